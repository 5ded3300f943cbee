#include "mp3/frmCDRootMP3.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "mp3/collectionfolder.h"
#include "mp3/ui_frmCDRootMP3.h"
#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/captions.h"
#include "services/clsRegistry.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QKeyEvent>
#include <QSignalBlocker>

using namespace Qt::StringLiterals;

namespace
{

constexpr QLatin1String modeNew("I");
constexpr qint64 noCollection = -999;
constexpr qsizetype longestFolder = 255;

// Tenths of the width of the list.
const std::vector<ListColumn> listColumns = {{ListColumn::Number, "Volgnummer", 1},
                                             {ListColumn::Text, "FileName", 4},
                                             {ListColumn::Text, "Album", 4},
                                             {ListColumn::Text, "Artist", 3},
                                             {ListColumn::Text, "Title", 4},
                                             {ListColumn::Text, "TrackPosition", 1},
                                             {ListColumn::Text, "PartOfSet", 1},
                                             {ListColumn::Text, "Year", 1},
                                             {ListColumn::Text, "Genre", 1},
                                             {ListColumn::Text, "CopyRightHolder", 1},
                                             {ListColumn::Text, "Label", 1},
                                             {ListColumn::Text, "Comments", 1},
                                             {ListColumn::Hidden},
                                             {ListColumn::Hidden}};
constexpr int tenths = 10;

} // namespace

frmCDRootMP3::frmCDRootMP3() : Form(u"frmCDRootMP3"_s), mUi(std::make_unique<Ui::frmCDRootMP3>())
{
    mUi->setupUi(this);
    mColumns = new ListColumns(mUi->TheMP3Collection, listColumns, tenths);
    setCancelButton(mUi->cmdCancel);
    setCaptions();
    connectControls();
    connectList();
}

frmCDRootMP3::~frmCDRootMP3() = default;

void frmCDRootMP3::setCaptions()
{
    applyCaptions(this, {{"frmCDRootMP3", "xMP3Collection"},
                         {"lblFolder", "MP3Map"},
                         {"lblTitle", "NaamTitel"},
                         {"cmdAdd", "AddFile"},
                         {"cmdBrowse", "BrowseFolder"},
                         {"cmdCancel", "CancelMP3collection"},
                         {"cmdOK", "MP3CollectionGereed"},
                         {"cmdUpdateID3", "UpdateID3Tag"},
                         {"cmdTagWizard", "TagWizard"},
                         {"cmdImportAsCD", "ImportAsCD"},
                         {"cmdDelete", "DeleteMP3FileFromCollection"},
                         {"cmdRefreshList", "RefreshList"},
                         {"cmdRename", "Rename"},
                         {"cmdPreview", "xPreviewNames"},
                         {"TheMP3Collection", "UseRightMouseButtonToDragDrop", Caption::ToolTip}});
    mUi->TheMP3Collection->setAccessibleName(GetMessage("xMP3Files"));
}

void frmCDRootMP3::connectControls()
{
    const auto on = [this](QPushButton *button, auto routine) {
        connect(button, &QPushButton::clicked, this, routine);
    };
    on(mUi->cmdBrowse, [this] { command([this] { cmdBrowse_Click(); }); });
    on(mUi->cmdAdd, &frmCDRootMP3::cmdAdd_Click);
    on(mUi->cmdScan, [this] { command([this] { cmdScan_Click(); }); });
    on(mUi->cmdDelete, &frmCDRootMP3::cmdDelete_Click);
    on(mUi->cmdRefreshList, [this] { command([this] { cmdRefreshList_Click(); }); });
    on(mUi->cmdRename, &frmCDRootMP3::cmdRename_Click);
    on(mUi->cmdPreview, &frmCDRootMP3::cmdPreview_Click);
    on(mUi->cmdUpdateID3, &frmCDRootMP3::cmdUpdateID3_Click);
    on(mUi->cmdTagWizard, &frmCDRootMP3::cmdTagWizard_Click);
    on(mUi->cmdImportAsCD, &frmCDRootMP3::cmdImportAsCD_Click);
    on(mUi->cmdOK, &frmCDRootMP3::cmdOK_Click);
    on(mUi->cmdCancel, &Form::Unload);
    connect(mUi->txtFolder, &QLineEdit::textChanged, this, &frmCDRootMP3::ValidateFolderAndTitle);
    connect(mUi->txtTitel, &QLineEdit::textChanged, this, &frmCDRootMP3::ValidateFolderAndTitle);
    connect(mUi->txtFolder, &QLineEdit::editingFinished, this, &frmCDRootMP3::txtFolder_Validate);
    mUi->txtFolder->installEventFilter(this);
    mUi->txtTitel->installEventFilter(this);
}

