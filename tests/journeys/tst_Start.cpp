// Label: journey
#include "catalogue/cataloguefile.h"
#include "catalogue/ids.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/programfolder.h"
#include "services/clsRegistry.h"
#include "services/globals.h"
#include "services/messages.h"
#include "support/datarows.h"
#include "support/program.h"
#include "support/testcatalogue.h"

#include <QAction>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QMdiSubWindow>
#include <QTabWidget>
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
            QVERIFY(program.screen("frmCDList"));
            QVERIFY(!program.screen("frmSplash"));
            QCOMPARE(bool(program.screen("frmHelp")), start == 1);
            const bool dutch = start == 2 && language == languageDutch;
            QCOMPARE(program.frame().windowTitle(),
                     dutch ? u"Dr. Orvanta's Liedkist"_s : u"Dr. Orvanta's Songcase"_s);
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
        const bool dutch = language == languageDutch;
        writeFile(mDesktop->folder + u"/Compact3.orv"_s, "old");
        const QString file = mDesktop->folder + u"/Compact4.orv"_s;
        mDesktop->expectBox((dutch ? u"[Bestand niet gevonden] Er kan geen verbinding met "
                                     "de database worden gemaakt!\rHet bestand "_s
                                   : u"[File not found] Unable to connect with "
                                     "database!\rFile "_s) +
                            file);
        Program program(*mDesktop);
        QVERIFY(!program.start());
        QVERIFY(Form::openForms().isEmpty());
        QVERIFY(!QFile::exists(file));
    }

    void aFileThatCannotBeUsedIsLeftAsItWas_data()
    {
        const DataRows<bool, QString> row("locked", "said");
        row("text", false, "not a catalogue"); // before it is opened
        row("locked", true, "in use");         // and after
    }

    void aFileThatCannotBeUsedIsLeftAsItWas()
    {
        QFETCH(bool, locked);
        QFETCH(QString, said);
        makeCatalogue();
        const QString file = mDesktop->folder + u"/Compact4.orv"_s;
        if (!locked)
            writeFile(file, QByteArray(5000, 'x'));
        const OtherProgram other(file);
        QCOMPARE(other.run("begin exclusive") == SQLITE_OK, locked);
        const QByteArray before = readFile(file);

        mDesktop->expectBox(u"error [System error] ADO Connect Error: "_s);
        mDesktop->expectBox(said);
        mDesktop->expectBox(u"[Unable to initialise list!]"_s);
        mDesktop->expectBox(said);
        {
            Program program(*mDesktop);
            QVERIFY2(program.start(), "the frame stays up");
            QVERIFY(program.frame().isVisible());
            mDesktop->verifyAllCame();
            mDesktop->expectBox(u"[Systeemfout]"_s);
            mDesktop->expectBox(u"[System error]"_s);
            QVERIFY(program.end());
        }
        QCOMPARE(readFile(file), before);
        QCOMPARE(QDir(mDesktop->folder).entryList({u"Compact4*"_s}).size(), 1);
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
        mDesktop->verifyAllCame();
        mDesktop->expectBox(u"[Systeemfout]"_s);
        mDesktop->expectBox(u"[System error]"_s);
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
        mDesktop->expectBox(u"[Systeemfout]"_s);
        mDesktop->expectBox(u"[System error]"_s);
        QVERIFY(frame.Unload());
    }

    void aCatalogueMovedWhileOpen_data()
    {
        QTest::addColumn<bool>("replaced");
        QTest::newRow("moved") << false;
        QTest::newRow("replaced") << true;
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

        QString told;
        try {
            gConnection->Execute(u"insert into artiesten values (1,'x')"_s);
        } catch (const Error &error) {
            told = error.Description;
        }
        QVERIFY2(told.contains("moved, replaced or deleted"_L1), qPrintable(told));
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
        const char *own = dutch ? "mnuNederlands" : "mnuEngels",
                   *other = dutch ? "mnuEngels" : "mnuNederlands";
        const int otherLanguage = dutch ? languageEnglish : languageDutch;
        {
            Program program(*mDesktop);
            QVERIFY(program.start());
            program.choose(own);
            QVERIFY2(mDesktop->boxes.isEmpty(), "the current language is no change");
            mDesktop->expectBox(dutch ? u"information [Preferences] If you close and restart this "
                                        "program, the preferred language will be English."_s
                                      : u"information [Instellingen] De taalinstellingen worden "
                                        "van toepassing indien u dit programma afsluit"_s);
            program.choose(other);
            QVERIFY(program.entry(other)->isChecked() && !program.entry(own)->isChecked());
            QCOMPARE(gLanguage, language);
            program.choose("mnuHelp");
            QCOMPARE(program.entry("Over")->text(),
                     dutch ? u"&Over Liedkist"_s : u"&About Songcase"_s);
            QVERIFY(program.end());
        }
        Program program(*mDesktop);
        QVERIFY(program.start());
        QCOMPARE(gLanguage, otherLanguage);
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
        const QString author =
            language == languageDutch ? u"Door Arend K. Vossel"_s : u"Created by Arend K. Vossel"_s;
        for (int time = 1; time <= 2; ++time) {
            QStringList shown;
            mDesktop->expectModal(u"frmSplash"_s, [&](Form &splash) {
                for (const char *label : {"lblVersion", "lblAuthor"})
                    shown.append(splash.findChild<QLabel *>(QLatin1String(label))->text());
                QTest::keyClick(&splash, Qt::Key_Space);
            });
            mDesktop->expectModal(u"Credits"_s, [](Form &credits) { credits.Unload(); });
            program.choose("tbCredits");
            QCOMPARE(shown, (QStringList{u"Version " SONGCASE_VERSION ""_s, QString()}));
            QCOMPARE(program.control<QLabel>("frmSplash", "lblAuthor")->text(), author);
            QVERIFY(!program.screen("frmSplash")->isVisible());
        }

        program.choose("mnuHelp");
        QPointer<Form> help = program.screen("frmHelp");
        program.choose("tbHelp");
        QCOMPARE(program.screen("frmHelp"), help.data());
        auto *link = program.control<QLabel>("frmHelp", "Link");
        program.frame().activateWindow();
        QTRY_VERIFY(link->hasFocus());
        QTest::keyClick(link, Qt::Key_Return); // and nothing before it
        QCOMPARE(mDesktop->addresses.size(), 1);
        QVERIFY(mDesktop->addresses.first().endsWith(
            language == languageDutch ? "guide/nl/index.html"_L1 : "guide/en/index.html"_L1));
        QVERIFY(QFile::exists(QUrl(mDesktop->addresses.first()).toLocalFile()));
        // Below ~/.local that is the folder of the user's catalogue, which is not there before the
        // first start.
        QVERIFY(!mDesktop->addresses.first().contains("share/songcase/"_L1));
        mDesktop->browserThere = false;
        mDesktop->expectBox(u"error [] No browser detected!"_s.mid(0, 5));
        emit link->linkActivated(u"guide"_s);
        QVERIFY(mDesktop->boxes.last().endsWith("No browser detected!"_L1));
        QVERIFY(program.end());
    }

private:
    static void languages()
    {
        QTest::addColumn<int>("language");
        QTest::newRow("English") << languageEnglish;
        QTest::newRow("Dutch") << languageDutch;
    }

    void makeCatalogue() { cataloguefile::create(mDesktop->folder + u"/Compact4.orv"_s); }

    std::unique_ptr<ScriptedDesktop> mDesktop;
};

QTEST_MAIN(tst_Start)
#include "tst_Start.moc"
