// Label: unit
#include "catalogue/cataloguefile.h"
#include "catalogue/provision.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/globals.h"
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
    void namedFolder();

private:
    QString catalogue() const { return mDesktop->folder + QStringLiteral("/Compact4.orv"); }
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
    QDir().mkpath(mDesktop->folder + QStringLiteral(".new"));
    writeFile(mDesktop->folder + QStringLiteral(".new/Compact4.orv"), "half");
    provisionCatalogue();
    QCOMPARE(QDir(mDesktop->folder).entryList(QDir::Files),
             QStringList{QStringLiteral("Compact4.orv")});
    QVERIFY(!QFile::exists(mDesktop->folder + QStringLiteral(".new")));
    cataloguefile::inspect(catalogue());
    openConnection(catalogue());
    cataloguefile::verify(*gConnection, true);
    gConnection->Execute(QStringLiteral("insert into artiesten values (1,'x')"));
    gConnection.reset();

    provisionCatalogue(); // not again, whatever has become of the file
    QVERIFY(QFile::remove(catalogue()));
    provisionCatalogue();
    QVERIFY(!QFile::exists(catalogue()));
}

void tst_Provision::makesNone_data()
{
    QTest::addColumn<QString>("because");
    QTest::newRow("started before") << QStringLiteral("session");
    QTest::newRow("another folder") << QStringLiteral("other");
    QTest::newRow("folder is there") << QStringLiteral("there");
}

void tst_Provision::makesNone()
{
    QFETCH(QString, because);
    if (because == QLatin1String("session")) {
        clsRegistry().CreateKey(settingsKey);
        clsRegistry().SetValue(settingsKey, QStringLiteral("Session"), 1);
    } else if (because == QLatin1String("other")) {
        mDesktop->folder = mHome->filePath(QStringLiteral("elsewhere"));
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

void tst_Provision::namedFolder()
{
    qputenv("SONGCASE_FOLDER", QFile::encodeName(mHome->path() + QStringLiteral("/a/../b/")));
    QCOMPARE(programfolder::find(), mHome->path() + QStringLiteral("/b"));
    qunsetenv("SONGCASE_FOLDER");
    QCOMPARE(programfolder::find(), programfolder::userFolder());
}

QTEST_GUILESS_MAIN(tst_Provision)
#include "tst_Provision.moc"
