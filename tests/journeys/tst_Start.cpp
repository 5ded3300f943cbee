// Label: journey
#include "catalogue/cataloguefile.h"
#include "catalogue/ids.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "services/globals.h"
#include "services/messages.h"
#include "support/datarows.h"
#include "support/program.h"
#include "support/testcatalogue.h"

#include <QAction>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QTest>
#include <sqlite3.h>

/// From the start of the program to its end, in both languages.
class tst_Start : public QObject
{
    Q_OBJECT

private slots:
    void init() { mDesktop = std::make_unique<ScriptedDesktop>(); }

    void cleanup()
    {
        mDesktop->verifyAllCame();
        mDesktop.reset();
    }

    void firstAndSecondStart_data() { languages(); }
    void firstAndSecondStart()
    {
        QFETCH(int, language);
        QTemporaryDir home;
        qputenv("XDG_DATA_HOME", home.path().toLocal8Bit());
        mDesktop->folder = programfolder::userFolder();
        for (int start = 1; start <= 2; ++start) {
            if (start == 2)
                storeLanguage(language);
            Program program(*mDesktop);
            QVERIFY(program.start());
            QVERIFY(program.screen("frmCDList") && !program.screen("frmSplash"));
            QCOMPARE(bool(program.screen("frmHelp")), start == 1);
            const bool dutch = start == 2 && language == languageDutch;
            QVERIFY(program.frame().windowTitle().endsWith(dutch ? "Liedkist"_L1 : "Songcase"_L1));
            QCOMPARE(gConnection->State(), ADODB::adStateOpen);
            QVERIFY(program.screen("frmCDList")->Unload());
            QTest::keyClick(&program.frame(), Qt::Key_F5);
            QVERIFY(program.screen("frmCDList"));
            QVERIFY(program.end());
            QCOMPARE(gConnection->State(), ADODB::adStateClosed);
        }
        QCOMPARE(QDir(mDesktop->folder).entryList(QDir::Files), texts("Compact4.orv"));
    }

    void aMissingCatalogueEndsTheProgram_data() { languages(); }
    void aMissingCatalogueEndsTheProgram()
    {
        QFETCH(int, language);
        storeLanguage(language);
        writeFile(mDesktop->folder + u"/Compact3.orv"_s, "old");
        const QString file = mDesktop->folder + u"/Compact4.orv"_s;
        mDesktop->expectBox((language == languageDutch ? u"!\rHet bestand "_s : u"!\rFile "_s) +
                            file);
        Program program(*mDesktop);
        QVERIFY(!program.start());
        QVERIFY(Form::openForms().isEmpty());
        QVERIFY(!QFile::exists(file));
    }

    void aLockedFileLeavesTheFrame()
    {
        makeCatalogue();
        const QString file = mDesktop->folder + u"/Compact4.orv"_s;
        const OtherProgram other(file);
        QCOMPARE(other.run("begin exclusive"), SQLITE_OK);
        const QByteArray before = readFile(file);
        for (const auto &box : {u"error [System error] ADO Connect Error: "_s, u"in use"_s,
                                u"[Unable to initialise list!]"_s, u"in use"_s})
            mDesktop->expectBox(box);
        {
            Program program(*mDesktop);
            QVERIFY(program.start());
            expectBoxesOfTheEnd();
            QVERIFY(program.end());
        }
        QCOMPARE(readFile(file), before);
    }

    // A folder that cannot be made leaves the frame with its captions and a connection that is
    // closed; what needs one says so and ends nothing.
    void withoutACatalogue()
    {
        QTemporaryDir home;
        qputenv("XDG_DATA_HOME", QFile::encodeName(writeFile(home.filePath(u"file"_s), "x")));
        mDesktop->folder = programfolder::userFolder();
        mDesktop->expectBox(u"ADO Connect Error: -2147467259"_s);
        mDesktop->expectBox(u"[Unable to initialise list!] 3704"_s);
        Program program(*mDesktop);
        QVERIFY(program.start());
        QCOMPARE(program.frame().windowTitle(), u"Dr. Orvanta's Songcase"_s);
        QVERIFY(!program.entry("Import")->text().isEmpty());
        QCOMPARE(gConnection->State(), ADODB::adStateClosed);

        // With this the reading of a text file begins.
        QCOMPARE(numberOf([] { nextId(Table::CDTitels); }), int(errObjectClosed));
        expectBoxesOfTheEnd();
        QVERIFY(program.end());
    }

    // Another one comes while this one still says what is wrong: the frame has its turn later.
    void aSecondStartWhileTheFirstSaysAnError()
    {
        makeCatalogue();
        writeFile(mDesktop->folder + u"/Compact4.orv"_s, "x");
        MainScreen frame;
        bool shown = true;
        mDesktop->expectBox(u"ADO Connect Error"_s);
        mDesktop->expectBox(u"not a catalogue"_s);
        mDesktop->duringBox = [&] {
            frame.bringToFront();
            shown = frame.isVisible();
        };
        QVERIFY(frame.Load());
        mDesktop->duringBox = {};
        QVERIFY(!shown);
        expectBoxesOfTheEnd();
        QVERIFY(frame.Unload());
    }

    void aCatalogueMovedWhileOpen_data()
    {
        const DataRows<bool> row("replaced");
        row("moved", false);
        row("replaced", true);
    }