void frmCDRootMP3::connectList()
{
    DBListViewCTL *list = mUi->TheMP3Collection;
    list->setMayBeUnselected(true);
    connect(list, &DBListViewCTL::SelectionCleared, this, &frmCDRootMP3::SyncSelection);
    connect(list, &DBListViewCTL::ItemClick, this, &frmCDRootMP3::list_ItemClick);
    connect(list, &DBListViewCTL::DblClick, this, &frmCDRootMP3::cmdUpdateID3_Click);
    connect(list, &DBListViewCTL::KeyUp, this, &frmCDRootMP3::list_KeyUp);
    connect(list, &DBListViewCTL::MouseDown, this,
            [this](int button, int, int x, int y) { list_MouseDown(button, x, y); });
    connect(list, &DBListViewCTL::DragOver, this,
            [this](QObject *, int x, int y) { list_DragOver(x, y); });
    connect(list, &DBListViewCTL::DragDrop, this, &frmCDRootMP3::list_DragDrop);
    list->installEventFilter(this);
}

void frmCDRootMP3::Form_Load()
{
    const Freeze freeze(this);
    FormReady = false;
    RedrawLocked = false;
    CurrentRow = 1;
    makeRoomInFrame(this);
    placeInFrame(this, 0.25, 0);
    LoadCollection();
    if (!LoadedTitle.isEmpty())
        setWindowTitle(windowTitle() + u" - "_s + LoadedTitle);
    FormReady = true;
    FilesAdded = false;
}

void frmCDRootMP3::LoadCollection()
{
    const Hourglass hourglass(this);
    if (Mode == modeNew)
        CollectionId = noCollection; // of which there are no rows
    mStored = collectionstore::header(CollectionId);
    if (mStored) {
        mUi->txtFolder->setText(mStored->folder);
        mUi->txtTitel->setText(mStored->title);
    }
    mRows.load(CollectionId);
    RefreshAndHandleButtons();
    LoadedFolder = LastGoodFolder = mUi->txtFolder->text();
    LoadedTitle = mUi->txtTitel->text();
}

void frmCDRootMP3::collectionDeleted()
{
    mStored.reset();
    setWindowTitle(windowTitle() + u" - "_s + GetMessage("xDeletedMark"));
}

// Blanks around a folder's name do not count, as DirExists has it.
QString frmCDRootMP3::folder() const
{
    return mUi->txtFolder->text().trimmed();
}

// As the program sets it: no change of the user's.
void frmCDRootMP3::setFolder(const QString &folder)
{
    const QSignalBlocker quiet(mUi->txtFolder);
    mUi->txtFolder->setText(folder);
}

void frmCDRootMP3::txtFolder_Validate()
{
    if (mUi->txtFolder->text() != LastGoodFolder && isFolderThere(*this, folder()).value_or(false))
        LastGoodFolder = mUi->txtFolder->text();
}

bool frmCDRootMP3::asksToClear() const
{
    return askYesNo(GetMessage("QuestClearMP3List")) == vbYes;
}

void frmCDRootMP3::ValidateFolderAndTitle()
{
    if (!FormReady)
        return;
    const bool hasRows = mRows.count() > 0, hasTitle = !mUi->txtTitel->text().isEmpty();
    const auto isThere = isFolderThere(*this, folder());
    if (!isThere) { // nobody waited for the answer
        if (hasRows)
            setFolder(LastGoodFolder);
        setButtons(hasRows ? ButtonState::InvalidHeader : ButtonState::NoRows, false);
    } else if (hasRows && !*isThere) {
        if (asksToClear())
            mRows.removeAll();
        else
            setFolder(LastGoodFolder);
        RefreshAndHandleButtons();
    } else if (hasRows && !hasTitle) {
        errorBox(GetMessage("NameTitleNotOptional"));
        setNoButtons();
    } else {
        setButtons(hasRows ? ButtonState::AllThere : ButtonState::NoRows, hasTitle && *isThere);
    }
}

void frmCDRootMP3::cmdBrowse_Click()
{
    const QString before = mUi->txtFolder->text();
    clsRegistry settings;
    QString start = settings.GetValue(settingsReadKey, u"LastDir"_s).toString();
    if (start.isEmpty())
        start = Desktop::current().programFolder();
    const QString chosen =
        BrowseForFolderDialog(GetMessage("MapSelecteren"), before.isEmpty() ? start : before);
    if (!chosen.isEmpty() && chosen != before && !changeFolder(before, chosen))
        return;
    // By design: a dialog that was cancelled stores the empty text.
    settings.CreateKey(settingsKey);
    settings.SetValue(settingsKey, u"LastDir"_s, chosen);
}

