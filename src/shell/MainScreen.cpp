#include "shell/MainScreen.h"

#include "catalogue/cleanorphans.h"
#include "catalogue/provision.h"
#include "collection/editors.h"
#include "collection/frmCDList.h"
#include "collection/frmSearchArtistsTitles.h"
#include "platform/ado/connection.h"
#include "platform/desktop/programfolder.h"
#include "services/captions.h"
#include "services/clsRegistry.h"
#include "services/fileutilities.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/accesskeys.h"
#include "shell/cataloguewatch.h"
#include "shell/conversionentry.h"
#include "shell/discentries.h"
#include "shell/freeplace.h"
#include "shell/frmHelp.h"
#include "shell/frmSplash.h"
#include "shell/mp3entries.h"
#include "shell/ui_MainScreen.h"
#include "shell/undoentry.h"
#include "textimport/frmImportWizard.h"

#include <QCloseEvent>
#include <QMdiSubWindow>
#include <QScopedValueRollback>
#include <QTimer>
#include <QToolButton>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr int splashTime = 3000;               // milliseconds
constexpr QRect placeAtStart(7, 7, 1000, 667); // 100, 100, 15000, 10000 twips

} // namespace

MainScreen::MainScreen(bool lastRunBroken)
    : mUi(std::make_unique<Ui::MainScreen>()),
      mTimer1(new QTimer(this)),
      mLastRunBroken(lastRunBroken)
{
    mTimer1->setObjectName(u"Timer1"_s);
    mTimer1->setInterval(splashTime);
    connect(mTimer1, &QTimer::timeout, this, &MainScreen::Timer1_Timer);
}

MainScreen::~MainScreen()
{
    Form::setHost(nullptr);
    Frame::setCurrent(nullptr);
}

bool MainScreen::Load()
{
    mDatabaseMissing = false;
    defaultInstance<frmSplash>().Show();
    Desktop::current().pump();
    setUpControls();
    try {
        InitMainScreen();
        mProvisioned = provisionCatalogue();
        if (FileExists(gDatabasePath)) {
            startup::openCatalogue(gDatabasePath, mLastRunBroken);
        } else {
            mDatabaseMissing = true;
            errorBox(GetMessage("FNFpart1") + gDatabasePath + GetMessage("FNFpart2"),
                     GetMessage("FileNotFound"));
            Unload();
            return false;
        }
    } catch (const Error &error) {
        startup::showErrors(error);
    }
    mTimer1->start();
    return true;
}

void MainScreen::setUpControls()
{
    mUi->setupUi(this);
    setCentralWidget(mUi->Children);
    connectActions();
    new AccessKeys(mUi->MenuBar, this);
    new CatalogueWatch(this);
    Frame::setCurrent(this);
    Form::setHost(this);
}

void MainScreen::InitMainScreen()
{
    const QString folder = Desktop::current().programFolder();
    mStart = startup::readSettings(folder);
    emit languageKnown();
    markLanguage();
    gDatabasePath = programfolder::catalogueIn(folder);
    setCaptions();
    setBoxTitle(windowTitle());
}

void MainScreen::setCaptions()
{
    applyCaptions(this, {{"MainScreen", "MainScreen.Caption"},
                         {"File", "File"},
                         {"Import", "Import"},
                         {"mnuSave", "mnuSave"},
                         {"mnuConvertDatabase", "frmAutoUpdateUtilityCaption"},
                         {"mnuUndoChanges", "xUndoEntry"},
                         {"Quit", "xQuit"},
                         {"mnuLiedkist", "mnuLiedkist"},
                         {"mnuSearchArtistsTitles", "mnuSearchArtistsTitles"},
                         {"mnuCDInsert", "mnuCDInsert"},
                         {"mnuInsertEnkelCD", "mnuInsertEnkelCD"},
                         {"mnuUpdate", "mnuUpdate"},
                         {"mnuMP3", "mnuInsertMP3Collection"},
                         {"mnuCDDB", "mnuCDDB"},
                         {"mnuInstellingen", "mnuInstellingen"},
                         {"mnuRegisterCDDB", "mnuRegisterCDDB"},
                         {"mnuTaal", "mnuTaal"},
                         {"mnuEngels", "mnuEngels"},
                         {"mnuNederlands", "mnuNederlands"},
                         {"Over", "Over"},
                         {"mnuOverCDDB", "OverCDDB"},
                         {"tbImport", "TTekstImport"},
                         {"tbSave", "TTSave"},
                         {"tbQuicksearch", "TTQuicksearch"},
                         {"tbCollection", "TTYourcollection"},
                         {"tbCredits", "TTCredits"},
                         {"tbHelp", "TTHelp"},
                         {"tbCDDB", "TTCDDB"},
                         {"MainToolbar", "xToolbar"}});
    nameKeys();
    // The keys that a toolbar's commands send go to the control with the focus.
    for (QToolButton *button : mUi->MainToolbar->findChildren<QToolButton *>())
        button->setFocusPolicy(Qt::NoFocus);
}