    void aCatalogueMovedWhileOpen()
    {
        QFETCH(bool, replaced);
        makeCatalogue();
        storeLanguage(languageEnglish);
        const QString file = mDesktop->folder + u"/Compact4.orv"_s, moved = file + u".old"_s;
        Program program(*mDesktop);
        QVERIFY(program.start());
        const QByteArray before = readFile(file);
        QVERIFY(QFile::rename(file, moved));
        if (replaced)
            writeFile(file, before);
        const auto comeBack = [] {
            emit qApp->applicationStateChanged(Qt::ApplicationActive);
            QCoreApplication::sendPostedEvents();
        };
        mDesktop->expectBox(u"moved, replaced or deleted"_s);
        comeBack();
        mDesktop->verifyAllCame();
        comeBack(); // and not again

        QVERIFY(numberOf([] { gConnection->Execute(u"insert into artiesten values (1,'x')"_s); }));
        QCOMPARE(readFile(moved), before);
        QCOMPARE(readFile(file), replaced ? before : QByteArray("none"));
        QFile::remove(file);
        QVERIFY(QFile::rename(moved, file));
        gConnection->Execute(u"insert into artiesten values (1,'x')"_s); // put back
        QVERIFY(program.end());
    }

    // The person sees that the program waits, and nothing else comes in.
    void aLockThatIsLetGoIsWaitedFor()
    {
        makeCatalogue();
        Program program(*mDesktop);
        QVERIFY(program.start());
        const OtherProgram other(gDatabasePath);
        QCOMPARE(other.run("begin exclusive"), SQLITE_OK);
        const auto pointer = [&] { return program.frame().cursor().shape(); };
        bool cameIn = false;
        QTimer::singleShot(1, &program.frame(), [&] { cameIn = true; });
        gConnection->WhileLocked = [&, wait = gConnection->WhileLocked] {
            wait();
            QCOMPARE(pointer(), Qt::WaitCursor);
            QVERIFY(!cameIn);
            QCOMPARE(other.run("commit"), SQLITE_OK);
        };
        gConnection->Execute(u"insert into artiesten values (1,'x')"_s);
        QTRY_COMPARE(pointer(), Qt::ArrowCursor);
        QVERIFY(cameIn);
        QVERIFY(program.end());
    }

    void changeOfLanguage_data() { languages(); }
    void changeOfLanguage()
    {
        QFETCH(int, language);
        makeCatalogue();
        storeLanguage(language);
        const bool dutch = language == languageDutch;
        const char *own = dutch ? "mnuNederlands" : "mnuEngels";
        const char *other = dutch ? "mnuEngels" : "mnuNederlands";
        {
            Program program(*mDesktop);
            QVERIFY(program.start());
            program.choose(own); // is no change
            mDesktop->expectBox(dutch ? u"If you close and restart this program"_s
                                      : u"indien u dit programma afsluit"_s);
            program.choose(other);
            QVERIFY(program.entry(other)->isChecked() && !program.entry(own)->isChecked());
            QCOMPARE(gLanguage, language);
            QVERIFY(program.end());
        }
        Program program(*mDesktop);
        QVERIFY(program.start());
        QCOMPARE(gLanguage, dutch ? languageEnglish : languageDutch);
        QVERIFY(program.end());
    }

    void aboutAndHelp_data() { languages(); }
    void aboutAndHelp()
    {
        QFETCH(int, language);
        makeCatalogue();
        storeLanguage(language);
        Program program(*mDesktop);
        QVERIFY(program.start());
        const bool dutch = language == languageDutch;
        for (int time = 1; time <= 2; ++time) {
            QString version;
            mDesktop->expectModal(u"frmSplash"_s, [&](Form &splash) {
                version = splash.findChild<QLabel *>(u"lblVersion"_s)->text();
                QTest::keyClick(&splash, Qt::Key_Space);
            });
            mDesktop->expectModal(u"Credits"_s, [](Form &credits) { credits.Unload(); });
            program.choose("tbCredits");
            QCOMPARE(version, u"Version " SONGCASE_VERSION ""_s);
            QVERIFY(!program.screen("frmSplash")->isVisible());
        }

        program.choose("mnuHelp");
        auto *link = program.control<QLabel>("frmHelp", "Link");
        program.frame().activateWindow();
        QTRY_VERIFY(link->hasFocus());
        QTest::keyClick(link, Qt::Key_Return); // and nothing before it
        QCOMPARE(mDesktop->addresses.size(), 1);
        const QString address = mDesktop->addresses.first();
        QVERIFY(address.endsWith(dutch ? "guide/nl/index.html"_L1 : "guide/en/index.html"_L1));
        QVERIFY(QFile::exists(QUrl(address).toLocalFile()));
        // Below ~/.local that is the folder of the user's catalogue, which is not there before the
        // first start.
        QVERIFY(!address.contains("share/songcase/"_L1));
        mDesktop->browserThere = false;
        mDesktop->expectBox(u"No browser detected!"_s);
        emit link->linkActivated(u"guide"_s);
        QVERIFY(program.end());
    }

private:
    static void languages()
    {
        const DataRows<int> row("language");
        row("English", languageEnglish);
        row("Dutch", languageDutch);
    }

    // Without a connection nothing can be cleaned up, nor be closed.
    void expectBoxesOfTheEnd()
    {
        mDesktop->verifyAllCame();
        mDesktop->expectBox(u"[Systeemfout]"_s);
        mDesktop->expectBox(u"[System error]"_s);
    }

    void makeCatalogue() { cataloguefile::create(mDesktop->folder + u"/Compact4.orv"_s); }

    std::unique_ptr<ScriptedDesktop> mDesktop;
};

QTEST_MAIN(tst_Start)
#include "tst_Start.moc"
