// Label: unit
#include "platform/ado/recordset.h"
#include "platform/text/collation.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

#include <sqlite3.h>

using namespace ADODB;

namespace
{

QStringList column(const QString &statement)
{
    Recordset rs;
    rs.Open(statement, *gConnection);
    QStringList all;
    for (; !rs.isEOF(); rs.MoveNext()) {
        const Value v = rs.Fields(0).Value();
        all.append(v.isNull() ? u"NULL"_s : v.toText());
    }
    return all;
}

} // namespace

/// What the statements find in the engine besides its own: like, left, isnumeric, iif and the order
/// of texts; also as the extension that other programs load.
class tst_SqlFunctions : public QObject
{
    Q_OBJECT

private slots:
    void expressions_data()
    {
        const DataRows<QString, QString> row("expression", "value");
        row("left('\U0001F3B5\U0001F3B5x',1)", "\U0001F3B5");
        row("left('ab',-1)", "");
        row("left(1985,2)", "19");
        row("left(null,1)", "NULL");
        row("isnumeric(' -1.5 ')", "1");
        row("isnumeric(null)", "0");
        row("iif(isnumeric(left('10cc',1)),1,0)", "1");
        row("iif('v'='V','Compilation','Album')", "Album"); // a literal has no collation
        row("'ÉDITH' like 'éd%'", "1");
        row("null like '%'", "NULL");
        row("'a' between 'A' and 'b'", "1");
    }

    void expressions()
    {
        QFETCH(QString, expression);
        TestCatalogue catalogue;
        QTEST(column(u"select "_s + expression).value(0), "value");
    }

    void collationIsUsedByIndexes()
    {
        TestCatalogue catalogue;
        const auto plan = [&](const char *statement) {
            return catalogue.rows("explain query plan "_L1 + QLatin1String(statement)).join(u'\n');
        };
        // The look-ups that run once per row of an import, and the three of the clean-up.
        for (const char *statement :
             {"select ID, Naam from Artiesten where Naam = 'x'",
              "select 1 from Tracks tr, Artiesten ar where ar.id = "
              "tr.artiest_id and tr.Titel = 'x' and "
              "tr.artiest_id = 1",
              "select '1' from CDTitels where Titel = 'x' and Artiest_ID = 1",
              "select '1' from CompactDiscs where Track_ID=1",
              "select '1' from CompactDiscs where CDtitels_ID=1",
              "select '1' from Tracks where Artiest_ID = 1",
              "select '1' from CDtitels where Artiest_ID = 1",
              "delete from mp3files where collectionid = 1"})
            QVERIFY2(!plan(statement).contains("SCAN"_L1), qPrintable(plan(statement)));
    }

    void extensionForOtherPrograms()
    {
        TestCatalogue catalogue;
        gConnection->Execute(u"insert into artiesten values (1,'Édith')"_s);
        sqlite3 *db = nullptr;
        QCOMPARE(sqlite3_open(catalogue.file().toUtf8().constData(), &db), SQLITE_OK);
        const auto run = [&](const char *sql) {
            return sqlite3_exec(db, sql, nullptr, nullptr, nullptr);
        };
        const char *query =
            "select \"left\"(naam,1) from artiesten where naam='ÉDITH' and naam like 'é%'";
        sqlite3_db_config(db, SQLITE_DBCONFIG_ENABLE_LOAD_EXTENSION, 1, nullptr);
        const QByteArray file = qgetenv("SONGCASE_BIN") + "/lib/songcase.so";
        char *message = nullptr;
        QVERIFY2(sqlite3_load_extension(db, file.constData(), nullptr, &message) == SQLITE_OK,
                 message);
        QCOMPARE(run(query), SQLITE_OK);
        QCOMPARE(run("update artiesten set naam='Edith'"), SQLITE_OK);
        sqlite3_close(db);
        QCOMPARE(column(u"select id from artiesten where naam='edith'"_s).size(), 1);
    }
};

QTEST_GUILESS_MAIN(tst_SqlFunctions)
#include "tst_SqlFunctions.moc"