// In the tool tip of each button: those of the entry that does the same.
void MainScreen::nameKeys()
{
    const std::pair<QAction *, QAction *> buttons[] = {
        {mUi->tbImport, mUi->Import},
        {mUi->tbSave, mUi->mnuSave},
        {mUi->tbQuicksearch, mUi->mnuSearchArtistsTitles},
        {mUi->tbCollection, mUi->mnuUpdate},
        {mUi->tbCredits, mUi->Over},
        {mUi->tbHelp, mUi->mnuHelp},
        {mUi->tbCDDB, mUi->mnuCDDB}};
    for (const auto &[button, entry] : buttons) {
        const QString keys = entry->shortcut().toString(QKeySequence::NativeText);
        button->setToolTip(button->text() + u" ("_s + keys + u')');
    }
}

void MainScreen::markLanguage()
{
    mUi->mnuNederlands->setChecked(gLanguage == languageDutch);
    mUi->mnuEngels->setChecked(gLanguage == languageEnglish);
}

void MainScreen::connectActions()
{
    const auto on = [this](QAction *action, auto command) {
        connect(action, &QAction::triggered, this, command);
    };
    on(mUi->Import, [] { defaultInstance<frmImportWizard>().Show(); });
    on(mUi->tbImport, [this] { mUi->Import->trigger(); });
    on(mUi->Quit, &QWidget::close);
    on(mUi->mnuSave, &editors::saveAll);
    on(mUi->tbSave, &editors::saveAll);
    on(mUi->mnuSearchArtistsTitles, [] { defaultInstance<frmSearchArtistsTitles>().Show(); });
    on(mUi->tbQuicksearch, [this] { mUi->mnuSearchArtistsTitles->trigger(); });
    on(mUi->mnuCDInsert, &editors::newCompilation);
    on(mUi->mnuInsertEnkelCD, &editors::newAlbum);
    on(mUi->mnuUpdate, &MainScreen::openBrowser);
    on(mUi->tbCollection, &MainScreen::openBrowser);
    on(mUi->mnuHelp, &ShowHelpLinks);
    on(mUi->tbHelp, &ShowHelpLinks);
    on(mUi->Over, &MainScreen::Over_Click);
    on(mUi->tbCredits, &MainScreen::Over_Click);
    connectMP3Entries(*this);
    connectConversionEntry(*this);
    connectDiscEntries(*this); // the credits of the services come behind the program's own
    connectUndoEntry(*this);
    on(mUi->mnuEngels, [this] { ChangeLanguage(languageEnglish); });
    on(mUi->mnuNederlands, [this] { ChangeLanguage(languageDutch); });
}

// Nothing here hangs on a window manager, which may never activate the frame.
void MainScreen::Timer1_Timer()
{
    {
        const Freeze freeze(this);
        defaultInstance<frmSplash>().Unload();
        setWindowState(Qt::WindowNoState);
        mTimer1->stop();
        placeOnScreen(this, placeAtStart.topLeft(), placeAtStart.size());
    }
    mStarted = true;
    show();
    placeOnScreen(this, pos(), QMainWindow::size()); // with what is now drawn around it
    offerConversion(mStart.conversionPending);
    if (mUnloaded)
        return; // the session has ended meanwhile
    openBrowser();
    if (mStart.session == 1)
        ShowHelpLinks();
    if (gConnection && gConnection->State() == ADODB::adStateOpen)
        editors::offerUnsaved();
}

void MainScreen::openBrowser()
{
    defaultInstance<frmCDList>().Show();
}

