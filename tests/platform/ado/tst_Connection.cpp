// Label: unit
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QTest>

using namespace ADODB;

class tst_Connection : public QObject
{
    Q_OBJECT

private slots:
    void writesAndReads();
};

void tst_Connection::writesAndReads()
{
    TestCatalogue catalogue;
    gConnection->Execute(QStringLiteral("Insert into Artiesten(ID,Naam) values (1,'d''Arc')"));
    Recordset rs;
    rs.Open(QStringLiteral("Select ID, Naam From Artiesten where Naam = 'D''ARC'"), *gConnection);
    QCOMPARE(rs.RecordCount(), 1);
    QCOMPARE(rs.Fields(u"naam").Value().toText(), QStringLiteral("d'Arc"));
}

QTEST_MAIN(tst_Connection)
#include "tst_Connection.moc"
