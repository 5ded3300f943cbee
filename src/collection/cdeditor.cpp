#include "collection/cdeditor.h"

#include "catalogue/cleanorphans.h"
#include "collection/disctabs.h"
#include "collection/trackbuttons.h"
#include "controls/tracks/trackgrid.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/modalloop.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QAction>
#include <QComboBox>
#include <QLayout>
#include <QLineEdit>
#include <QPushButton>
#include <QScopedValueRollback>
#include <QTimer>
#include <QToolBar>
#include <QToolButton>

using namespace Qt::StringLiterals;

namespace
{

constexpr int copyInterval = 1000; // milliseconds

void pump()
{
    Desktop::current().pump();
}

} // namespace

CdEditor::CdEditor(const QString &name) : Form(name), mCopyTimer(new QTimer(this))
{
    mCopyTimer->setObjectName(u"RecoveryTimer"_s);
    mCopyTimer->setInterval(copyInterval);
    connect(mCopyTimer, &QTimer::timeout, this, &CdEditor::keepCopy);
}

void CdEditor::setUp(const Controls &controls, const Kind &kind)
{
    mControls = controls;
    mKind = kind;
    mFields = new HeaderFields(controls.fields, this);
    mTracks = new TrackButtons(controls.disk, controls.toolbar, this);
    mPosition.setDisk(controls.disk);
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
    connect(mFields, &HeaderFields::firstTrackWanted, mTracks, &TrackButtons::GoToFirstTrack);
    connect(mFields, &HeaderFields::lastTrackWanted, mTracks, &TrackButtons::GoToLastTrack);
    connect(mFields, &HeaderFields::newDiscWanted, this,
            [this] { command([this] { AddDisc(); }); });
    connect(mFields, &HeaderFields::discDeletionWanted, this,
            [this] { command([this] { DeleteDiscLocked(); }); });
}

void CdEditor::connectDisk()
{
    TrackGrid *disk = mControls.disk;
    connect(disk, &TrackGrid::LockScreen, this, &freezeFrame);
    connect(disk, &TrackGrid::UnlockScreen, this, &releaseFrame);
    connect(disk, &TrackGrid::LeaveForward, this, [this] { behindLastTrack()->setFocus(); });
    connect(disk, &TrackGrid::LeaveBackward, this, [this] { mControls.fields.year->setFocus(); });
    connect(disk, &TrackGrid::RequestSave, this, &CdEditor::SaveKeepingPosition);
    connect(disk, &TrackGrid::RequestAddDisc, this, [this] { command([this] { AddDisc(); }); });
    connect(disk, &TrackGrid::RequestDeleteDisc, this,
            [this] { command([this] { DeleteDiscLocked(); }); });
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
    on(0, [this] { command([this] { AddDisc(); }); });
    on(1, [this] { command([this] { DeleteDiscLocked(); }); });
    on(2, &CdEditor::SaveKeepingPosition); // those behind it are mTracks'
}