void MainScreen::ChangeLanguage(int language)
{
    const bool dutch = language == languageDutch;
    const bool isMarked = (dutch ? mUi->mnuEngels : mUi->mnuNederlands)->isChecked();
    mUi->mnuNederlands->setChecked(dutch);
    mUi->mnuEngels->setChecked(!dutch);
    if (!isMarked)
        return; // the entry of the marked language was pressed again
    clsRegistry settings;
    settings.SetValue(settingsKey, u"Language"_s, language);
    // The running program keeps its language, so these words are in no table.
    if (dutch)
        informationBox(u"De taalinstellingen worden van toepassing indien u dit programma "
                       "afsluit en daarna opnieuw start."_s,
                       u"Instellingen"_s);
    else
        informationBox(u"If you close and restart this program, the preferred language "
                       "will be English."_s,
                       u"Preferences"_s);
}

void MainScreen::Over_Click()
{
    defaultInstance<frmSplash>().setAuthor({}); // of the form that the last time has left
    defaultInstance<frmSplash>().ShowModal();
    // By design: the author comes after the screen has closed, on a form that stays hidden, and is
    // never seen.
    frmSplash &hidden = defaultInstance<frmSplash>();
    hidden.Load();
    hidden.setAuthor(GetMessage("TheAuthor"));
    Desktop::current().pump();
}

QAction *MainScreen::command(const QString &name)
{
    return findChild<QAction *>(name);
}

void MainScreen::setImportEnabled(bool enabled)
{
    mUi->Import->setEnabled(enabled);
    mUi->tbImport->setEnabled(enabled);
}

// A screen gets the size that it wants and the place that it asks for, as far as the frame has
// room.
void MainScreen::adopt(Form *form)
{
    const QSize wanted = form->size().expandedTo(form->minimumSizeHint());
    if (subWindowOf(form)) { // which is minimized
        bringUp(form);
        return;
    }
    QMdiSubWindow *child = mUi->Children->addSubWindow(form);
    child->setAttribute(Qt::WA_DeleteOnClose, false);
    // Tab would come by it on its way around, and screen readers would tell of it last.
    child->setFocusPolicy(Qt::ClickFocus);
    child->setWindowIcon(form->windowIcon());
    form->show();
    child->show();
    const QSize room = mUi->Children->viewport()->size();
    child->resize((wanted + child->size() - form->size()).boundedTo(room));
    const QPoint place = form->place() ? *form->place() : freePlaceFor(*child, *mUi->Children);
    child->move(std::clamp(place.x(), 0, std::max(0, room.width() - child->width())),
                std::clamp(place.y(), 0, std::max(0, room.height() - child->height())));
    mUi->Children->setActiveSubWindow(child);
}

void MainScreen::bringUp(Form *form)
{
    if (QMdiSubWindow *child = subWindowOf(form)) {
        if (child->isMinimized())
            child->showNormal();
        mUi->Children->setActiveSubWindow(child);
    } else {
        form->show();
        form->activateWindow();
    }
}

QMdiSubWindow *MainScreen::subWindowOf(Form *form) const
{
    return qobject_cast<QMdiSubWindow *>(form->parentWidget());
}

void MainScreen::bringToFront()
{
    if (!mStarted)
        return; // by the timer step, which comes after what the start still has to say
    setWindowState(windowState() & ~Qt::WindowMinimized);
    show();
    raise();
    activateWindow();
}

void MainScreen::closeEvent(QCloseEvent *event)
{
    event->setAccepted(Unload());
}

// A screen that is busy keeps all others open: nothing is lost before the user has decided.
bool MainScreen::unloadChildren(bool forced)
{
    Form *busy = forced ? nullptr : Form::busyForm();
    if (busy) {
        bringUp(busy);
        informationBox(GetMessage("xBusy"));
        return false;
    }
    return Form::UnloadAll(u"frmSplash"_s, forced);
}

bool MainScreen::Unload(bool forced)
{
    if (mUnloaded)
        return true;
    if (mUnloading)
        return false; // a screen is being asked
    const QScopedValueRollback<bool> unloading(mUnloading, true);
    if (!unloadChildren(forced))
        return false;
    mUnloaded = true;
    mTimer1->stop();
    closeCatalogue();
    const auto forms = Form::openForms();
    for (Form *form : forms)
        form->Unload(); // the splash
    emit unloaded();
    return true;
}

void MainScreen::closeCatalogue()
{
    if (mDatabaseMissing)
        return;
    try {
        CleanOrphans();
        gConnection->Close();
    } catch (const Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
        gConnection->RollbackTrans();
    }
}
