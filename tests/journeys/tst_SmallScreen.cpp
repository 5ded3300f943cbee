// Label: journey
#include "discdata/cddbuserprofile.h"
#include "mp3/EditMP3Tags.h"
#include "mp3/frmMatchWithSongcase.h"
#include "mp3/frmTagWizardPg1.h"
#include "support/journey.h"
#include "support/onscreen.h"

#include <QAbstractButton>
#include <QLineEdit>
#include <QScreen>

/// A screen of 960 by 540: one of 1920 by 1080 whose owner wants all twice as large.
class tst_SmallScreen : public Journey
{
    Q_OBJECT

private slots:
    void allStaysOnTheScreen_data() { languages(); }
    void allStaysOnTheScreen()
    {
        QFETCH(int, language);
        start(language);
        QCOMPARE(outside(mProgram->frame()), QString());
        for (const char *entry :
             {"mnuCDInsert", "mnuInsertEnkelCD", "mnuSearchArtistsTitles", "Import", "mnuHelp"}) {
            mProgram->choose(entry);
            QCOMPARE(outside(mProgram->frame()), QString());
            for (const Form *form : Form::openForms())
                QCOMPARE(outside(*form), QString());
        }
        mProgram->frame().move(500, 300); // a wide report makes the frame grow from where it is
        mProgram->frame().resize(400, 200);
        mProgram->control<QAbstractButton>("frmCDList", "cmdStartReport")->click();
        QVERIFY(mProgram->screen("CompilationReport"));
        QCOMPARE(outside(mProgram->frame()), QString());
        QVERIFY(mProgram->frame().QMainWindow::width() > 700);
    }

    // Those that stand by themselves, larger than the screen as they are drawn.
    void modalScreens_data()
    {
        const DataRows<std::function<Form *()>> row("make");
        row("EditMP3Tags", [] { return new EditMP3Tags; });
        row("frmTagWizardPg1", [] { return new frmTagWizardPg1; });
        row("frmMatchWithSongcase", [] { return new frmMatchWithSongcase; });
    }
    void modalScreens()
    {
        QFETCH(std::function<Form *()>, make);
        start(languageDutch);
        CddbUserProfile profile;
        profile.registered = true;
        profile.store();
        Form *form = make();
        mDesktop->expectModal(form->Name(), [](Form &shown) {
            QCOMPARE(outside(shown), QString());
            shown.Unload();
        });
        form->ShowModal();
    }

    // Begins low on the screen, and has a log to show then.
    void conversionGrowsWithinTheScreen()
    {
        start(languageEnglish);
        mProgram->frame().move(0, 300);
        mDesktop->expectModal(u"frmAutoUpdateUtility"_s, [this](Form &shown) {
            shown.findChild<QLineEdit *>(u"txtOldDatabaseFileName"_s)->setText(mDesktop->folder);
            shown.findChild<QAbstractButton *>(u"cmdStartConversion"_s)->click();
            QCOMPARE(outside(shown), QString());
            shown.Unload();
        });
        mProgram->choose("mnuConvertDatabase");
        mDesktop->verifyAllCame();
    }

    void aMaximizedFrameStaysSo()
    {
        start(languageEnglish);
        mProgram->frame().showMaximized();
        const QRect before = mProgram->frame().geometry();
        mProgram->control<QAbstractButton>("frmCDList", "cmdStartReport")->click();
        mProgram->choose("mnuCDInsert");
        QVERIFY(mProgram->frame().isMaximized());
        QCOMPARE(mProgram->frame().geometry(), before);
    }

private:
    // The names of the buttons, and of the window itself, that are not on the screen.
    static QString outside(const QWidget &window)
    {
        const QRect screen = window.screen()->availableGeometry();
        QStringList names;
        if (window.isWindow() && !screen.contains(window.frameGeometry()))
            names.append(window.objectName());
        for (const auto *button : window.findChildren<QAbstractButton *>()) {
            const QRect place(button->mapToGlobal(QPoint()), button->size());
            if (button->isVisible() && !screen.contains(place))
                names.append(button->objectName());
        }
        return names.join(u' ');
    }
};

int main(int argc, char *argv[])
{
    return runOnScreen<tst_SmallScreen>(960, 540, argc, argv);
}
#include "tst_SmallScreen.moc"