// A command of the user; none is begun while another handles events.
void CdEditor::command(const std::function<void()> &routine)
{
    if (!LongWork::mayBegin(*this))
        return;
    const LongWork work(*this);
    try {
        routine();
    } catch (const Error &error) {
        gConnection->RollbackTrans();
        releaseFrame();
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}

void CdEditor::Form_Load()
{
    mTracks->setDiskHasFocus(false);
    mPosition.forget();
    mCloseSilently = false;
    makeRoomInFrame(this);
    placeInFrame(this, mKind.left, 0);
    mCopyTimer->start();
    mDropCopy = false;
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
    mRecord.begin();
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
    mRecord.know(CdId);
    mSaved = headerOf(record);
    mFields->show(mSaved);
    mControls.discs->setCount(record.Fields(u"DiscNum").Value().toLong());
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
    mPosition.forget();
    if (mTracks->diskHasFocus())
        mPosition.remember();
}

void CdEditor::RestoreDiskPosition()
{
    if (mSaveFailed && mControls.disk->HasError())
        mPosition.forget(); // the grid has put the cursor on the cell that it refused
    mPosition.restore();
}

QString CdEditor::withPosition(const Error &error) const
{
    return QString::number(error.Number) + u'-' + error.Description + mPosition.text();
}

void CdEditor::SaveAtUserRequest(bool Reload)
{
    if (!LongWork::mayBegin(*this))
        return;
    const LongWork work(*this);
    save(Reload);
}

void CdEditor::takeFocus()
{
    if (isVisible())
        Show();
}

void CdEditor::SaveKeepingPosition()
{
    command([this] { saveCommand(); });
}

void CdEditor::saveCommand()
{
    freezeFrame();
    try {
        RememberDiskPosition();
        save(true);
        RestoreDiskPosition();
    } catch (const Error &error) {
        errorBox(withPosition(error), mKind.positionTitle);
    }
    releaseFrame();
}

// The user's own; one that comes in while another's events are handled is taken back.
void CdEditor::DiscsTab_Click(int leftBehind)
{
    if (!LongWork::mayBegin(*this)) {
        mControls.discs->showTab(leftBehind);
        return;
    }
    const LongWork work(*this);
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
    if (disc < 1 || disc > mControls.discs->count() || !LongWork::mayBegin(*this))
        return;
    const LongWork work(*this);
    goToTab(disc - 1);
    if (mControls.discs->currentIndex() != disc - 1)
        return; // the disc that showed could not be saved, and stays
    mControls.disk->setCurrentRow(track);
    mControls.disk->setCurrentColumn(1);
    mTracks->focusDisk();
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
    RememberDiskPosition();
    save(true);
    if (mSaveFailed) {
        informationBox(GetMessage("MsgAddDisc"));
        RestoreDiskPosition();
    } else {
        mControls.discs->add();
        goToTab(mControls.discs->count() - 1); // which shows the disc
    }
    pump();
    releaseFrame();
}

void CdEditor::DeleteDiscLocked()
{
    freezeFrame();
    pump();
    DeleteDisc();
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
    const bool inDisk = mTracks->diskHasFocus();
    const int tab = mControls.discs->currentIndex();
    if (!removeDisc())
        return;
    mCloseSilently = true;
    Reload();
    if (inDisk)
        mTracks->focusDisk();
    goToTab(std::min(tab, mControls.discs->count() - 1));
    if (mTracks->diskHasFocus()) {
        mControls.disk->setCurrentRow(1);
        mControls.disk->setCurrentColumn(1);
    }
    CleanOrphans();
    mRecord.know(CdId);
    refreshBrowser();
    pump();
    takeFocus();
}

// By design: nothing is asked here, whatever has changed.
void CdEditor::cmdCancel_Click()
{
    if (isBusy())
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
    if (!mCloseSilently && isChanged() && !LongWork::mayBegin(*this))
        return false;
    const Busy asking(*this);
    mDropCopy = true;
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
    if (!isChanged())
        return true;
    if (askYesNo(GetMessage("QuestSaveChanges")) != vbYes) {
        mDropCopy = !modalWasRefused(); // a person's answer, not the end of the program
        return true;
    }
    if (mTracks->diskHasFocus())
        mControls.disk->CommitEdit();
    save(false);
    if (!mSaveFailed)
        return true;
    errorBox(GetMessage("MsgWindowCannotBeClosed"));
    RestoreDiskPosition();
    releaseFrame();
    return false;
}

void CdEditor::Form_Unload()
{
    mCopyTimer->stop();
    if (mDropCopy)
        mCopy.drop();
    else
        keepCopy();
}

UnsavedRecord CdEditor::unsaved() const
{
    const bool held = Mode == modeExisting && mRecord.isStored();
    return {artists() == TrackStore::Artists::OfTitle,
            held ? CdId : 0,
            mRecord.content(),
            mFields->shown(),
            mControls.disk->DiscNo(),
            mControls.disk->Tracks(),
            mRecord.keptDiscs()};
}

// Between two states of a command there is nothing to keep.
void CdEditor::keepCopy()
{
    if (isBusy())
        return;
    mDropCopy = false; // of a close that did not come about
    if (isChanged())
        mCopy.keep(unsaved());
    else
        mCopy.drop();
}

void CdEditor::restore(const UnsavedRecord &record, const QString &copy)
{
    mCopy.adopt(copy);
    if (Mode == modeNew)
        mRecord.beginAnew(record.otherDiscs);
    const int others = record.otherDiscs.isEmpty() ? 1 : record.otherDiscs.lastKey();
    mControls.discs->setCount(std::max({record.disc, others, mControls.discs->count()}));
    mControls.discs->showTab(record.disc - 1);
    mControls.disk->setCdId(Mode == modeNew ? 0 : CdId);
    mControls.disk->setDiscNo(record.disc);
    mControls.disk->LoadDisc();
    mControls.disk->ShowUnsaved(record.tracks);
    mFields->show(record.header);
}
