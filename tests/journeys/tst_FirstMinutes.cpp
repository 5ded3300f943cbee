// Label: journey
#include "catalogue/cataloguefile.h"
#include "collection/firststeps.h"
#include "platform/ado/recordset.h"
#include "services/browser.h"
#include "support/journey.h"
#include "support/onscreen.h"

#include <QAction>
#include <QMdiSubWindow>
#include <QPushButton>
#include <QSignalSpy>
#include <QTabWidget>
#include <QToolBar>

namespace
{

QRect placeOf(const QWidget *w)
{
    return {w->mapToGlobal(QPoint()), w->size()};
}

} // namespace

/// What a person meets first: an empty catalogue, the keys of things, the way out.
class tst_FirstMinutes : public Journey
{
    Q_OBJECT

private slots:
    void anEmptyListSaysWhatToDo_data() { languages(); }
    void anEmptyListSaysWhatToDo()
    {
        QFETCH(int, language);
        start(language);
        auto *steps = mProgram->control<FirstSteps>("frmCDList", "noCompilations");
        QVERIFY(steps->isVisible() && steps->isEnabled());
        const std::pair<const char *, const char *> links[] = {{"mnuCDInsert", "frmCDRoot"},
                                                               {"mnuCDDB", "frmDiscInfoCDDB"},
                                                               {"Import", "frmImportWizard"},
                                                               {"mnuHelp", "frmHelp"}};
        for (const auto &[command, screen] : links) {
            const QAction *entry = mProgram->entry(command);
            QVERIFY(steps->text().contains(u"href=\""_s + entry->objectName()));
            QVERIFY(steps->text().contains(u'(' + entry->shortcut().toString()));
            emit steps->linkActivated(entry->objectName());
            QVERIFY2(mProgram->screen(screen), screen);
        }
        auto *collections = mProgram->control<FirstSteps>("frmCDList", "noMP3");
        emit collections->linkActivated(u"mnuMP3"_s);
        QVERIFY(mProgram->screen("frmCDRootMP3"));
    }

    void itGoesWithTheFirstDisc()
    {
        start(languageEnglish);
        auto *steps = mProgram->control<FirstSteps>("frmCDList", "noAlbums");
        mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(1);
        QVERIFY(steps->isVisible() && steps->text().contains("mnuInsertEnkelCD"_L1));
        gConnection->Execute(u"insert into Artiesten values (1,'Zed')"_s);
        gConnection->Execute(u"insert into CDTitels values (1,'Zebra',1,'E',null,null)"_s);
        refreshBrowser();
        QVERIFY(!steps->isVisible());
    }

    // It comes by itself at the first start, before anything has been drawn.
    void theHelpCoversNoButton_data() { languages(); }
    void theHelpCoversNoButton()
    {
        QFETCH(int, language);
        mDesktop = std::make_unique<ScriptedDesktop>();
        cataloguefile::create(mDesktop->folder + u"/Compact4.orv"_s);
        storeLanguage(language);
        mProgram = std::make_unique<Program>(*mDesktop);
        QVERIFY(mProgram->start());
        for (int time = 1; time <= 2; ++time) {
            const QRect help = placeOf(mProgram->screen("frmHelp")->parentWidget());
            for (const auto *button : mProgram->screen("frmCDList")->findChildren<QPushButton *>())
                QVERIFY2(!help.intersects(placeOf(button)), button->objectName().toLatin1());
            mProgram->screen("frmHelp")->Unload();
            mProgram->choose("mnuHelp");
        }
    }

    void theFrameHasTheSizeThatIsTold()
    {
        start(languageEnglish);
        QCOMPARE(mProgram->frame().pos(), QPoint(7, 7));
        QCOMPARE(mProgram->frame().QMainWindow::size(), QSize(1000, 667));
    }

    void theToolbarNamesItsKeys()
    {
        start(languageEnglish);
        QStringList tips;
        const auto buttons = mProgram->frame().findChild<QToolBar *>(u"MainToolbar"_s)->actions();
        for (const QAction *button : buttons)
            tips.append(button->toolTip().section(u'(', -1));
        QCOMPARE(tips.join(u' '), u"Ctrl+Ins) Ctrl+S) Ctrl+F1) F5) Ctrl+I) F1) F6)"_s);
    }

    void quit()
    {
        start(languageEnglish);
        QSignalSpy ended(&mProgram->frame(), &MainScreen::unloaded);
        QCOMPARE(mProgram->entry("Quit")->shortcut(), QKeySequence(u"Ctrl+Q"_s));
        mProgram->choose("Quit");
        QCOMPARE(ended.size(), 1);
    }
};

int main(int argc, char *argv[])
{
    return runOnScreen<tst_FirstMinutes>(1600, 1000, argc, argv);
}
#include "tst_FirstMinutes.moc"
