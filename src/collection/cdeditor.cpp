#include "collection/cdeditor.h"

#include "catalogue/cleanorphans.h"
#include "catalogue/ids.h"
#include "collection/disctabs.h"
#include "controls/tracks/trackgrid.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "services/browser.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QAction>
#include <QComboBox>
#include <QLineEdit>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QToolBar>
#include <QToolButton>

using namespace Qt::StringLiterals;

namespace
{

const auto modeNew = "I"_L1, modeExisting = "U"_L1;

const auto nextTitleId = u"Select max(id) + 1 as N from CDTitels"_s;
const auto idField = "N"_L1;

// Buttons of the toolbar, counted from 0, that need the focus in the grid.
constexpr int insertTrack = 3, deleteTrack = 4, previousTrack = 10;

void pump()
{
    Desktop::current().pump();
}

// To the control that has the focus, which need not be the grid.
void send(const char *keys)
{
    Desktop::current().sendKeys(QLatin1String(keys));
}

} // namespace

CdEditor::CdEditor(const QString &name) : Form(name) {}

void CdEditor::setUp(const Controls &controls, const Kind &kind)
{
    mControls = controls;
    mKind = kind;
    mFields = new HeaderFields(controls.fields, this);
    setCancelButton(controls.cancel);
    (controls.fields.artist ? controls.fields.artist : controls.fields.title)->setFocus();
    controls.toolbar->setAccessibleName(GetMessage("xToolbar"));
    connect(controls.discs, &DiscTabs::left, this, &CdEditor::DiscsTab_Click);
    connect(controls.cancel, &QPushButton::clicked, this, &CdEditor::cmdCancel_Click);
    connectFields();
    connectDisk();
    connectToolbar();
}

void CdEditor::connectFields()
{
    connect(mFields, &HeaderFields::firstTrackWanted, this, &CdEditor::GoToFirstTrack);
    connect(mFields, &HeaderFields::lastTrackWanted, this, &CdEditor::GoToLastTrack);
    connect(mFields, &HeaderFields::newDiscWanted, this, [this] { command(&CdEditor::AddDisc); });
    connect(mFields, &HeaderFields::discDeletionWanted, this,
            [this] { command(&CdEditor::DeleteDiscLocked); });
}

void CdEditor::connectDisk()
{
    TrackGrid *disk = mControls.disk;
    connect(disk, &TrackGrid::GotFocus, this, [this] { setDiskHasFocus(true); });
    connect(disk, &TrackGrid::LostFocus, this, [this] { setDiskHasFocus(false); });
    connect(disk, &TrackGrid::LockScreen, this, &freezeFrame);
    connect(disk, &TrackGrid::UnlockScreen, this, &releaseFrame);
    connect(disk, &TrackGrid::LeaveForward, this, [this] { behindLastTrack()->setFocus(); });
    connect(disk, &TrackGrid::LeaveBackward, this, [this] { mControls.fields.year->setFocus(); });
    connect(disk, &TrackGrid::RequestSave, this, &CdEditor::SaveKeepingPosition);
    connect(disk, &TrackGrid::RequestAddDisc, this, [this] { command(&CdEditor::AddDisc); });
    connect(disk, &TrackGrid::RequestDeleteDisc, this,
            [this] { command(&CdEditor::DeleteDiscLocked); });
}

// The toolbar lines up with the fields. Its buttons take no focus: the keys that they send go to
// the control that has it.
void CdEditor::connectToolbar()
{
    applyCaptions(this, {{"tbInsertDisc", "TTInsertCD"},
                         {"tbDeleteDisc", "TTDeleteCD"},
                         {"tbSaveDiscs", "TTSave"},
                         {"tbInsertTrack", "TTInsertTrack"},
                         {"tbDeleteTrack", "TTDeleteTrack"},
                         {"tbFirstTrack", "TTFirstTrack"},
                         {"tbLastTrack", "TTLastTrack"},
                         {"tbNextField", "TTNextField"},
                         {"tbPrevField", "TTPrevField"},
                         {"tbNextTrack", "TTNextTrack"},
                         {"tbPrevTrack", "TTPrevTrack"}});
    mControls.toolbar->layout()->setContentsMargins(0, 0, 0, 0);
    for (QToolButton *button : mControls.toolbar->findChildren<QToolButton *>())
        button->setFocusPolicy(Qt::NoFocus);
    const auto actions = mControls.toolbar->actions();
    const auto on = [this, &actions](int button, auto routine) {
        connect(actions.at(button), &QAction::triggered, this, routine);
    };
    on(0, [this] { command(&CdEditor::AddDisc); });
    on(1, [this] { command(&CdEditor::DeleteDiscLocked); });
    on(2, &CdEditor::SaveKeepingPosition);
    on(insertTrack, [] { send("Ins"); });
    on(deleteTrack, [] { send("End"); });
    on(5, &CdEditor::GoToFirstTrack);
    on(6, &CdEditor::GoToLastTrack);
    on(7, [] { send("Tab"); });
    on(8, [] { send("Shift+Tab"); });
    on(9, &CdEditor::GoToNextTrack);
    on(previousTrack, [] { send("Up"); });
}