bool frmCDRootMP3::changeFolder(const QString &from, const QString &to)
{
    if (to.size() > longestFolder) {
        errorBox(GetMessage("NumberOfCharactersExceeded"));
        return false;
    }
    const bool hasRows = mRows.count() > 0;
    const bool changes = !hasRows || asksToClear();
    LastGoodFolder = changes ? to : from;
    setFolder(LastGoodFolder);
    if (!hasRows) {
        ValidateFolderAndTitle();
        return true;
    }
    if (changes)
        mRows.removeAll();
    RefreshAndHandleButtons();
    return changes;
}

void frmCDRootMP3::cmdRefreshList_Click()
{
    mRows.readAnew();
    RedrawLocked = true;
    RefreshAndHandleButtons();
    SyncSelection();
    mUi->TheMP3Collection->setFocus();
    RedrawLocked = false;
}

void frmCDRootMP3::RefreshAndHandleButtons()
{
    LongWork work(*this, GetMessage("xReadingTags"));
    Desktop::current().pump();
    if (RedrawLocked)
        Desktop::current().freeze(this);
    gTagsChanged = mFilesChanged = false;
    const auto reading = mRows.read(folder(), work);
    mColumns->show(mRows.WorkingRecords);
    const bool isValid = reading.folderExists && !mUi->txtTitel->text().isEmpty();
    setButtons(mRows.count() == 0  ? ButtonState::NoRows
               : !isValid          ? ButtonState::InvalidHeader
               : !reading.allExist ? ButtonState::FileMissing
                                   : ButtonState::AllThere,
               isValid);
    if (RedrawLocked)
        Desktop::current().freeze(nullptr); // what is told is told over the list as it is now
    if (!isUnloaded()) {
        if (!reading.unreadable.isEmpty())
            tellUnreadable(reading.unreadable);
        if (!reading.allExist && isValid)
            warningBox(GetMessage("OneOrMoreFilesDoNotExist"));
        if (!reading.allExist)
            markMissingFiles();
    }
    RestoreListPosition();
}

void frmCDRootMP3::setButtons(ButtonState state, bool isHeaderValid)
{
    using enum ButtonState;
    const bool hasRows = state != NoRows, isValid = state == AllThere || state == FileMissing;
    const bool allThere = state == AllThere;
    const bool mayAdd = allThere || (state == NoRows && isHeaderValid);
    mUi->TheMP3Collection->setEnabled(isValid);
    mUi->cmdBrowse->setEnabled(true);
    mUi->cmdAdd->setEnabled(mayAdd);
    mUi->cmdScan->setEnabled(mayAdd);
    enableTagScreens(allThere, false);
    mUi->cmdImportAsCD->setEnabled(allThere);
    mUi->cmdDelete->setEnabled(hasRows);
    mUi->cmdRefreshList->setEnabled(hasRows);
    mUi->cmdRename->setEnabled(isValid);
    mUi->cmdPreview->setEnabled(isValid);
    mUi->cmdOK->setEnabled(allThere);
    mUi->cmdCancel->setEnabled(true);
}

// But those that lead out of here.
void frmCDRootMP3::setNoButtons()
{
    enableTagScreens(false, false);
    for (QPushButton *button : {mUi->cmdAdd, mUi->cmdScan, mUi->cmdImportAsCD, mUi->cmdDelete,
                                mUi->cmdRefreshList, mUi->cmdRename, mUi->cmdPreview, mUi->cmdOK})
        button->setEnabled(false);
    mUi->cmdCancel->setEnabled(true);
}

// Those of a folder that is not there too: a medium may have taken it along.
void frmCDRootMP3::markMissingFiles()
{
    for (qsizetype row = 0; row < mRows.count(); ++row) {
        if (!mRows.isMissing(row))
            continue;
        const ListItem item = mUi->TheMP3Collection->ListItems().Item(int(row) + 1);
        item.setBold(true);
        item.setForeColor(Qt::red);
    }
}

void frmCDRootMP3::tellUnreadable(const QStringList &names)
{
    constexpr qsizetype mostNames = 10;
    QString text = GetMessage("xTagsUnreadable");
    for (const QString &name : names.first(std::min(names.size(), mostNames)))
        text += u'\r' + name;
    if (names.size() > mostNames)
        text += u"\r..."_s;
    warningBox(text);
}

