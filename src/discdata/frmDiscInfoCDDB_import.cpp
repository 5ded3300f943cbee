#include "discdata/cddbcontrol.h"
#include "discdata/discimport.h"
#include "discdata/frmDiscInfoCDDB.h"
#include "discdata/frmWhatNow.h"
#include "discdata/mmcontrol.h"
#include "discdata/ui_frmDiscInfoCDDB.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

// What can be done with the disc on show: import, edit, send.

namespace
{

// Throws errTypeMismatch for a text that is no number.
qint64 number(const QString &text)
{
    return ADODB::Value(text).toLong();
}

bool isBlank(const QString &text)
{
    return text.trimmed().isEmpty();
}

} // namespace

// By design: a number field that holds none is caught nowhere here.
void frmDiscInfoCDDB::cmdImport_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    QString answer = u"1"_s;
    {
        const Form::Busy busy(*this);
        const Hourglass hourglass(this);
        if (const char *refusal = importRefusal()) {
            errorBox(GetMessage(QLatin1String(refusal)));
            return;
        }
        if (!isComplete()) {
            frmWhatNow &question = defaultInstance<frmWhatNow>();
            question.ShowModal();
            answer = question.Answer;
        }
        if (answer == u'1')
            ImportDisc();
    }
    if (answer == u'2')
        mUi->cmdUpdateInfo->click();
}

// The first of the checks that fails, as the key of what is told.
const char *frmDiscInfoCDDB::importRefusal() const
{
    const QString disc = mUi->txtDiscNo->text(), total = mUi->txtTotalDiscs->text();
    if (disc.isEmpty())
        return "MsgDiscNoEmpty";
    if (total.isEmpty())
        return "MsgTotalDiscsEmpty";
    if (number(disc) < 1)
        return "MsgInvalidDiscNo";
    if (number(total) < number(disc))
        return "MsgInvalidDiscValues"; // by design: no text has this key
    if (mUi->OptCmpNo->isChecked() && isBlank(mUi->txtArtist->text()))
        return "MsgArtistEmpty";
    if (isBlank(mUi->txtTitle->text()))
        return mUi->OptCmpNo->isChecked() ? "MsgTitleEmpty" : "MsgCompTitleEmpty";
    return nullptr;
}

// Whether each track has a title and, on a compilation, an artist.
bool frmDiscInfoCDDB::isComplete() const
{
    const bool withArtist = mUi->OptCmpYes->isChecked();
    if (mTrackRows->RecordCount() == 0)
        return true;
    for (mTrackRows->MoveFirst(); !mTrackRows->isEOF(); mTrackRows->MoveNext()) {
        if (isBlank(mTrackRows->Fields(u"Titel").Value().toText()))
            return false;
        if (withArtist && isBlank(mTrackRows->Fields(u"Artiest").Value().toText()))
            return false;
    }
    return true;
}

void frmDiscInfoCDDB::ImportDisc()
{
    DiscImport import({mUi->txtArtist->text(), mUi->txtTitle->text(), mUi->txtGenre->text(),
                       mUi->txtYear->text(), mDisc->NumberInSet(), mDisc->TotalInSet(),
                       mTrackRows});
    const bool imported =
        mUi->OptCmpYes->isChecked() ? import.ImportCompilation() : import.ImportAlbum();
    if (!imported)
        return;
    refreshBrowser();
    activateWindow();
    mUi->cmdImport->setFocus();
    informationBox(GetMessage("MsgCDDBImported"));
}

void frmDiscInfoCDDB::cmdUpdateInfo_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    const Form::Busy busy(*this);
    mEditFlags = 2;
    mEditFlags = TheCDDB->ShowEditDialog(mDisc, 2);
    Desktop::current().pump();
    if (mEditFlags & cddbChanged)
        ShowDiscInfo(mDisc);
}

// By design: whether there is something to send goes by the last edit alone, so a record as it came
// is never sent back, and a changed one once.
void frmDiscInfoCDDB::cmdSubmitDisc_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    const Form::Busy busy(*this);
    if (!(mEditFlags & cddbChanged)) {
        informationBox(GetMessage("DataNotSent"));
        return;
    }
    try {
        TheCDDB->SubmitDisc(mDisc, 0);
        informationBox(GetMessage("UpdatedDataSent"));
        mEditFlags = 1;
    } catch (const Error &error) {
        plainBox(error.Description);
    }
}
