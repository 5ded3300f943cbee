// The saving of CdEditor: what is checked, what goes into the transaction, and what becomes of a
// record that somebody else has deleted.

#include "collection/cdeditor.h"

#include "catalogue/cleanorphans.h"
#include "catalogue/ids.h"
#include "controls/tracks/trackgrid.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "services/browser.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

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
    if (!header.year.isEmpty() && !mFields->ValidateYear())
        return false;
    return mRecord.state() != HeldRecord::State::Lost ||
           askYesNo(GetMessage("xSaveAnew"), windowTitle()) == vbYes;
}

// The head and the tracks go in one transaction; the clean-up has its own, and follows a save that
// was taken back as well.
void CdEditor::write(const Header &header, bool reload)
{
    const bool isNew = Mode == modeNew;
    if (!isNew && Mode != modeExisting)
        throw Error(0, Name(), QString());
    const bool anew = isNew || !mRecord.isStored();
    const qint64 earlyId = anew && mKind.idBeforeTransaction ? nextId(Table::CDTitels) : 0;
    ADODB::Transaction transaction(*gConnection);
    const bool another = !anew && !mRecord.isThere(CdId);
    mSaveFailed = another;
    if (!another) {
        writeTitle(anew, earlyId, header);
        const bool gridChanged = mControls.disk->IsChanged();
        Desktop::current().pump();
        mControls.disk->SaveDisc();
        mSaveFailed = mControls.disk->HasError();
        if (!mSaveFailed)
            commit(transaction, header, reload, anew || gridChanged);
    }
    if (mSaveFailed)
        transaction.RollbackTrans();
    if (another)
        loseRecord("xOtherRecord");
    CleanOrphans();
    if (!mSaveFailed)
        mRecord.know(CdId); // one without tracks is swept
}

// A row that has gone comes back under another id, whole.
void CdEditor::writeTitle(bool anew, qint64 newId, const Header &header)
{
    beforeTitle(header);
    if (!anew) {
        if (header != mSaved)
            gConnection->Execute(updateTitle(CdId, header));
        afterTitle(header, mSaved);
        return;
    }
    CdId = newId ? newId : nextId(Table::CDTitels);
    gConnection->Execute(insertTitle(CdId, header));
    mControls.disk->setCdId(CdId);
    if (mRecord.state() == HeldRecord::State::Lost)
        mControls.disk->ForgetSaved();
    mRecord.writeKeptDiscs(CdId, mControls.disk->DiscNo(), artists());
}

void CdEditor::commit(ADODB::Transaction &transaction, const Header &header, bool reload,
                      bool tracksChanged)
{
    HeldRecord written = mRecord;
    written.know(CdId);
    transaction.CommitTrans();
    mRecord = written;
    mCopy.drop();
    showLost(false);
    committed(header,
              tracksChanged || header.title != mSaved.title || header.artist != mSaved.artist,
              reload);
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
        Desktop::current().pump();
    }
    mSaved = asStored(header);
    mFields->show(mSaved);
    takeFocus();
}

// False if the record is not what it was; nothing is removed then.
bool CdEditor::removeDisc()
{
    if (mRecord.state() == HeldRecord::State::Swept)
        return true; // none of its discs is in the catalogue
    ADODB::Transaction transaction(*gConnection);
    if (mRecord.isThere(CdId)) {
        mControls.disk->RemoveDisc();
        transaction.CommitTrans();
        return true;
    }
    transaction.RollbackTrans();
    loseRecord("xRecordDeleted");
    return false;
}

void CdEditor::loseRecord(const char *message)
{
    if (mRecord.isStored())
        mRecord.setLost();
    showLost(true);
    errorBox(GetMessage(message));
}

void CdEditor::showLost(bool lost)
{
    const QString mark = u" - "_s + GetMessage("xDeletedMark");
    const QString plain = windowTitle().remove(mark);
    setWindowTitle(lost ? plain + mark : plain);
}

bool CdEditor::holds(qint64 id) const
{
    return CdId == id && Mode == modeExisting && mRecord.isStored();
}

void CdEditor::keepForAnew()
{
    mRecord.keepDiscs(CdId, artists());
}

void CdEditor::recordDeleted()
{
    mRecord.setLost();
    showLost(true);
}

TrackStore::Artists CdEditor::artists() const
{
    return mControls.fields.artist ? TrackStore::Artists::OfTitle : TrackStore::Artists::OfTracks;
}