// A command of the user; none is begun while another handles events.
void CdEditor::command(Routine routine)
{
    if (mBusy)
        return;
    const QScopedValueRollback<bool> busy(mBusy, true);
    try {
        (this->*routine)();
    } catch (const Error &error) {
        if (gConnection)
            gConnection->RollbackTrans();
        releaseFrame();
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}

void CdEditor::Form_Load()
{
    setDiskHasFocus(false);
    mPositionSaved = mCloseSilently = false;
    makeRoomInFrame(this);
    placeInFrame(this, mKind.left, 0);
    mControls.disk->setLanguage(gLanguage);
    mFields->show(mSaved);
    try {
        load();
    } catch (const Error &error) {
        errorBox(QString::number(error.Number) + u' ' + error.Description, GetMessage("MsgSysErr"));
    }
}

void CdEditor::load()
{
    if (!gConnection)
        throw makeError(errObjectClosed);
    if (Mode == modeNew)
        loadNew();
    else if (Mode != modeExisting)
        refuseToLoad(mKind.unknownMode);
    else if (CdId < 1)
        refuseToLoad(GetMessage("MsgInitFalse"));
    else
        loadRecord();
}

void CdEditor::refuseToLoad(const QString &why)
{
    errorBox(why, GetMessage("MsgSysErr"));
    Unload();
}

// The grid must not show the tracks of another record: an id that was given for a save which failed
// may belong to one by now.
void CdEditor::loadNew()
{
    mSaved = {};
    mFields->show(mSaved);
    mControls.discs->setCount(1);
    mControls.disk->setConnection(gConnection.get());
    mControls.disk->setCdId(0);
    mControls.disk->setDiscNo(1);
    mControls.disk->LoadDisc();
}

// The grid first: it then shows disc 1 of this record, and so does the tab, also when the record
// turns out to be gone.
void CdEditor::loadRecord()
{
    mControls.discs->setCount(1);
    ShowDisc(1);
    ADODB::Recordset record;
    record.Open(selectRecord(CdId), *gConnection);
    mSaved = headerOf(record);
    mFields->show(mSaved);
    const qint64 discs = record.Fields(u"DiscNum").Value().toLong();
    mControls.discs->setCount(std::max(1, int(discs)));
}

Header CdEditor::headerOf(ADODB::Recordset &record) const
{
    const auto text = [&record](QStringView field) {
        return record.Fields(field).Value().toText();
    };
    return {mControls.fields.artist ? text(u"Artiest") : QString(), text(u"CDTitle"),
            text(u"Genre"), text(u"Hitjaar")};
}

void CdEditor::ShowDisc(int number)
{
    mControls.disk->setCdId(CdId);
    mControls.disk->setDiscNo(number);
    mControls.disk->setConnection(gConnection.get());
    mControls.disk->LoadDisc();
}

void CdEditor::RememberDiskPosition()
{
    mPositionSaved = mDiskHasFocus;
    if (!mDiskHasFocus)
        return;
    pump();
    mSavedColumn = mControls.disk->CurrentColumn();
    mSavedRow = mControls.disk->CurrentRow();
}

void CdEditor::RestoreDiskPosition()
{
    if (!std::exchange(mPositionSaved, false))
        return;
    if (mSaveFailed && mControls.disk->HasError())
        return; // the grid has put the cursor on the cell that it refused
    mSavedRow = std::max(1, mSavedRow);
    mSavedColumn = std::max(1, mSavedColumn);
    mControls.disk->setCurrentRow(mSavedRow);
    pump();
    mControls.disk->setCurrentColumn(mSavedColumn);
    pump();
}

QString CdEditor::withPosition(const Error &error) const
{
    return QString::number(error.Number) + u'-' + error.Description + u" ( "_s +
           QString::number(mSavedColumn) + u" - "_s + QString::number(mSavedRow) + u')';
}

void CdEditor::SaveAtUserRequest(bool Reload)
{
    if (mBusy)
        return;
    const QScopedValueRollback<bool> busy(mBusy, true);
    save(Reload);
}

// By design: an error of the database does not set mSaveFailed. It has been told, and who called
// goes on as after a success.
void CdEditor::save(bool reload)
{
    mSaveFailed = false;
    const auto setPointer = [this](PointerShape shape) {
        Desktop::current().setPointer(this, shape);
    };
    setPointer(vbHourglass);
    try {
        const Header header = mFields->shown();
        mSaveFailed = !canBeSaved(header);
        if (!mSaveFailed)
            write(header, reload);
        setPointer(vbDefault);
    } catch (const Error &error) {
        setPointer(vbDefault);
        releaseFrame();
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
        if (gConnection)
            gConnection->RollbackTrans();
    }
}

bool CdEditor::canBeSaved(const Header &header)
{
    if (const char *gap = gapIn(header)) {
        Desktop::current().setPointer(this, vbDefault);
        errorBox(GetMessage(gap));
        return false;
    }
    return header.year.isEmpty() || mFields->ValidateYear();
}

// The head and the tracks go in one transaction; the clean-up has its own, and follows a save that
// was taken back as well.
void CdEditor::write(const Header &header, bool reload)
{
    const bool isNew = Mode == modeNew;
    if (!isNew && Mode != modeExisting)
        throw Error(0, Name(), QString());
    if (!gConnection)
        throw makeError(errObjectClosed);
    const qint64 earlyId = isNew && mKind.idBeforeTransaction ? nextId(nextTitleId, idField) : 0;
    ADODB::Transaction transaction(*gConnection);
    const TitleRow row = isNew ? TitleRow::New : findTitleRow();
    bool listsChange =
        row == TitleRow::Gone || header.title != mSaved.title || header.artist != mSaved.artist;
    mSaveFailed = row == TitleRow::Anothers;
    if (!mSaveFailed) {
        writeTitle(row, earlyId, header);
        listsChange |= mControls.disk->IsChanged();
        pump();
        mControls.disk->SaveDisc();
        mSaveFailed = mControls.disk->HasError();
    }
    if (mSaveFailed) {
        transaction.RollbackTrans();
    } else {
        transaction.CommitTrans();
        committed(header, listsChange, reload);
    }
    if (row == TitleRow::Anothers)
        errorBox(GetMessage("xOtherRecord"));
    CleanOrphans();
}

// The row may have been deleted by the browser, or swept after a save without tracks, and its id
// given to another record. One that says what was last saved here is ours.
CdEditor::TitleRow CdEditor::findTitleRow() const
{
    ADODB::Recordset answer;
    answer.Open(selectIsOwn(CdId, mSaved), *gConnection);
    if (answer.isEOF())
        return TitleRow::Gone;
    return answer.Fields(0).Value().toLong() ? TitleRow::Ours : TitleRow::Anothers;
}

// A row that has gone is put back under its id: links without a title must not arise.
void CdEditor::writeTitle(TitleRow row, qint64 newId, const Header &header)
{
    beforeTitle(header);
    if (row == TitleRow::New)
        CdId = newId ? newId : nextId(nextTitleId, idField);
    if (row != TitleRow::Ours)
        gConnection->Execute(insertTitle(CdId, header));
    else if (header != mSaved)
        gConnection->Execute(updateTitle(CdId, header));
    if (row == TitleRow::New)
        mControls.disk->setCdId(CdId);
    else
        afterTitle(header, mSaved);
}

// By design: genre and year stand in no list, so a change of theirs alone refreshes none.
void CdEditor::committed(const Header &header, bool listsChange, bool reload)
{
    Mode = modeExisting;
    if (reload)
        mControls.disk->LoadDisc();
    if (listsChange) {
        refreshBrowser();
        takeFocus();
        pump();
    }
    mSaved = header;
    takeFocus();
}

void CdEditor::takeFocus()
{
    if (isVisible())
        Show();
}

void CdEditor::SaveKeepingPosition()
{
    command(&CdEditor::saveCommand);
}

void CdEditor::saveCommand()
{
    freezeFrame();
    try {
        RememberDiskPosition();
        pump();
        save(true);
        pump();
        RestoreDiskPosition();
    } catch (const Error &error) {
        errorBox(withPosition(error), mKind.positionTitle);
    }
    releaseFrame();
}

// The user's own; one that comes in while another's events are handled is taken back.
void CdEditor::DiscsTab_Click(int leftBehind)
{
    if (mBusy) {
        mControls.discs->showTab(leftBehind);
        return;
    }
    const QScopedValueRollback<bool> busy(mBusy, true);
    changeDisc(leftBehind);
}

// As a click on the tab does.
void CdEditor::goToTab(int tab)
{
    const int leftBehind = mControls.discs->currentIndex();
    if (tab == leftBehind)
        return;
    mControls.discs->showTab(tab);
    changeDisc(leftBehind);
}

void CdEditor::GoToTrack(int disc, int track)
{
    if (mBusy || disc < 1 || disc > mControls.discs->count())
        return;
    const QScopedValueRollback<bool> busy(mBusy, true);
    goToTab(disc - 1);
    if (mControls.discs->currentIndex() != disc - 1)
        return; // the disc that showed could not be saved, and stays
    mControls.disk->setCurrentRow(track);
    mControls.disk->setCurrentColumn(1);
    focusDisk();
}

// By design: the disc left behind is saved without a question; and after an error the hourglass
// stays.
void CdEditor::changeDisc(int leftBehind)
{
    Desktop::current().setPointer(this, vbHourglass);
    freezeFrame();
    try {
        RememberDiskPosition();
        save(false);
        if (mSaveFailed) {
            informationBox(GetMessage("MsgDiscNav"));
            mControls.discs->showTab(leftBehind);
            RestoreDiskPosition();
        } else {
            ShowDisc(mControls.discs->currentIndex() + 1);
            mControls.disk->setCurrentRow(1);
            mControls.disk->setCurrentColumn(1);
        }
        releaseFrame();
        Desktop::current().setPointer(this, vbDefault);
    } catch (const Error &error) {
        errorBox(withPosition(error), GetMessage("MsgSysErr"));
        releaseFrame();
    }
}

// A disc is in the catalogue only once it has a track: until then the tab alone stands for it.
void CdEditor::AddDisc()
{
    freezeFrame();
    pump();
    RememberDiskPosition();
    save(true);
    pump();
    if (mSaveFailed) {
        informationBox(GetMessage("MsgAddDisc"));
        RestoreDiskPosition();
        pump();
    } else {
        mControls.discs->add();
        goToTab(mControls.discs->count() - 1); // which shows the disc
        pump();
    }
    releaseFrame();
}

void CdEditor::DeleteDiscLocked()
{
    freezeFrame();
    pump();
    DeleteDisc();
    pump();
    releaseFrame();
}

// By design: nothing is asked, and what was typed in the head since the last save goes too.
void CdEditor::DeleteDisc()
{
    if (mControls.discs->count() == 1) {
        RememberDiskPosition();
        errorBox(GetMessage("MsgDiscDel"));
        RestoreDiskPosition();
        return;
    }
    const QScopedValueRollback<bool> deleting(mDeletingDisc, true);
    const bool inDisk = mDiskHasFocus;
    const int tab = mControls.discs->currentIndex();
    mControls.disk->RemoveDisc();
    mCloseSilently = true;
    Reload();
    if (inDisk)
        focusDisk();
    goToTab(std::min(tab, mControls.discs->count() - 1));
    if (mDiskHasFocus) {
        mControls.disk->setCurrentRow(1);
        mControls.disk->setCurrentColumn(1);
    }
    CleanOrphans();
    refreshBrowser();
    pump();
    takeFocus();
    pump();
}

// A reason that does not stop at an empty year.
void CdEditor::focusDisk()
{
    mControls.disk->setFocus(Qt::ShortcutFocusReason);
}

void CdEditor::GoToFirstTrack()
{
    if (!mDiskHasFocus)
        focusDisk();
    send("PgUp");
}

void CdEditor::GoToLastTrack()
{
    if (!mDiskHasFocus)
        focusDisk();
    send("PgDown");
}

// By design: without the focus in the grid this only moves it there.
void CdEditor::GoToNextTrack()
{
    if (mDiskHasFocus)
        send("Down");
    else
        focusDisk();
}

void CdEditor::setDiskHasFocus(bool has)
{
    mDiskHasFocus = has;
    const auto actions = mControls.toolbar->actions();
    for (const int button : {insertTrack, deleteTrack, previousTrack})
        actions.at(button)->setEnabled(has);
}

// By design: nothing is asked here, whatever has changed.
void CdEditor::cmdCancel_Click()
{
    if (mBusy)
        return;
    mCloseSilently = true;
    Unload();
}

bool CdEditor::isChanged() const
{
    return mControls.disk->IsChanged() || mFields->shown() != mSaved;
}

bool CdEditor::QueryUnload()
{
    if (mBusy && !mDeletingDisc)
        return false;
    const QScopedValueRollback<bool> busy(mBusy, true);
    RememberDiskPosition();
    if (!mCloseSilently && !saveBeforeClosing())
        return false;
    if (!mDeletingDisc)
        releaseFrame();
    return true;
}

// False if the user wants to save and the save was refused.
bool CdEditor::saveBeforeClosing()
{
    freezeFrame();
    if (!isChanged() || askYesNo(GetMessage("QuestSaveChanges")) != vbYes)
        return true;
    if (mDiskHasFocus)
        mControls.disk->CommitEdit();
    save(false);
    if (!mSaveFailed)
        return true;
    errorBox(GetMessage("MsgWindowCannotBeClosed"));
    RestoreDiskPosition();
    releaseFrame();
    return false;
}
