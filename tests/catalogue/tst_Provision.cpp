// Label: unit
#include "catalogue/cataloguefile.h"
#include "catalogue/provision.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "services/clsRegistry.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>

/// The folder that the very first start makes, and the starts that must make none.
class tst_Provision : public QObject
{
    Q_OBJECT

private:
    QString catalogue() const { return mDesktop->folder + u"/Compact4.orv"_s; }
    std::unique_ptr<QTemporaryDir> mHome;
    std::unique_ptr<ScriptedDesktop> mDesktop;

private slots:
    void init()
    {
        mHome = std::make_unique<QTemporaryDir>();
        qputenv("XDG_DATA_HOME", QFile::encodeName(mHome->path()));
        mDesktop = std::make_unique<ScriptedDesktop>();
        mDesktop->folder = programfolder::userFolder();
        QVERIFY(mDesktop->folder.startsWith(mHome->path()));
    }

    void firstStart()
    {
        // An attempt that was cut off stands beside it.
        QDir().mkpath(mDesktop->folder + u".new"_s);
        writeFile(mDesktop->folder + u".new/Compact4.orv"_s, "half");
        // That a start has been elsewhere before means nothing, nor what else lies there.
        clsRegistry().CreateKey(settingsKey);
        clsRegistry().SetValue(settingsKey, u"Session"_s, 1);
        {
            const CatalogueLock first = provisionCatalogue();
            QCOMPARE(CatalogueLock().take(catalogue()), FileLock::Outcome::Held);
        }
        QCOMPARE(QDir(mDesktop->folder).entryList(QDir::Files), QStringList{u"Compact4.orv"_s});
        QCOMPARE(QDir(mHome->path()).entryList(QDir::AllEntries | QDir::NoDotAndDotDot),
                 QStringList{QFileInfo(mDesktop->folder).fileName()});
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

    void makesNone()
    {
        const QString own = mDesktop->folder;
        mDesktop->folder = mHome->filePath(u"elsewhere"_s);
        provisionCatalogue(); // not his own folder
        QVERIFY(!QFile::exists(mDesktop->folder));
        mDesktop->folder = own;
        QDir().mkpath(own);
        provisionCatalogue(); // it is there already
        QVERIFY(QDir(own).isEmpty());
    }

    void cannotBeMade()
    {
        QFile::setPermissions(mHome->path(), QFile::Permissions(0x5555));
        QString told;
        {
            const OrdinaryUser user;
            try {
                provisionCatalogue();
            } catch (const Error &error) {
                told = error.Description;
            }
        }
        QFile::setPermissions(mHome->path(), QFile::Permissions(0x7700));
        QVERIFY2(told.contains(mDesktop->folder), qPrintable(told));
        QVERIFY(QDir(mHome->path()).isEmpty());
    }
};

QTEST_GUILESS_MAIN(tst_Provision)
#include "tst_Provision.moc"
