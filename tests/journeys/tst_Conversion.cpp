// Label: journey
#include "catalogue/cataloguefile.h"
#include "services/clsRegistry.h"
#include "support/jetfile.h"
#include "support/journey.h"

#include <QAction>
#include <QDir>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPushButton>

/// From the catalogue of the older program to this one, in both languages.
class tst_Conversion : public Journey
{
    Q_OBJECT

    template <typename Control> static Control *control(const Form &screen, const char *name)
    {
        return screen.findChild<Control *>(QLatin1String(name));
    }
    static void press(const Form &screen, const char *button)
    {
        control<QPushButton>(screen, button)->click();
    }

    // What a person does who sees the screen with a file in it.
    void convert(const Form &screen)
    {
        QVERIFY(screen.isVisible() && screen.isModal());
        press(screen, "cmdStartConversion");
        const QString log = control<QPlainTextEdit>(screen, "ReportList")->toPlainText();
        QVERIFY2(log.contains("Ready at "_L1), qPrintable(log));
        QCOMPARE(control<QPushButton>(screen, "cmdCancel")->text(), u"&OK"_s);
        press(screen, "cmdCancel");
    }
    void prepare(int language)
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        storeLanguage(language);
        cataloguefile::create(mDesktop->folder + u"/Compact4.orv"_s);
        clsRegistry().SetValue(settingsKey, u"Session"_s, 5); // no help on the screen
    }
    bool run()
    {
        mProgram = std::make_unique<Program>(*mDesktop);
        return mProgram->start();
    }

private slots:
    void offeredOnceAfterAnUpgrade_data() { languages(); }
    void offeredOnceAfterAnUpgrade()
    {
        QFETCH(int, language);
        prepare(language);
        const QByteArray old = jetFile(oldCatalogue());
        const QString file = writeFile(mDesktop->folder + u"/Compact.orv"_s, old);
        mDesktop->expectModal(u"frmAutoUpdateUtility"_s, [&](Form &screen) {
            QVERIFY2(!mProgram->screen("frmCDList"), "the offer comes before the browser");
            QCOMPARE(screen.windowTitle(), GetMessage("frmAutoUpdateUtilityCaption"));
            convert(screen);
        });
        QVERIFY(run());
        mDesktop->verifyAllCame();
        QCOMPARE(column("ColList", 1), texts("Mix"));
        QCOMPARE(readFile(file), old);
        QVERIFY(mProgram->end());
        mProgram.reset();
        QVERIFY2(run(), "a second offer would fail the test");
    }

    void sessionEndsWhileItIsOffered()
    {
        prepare(languageEnglish);
        writeFile(mDesktop->folder + u"/Compact3.orv"_s, "x");
        mDesktop->expectModal(u"frmAutoUpdateUtility"_s, [&](Form &) { mProgram->end(); });
        run();
        QVERIFY(!mProgram->screen("frmCDList"));
    }

    void fromTheMenu_data() { languages(); }
    void fromTheMenu()
    {
        QFETCH(int, language);
        start(language);
        const QString file =
            writeFile(mDesktop->folder + u"/Compact3.orv"_s, jetFile(oldCatalogue()));
        mDesktop->expectModal(u"frmAutoUpdateUtility"_s, [&](Form &screen) {
            mDesktop->expectBox(GetMessage("cvtInvalidFileName"));
            control<QLineEdit>(screen, "txtOldDatabaseFileName")->setText(file + u'x');
            press(screen, "cmdStartConversion");
            mDesktop->expectFile(mDesktop->folder);
            press(screen, "cmdBrowse");
            convert(screen);
        });
        mProgram->choose("mnuConvertDatabase");
        QCOMPARE(column("ColList", 1), texts("Mix"));

        mDesktop->expectModal(u"frmAutoUpdateUtility"_s, [&](Form &screen) {
            QVERIFY(!control<QPushButton>(screen, "cmdStartConversion")->isVisible());
            screen.close();
        });
        mProgram->choose("mnuConvertDatabase"); // not into this one
    }

    // Somebody has copied the old file over the catalogue of this program.
    void inThePlaceOfTheCatalogue_data() { languages(); }
    void inThePlaceOfTheCatalogue()
    {
        QFETCH(int, language);
        prepare(language);
        clsRegistry().SetValue(settingsKey, u"DBVersion"_s, 3); // an offer is pending
        const QByteArray old = jetFile(oldCatalogue());
        const QString file = writeFile(mDesktop->folder + u"/Compact4.orv"_s, old);
        const QString said = language == languageDutch ? u"database van het oude programma"_s
                                                       : u"catalogue of the older program"_s;
        for (const QString &box : {said, said, u"3704"_s, said}) // the start, then the browser
            mDesktop->expectBox(box);
        QVERIFY(run());
        QVERIFY(mDesktop->boxes[0].endsWith(QDir::toNativeSeparators(file)));
        mDesktop->expectBox(GetMessage("xErrCannotOpen"));
        mProgram->choose("mnuConvertDatabase");
        mDesktop->expectBox(u"3704"_s);
        mDesktop->expectBox(u"3704"_s);
        QVERIFY(mProgram->end());
        QCOMPARE(readFile(file), old);
    }
};

QTEST_MAIN(tst_Conversion)
#include "tst_Conversion.moc"
