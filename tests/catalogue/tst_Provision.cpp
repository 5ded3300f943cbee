// Label: unit
#include "catalogue/cataloguefile.h"
#include "catalogue/provision.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/globals.h"
#include "support/datarows.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QTest>

/// The folder that the very first start makes, and the starts that must make none.
class tst_Provision : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void firstStart();
    void makesNone_data();
    void makesNone();
    void cannotBeMade();

private:
    QString catalogue() const { return mDesktop->folder + u"/Compact4.orv"_s; }
    std::unique_ptr<QTemporaryDir> mHome;
    std::unique_ptr<ScriptedDesktop> mDesktop;
};

void tst_Provision::init()
{
    mHome = std::make_unique<QTemporaryDir>();
    qputenv("XDG_DATA_HOME", QFile::encodeName(mHome->path()));
    mDesktop = std::make_unique<ScriptedDesktop>();
    mDesktop->folder = programfolder::userFolder();
    QVERIFY(mDesktop->folder.startsWith(mHome->path()));
}

void tst_Provision::firstStart()
{
    // An attempt that was cut off stands beside it.
    QDir().mkpath(mDesktop->folder + u".new"_s);
    writeFile(mDesktop->folder + u".new/Compact4.orv"_s, "half");
    provisionCatalogue();
    QCOMPARE(QDir(mDesktop->folder).entryList(QDir::Files), QStringList{u"Compact4.orv"_s});
    QVERIFY(!QFile::exists(mDesktop->folder + u".new"_s));
    cataloguefile::inspect(catalogue());
    openConnection(catalogue());
    cataloguefile::verify(*gConnection, true);
    gConnection->Execute(u"insert into artiesten values (1,'x')"_s);
    gConnection.reset();

    provisionCatalogue(); // not again, whatever has become of the file
    QVERIFY(QFile::remove(catalogue()));
    provisionCatalogue();
    QVERIFY(!QFile::exists(catalogue()));
}

void tst_Provision::makesNone_data()
{
    const DataRows<QString> row("because");
    row("started before", "session");
    row("another folder", "other");
    row("folder is there", "there");
}

void tst_Provision::makesNone()
{
    QFETCH(QString, because);
    if (because == QLatin1String("session")) {
        clsRegistry().CreateKey(settingsKey);
        clsRegistry().SetValue(settingsKey, u"Session"_s, 1);
    } else if (because == QLatin1String("other")) {
        mDesktop->folder = mHome->filePath(u"elsewhere"_s);
    } else {
        QDir().mkpath(mDesktop->folder);
    }
    provisionCatalogue();
    QVERIFY(!QFile::exists(catalogue()));
    QCOMPARE(QFile::exists(mDesktop->folder), because == QLatin1String("there"));
}

void tst_Provision::cannotBeMade()
{
    QFile::setPermissions(mHome->path(), QFile::Permissions(0x5555));
    QString told;
    {
        const OrdinaryUser user;
        try {
            provisionCatalogue();
        } catch (const ADODB::Error &error) {
            told = error.Description;
        }
    }
    QFile::setPermissions(mHome->path(), QFile::Permissions(0x7700));
    QVERIFY2(told.contains(mDesktop->folder), qPrintable(told));
    QVERIFY(QDir(mHome->path()).isEmpty());
}

QTEST_GUILESS_MAIN(tst_Provision)
#include "tst_Provision.moc"