void frmCDRootMP3::RestoreListPosition()
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    const int count = list.ListItems().Count();
    if (count < 1)
        return;
    CurrentRow = std::clamp(CurrentRow, 1, count);
    const ListItem item = list.ListItems().Item(CurrentRow);
    list.setSelectedItem(item);
    item.EnsureVisible();
}

// The box of an earlier press may still stand open.
// A refresh handles events, and within the toolkit's own activation the window before may go away.
void frmCDRootMP3::Form_Activate()
{
    if (gTagsChanged || mFilesChanged)
        QMetaObject::invokeMethod(this, &frmCDRootMP3::activate, Qt::QueuedConnection);
    else
        activate();
}

void frmCDRootMP3::activate()
{
    if (isUnloaded())
        return;
    DragActive = false;
    if (!FormReady || isBusy() || !mUi->TheMP3Collection->isEnabled())
        return;
    SyncSelection();
    if (gTagsChanged || mFilesChanged)
        RefreshAndHandleButtons();
    const QWidget *focus = focusWidget();
    const bool wasClicked = focus && focus->underMouse() && qApp->mouseButtons() != Qt::NoButton;
    if (!wasClicked)
        mUi->TheMP3Collection->setFocus();
}

void frmCDRootMP3::followNames(const RenamedFiles &renamed)
{
    mRows.followNames(renamed, folder());
    mFilesChanged = true;
}

bool frmCDRootMP3::eventFilter(QObject *watched, QEvent *event)
{
    const bool isKey =
        event->type() == QEvent::KeyPress || event->type() == QEvent::ShortcutOverride;
    if (!isKey)
        return Form::eventFilter(watched, event);
    const auto &key = static_cast<QKeyEvent &>(*event);
    const bool pressed = event->type() == QEvent::KeyPress;
    const bool moves = key.modifiers().testFlag(Qt::AltModifier) &&
                       (key.key() == Qt::Key_Up || key.key() == Qt::Key_Down);
    if (watched == mUi->TheMP3Collection && moves) {
        if (pressed)
            moveCurrentBy(key.key() == Qt::Key_Up ? -1 : 1);
        event->accept();
        return true;
    }
    if (watched != mUi->TheMP3Collection && key.matches(QKeySequence::Undo)) {
        if (pressed && watched == mUi->txtFolder)
            mUi->txtFolder->setText(LastGoodFolder);
        else if (pressed)
            mUi->txtTitel->setText(LoadedTitle);
        event->accept();
        return true;
    }
    return Form::eventFilter(watched, event);
}

void frmCDRootMP3::cmdOK_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    if (save())
        Unload();
}

bool frmCDRootMP3::save()
{
    const Busy busy(*this);
    Desktop::current().setPointer(this, vbHourglass);
    bool saved = false;
    try {
        saved = write({folder(), mUi->txtTitel->text()});
        Desktop::current().setPointer(this, vbDefault);
    } catch (const Error &error) {
        Desktop::current().setPointer(this, vbDefault);
        errorBox(QString::number(error.Number) + u": "_s + error.Description);
        gConnection->RollbackTrans();
    }
    return saved;
}

// A collection that somebody has deleted meanwhile is entered anew at the next press: its id may be
// another's by then.
bool frmCDRootMP3::write(const collectionstore::Header &header)
{
    const bool isNew = Mode == modeNew;
    const bool headerChanged =
        isNew || header != collectionstore::Header{LoadedFolder, LoadedTitle};
    const bool rowsChanged = isNew || HasRecordSetChanged();
    ADODB::Transaction transaction(*gConnection);
    const auto isThere = [this] {
        return mStored && collectionstore::header(CollectionId) == mStored;
    };
    if (!isNew && (headerChanged || rowsChanged || !mStored) && !isThere()) {
        transaction.RollbackTrans();
        Mode = modeNew;
        errorBox(GetMessage("xOtherCollection"));
        return false;
    }
    qint64 id = CollectionId;
    if (isNew)
        id = collectionstore::insertHeader(header);
    else if (headerChanged)
        collectionstore::updateHeader(id, header);
    if (rowsChanged)
        collectionstore::replaceFiles(id, *mRows.WorkingRecords->rows());
    transaction.CommitTrans();
    CollectionId = id;
    if (headerChanged) {
        refreshBrowser();
        repaint();
        Desktop::current().pump();
    }
    return true;
}
