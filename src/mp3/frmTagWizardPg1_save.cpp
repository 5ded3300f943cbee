#include "controls/list/DBListViewCTL.h"
#include "discdata/cddbtagmanager.h"
#include "mp3/frmTagWizardPg1.h"
#include "mp3/tagrow.h"
#include "mp3/ui_frmTagWizardPg1.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/globals.h"
#include "services/messages.h"
#include "tags/tagerrors.h"

#include <QDir>

using namespace Qt::StringLiterals;

// The rows of the Tags Processor into their files.

/// What has become of the files.
struct frmTagWizardPg1::Saved {
    int files = 0;                // that hold their tag now
    QStringList missing;          // full names
    bool notAccessible = false;   // one or more
    std::optional<Error> failure; // the first of any other kind
    bool cancelled = false;
};

CddbID3Tag frmTagWizardPg1::tagOfRow(int row) const
{
    const ListItem item = mUi->TheFileList->ListItems().Item(row);
    CddbID3Tag tag;
    for (int n = tagrow::firstTag; const TagField field : tagrow::fields)
        tag.setField(field, item.SubItems(n++));
    return tag;
}

void frmTagWizardPg1::cmdSaveTags_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    Saved saved;
    try {
        const Hourglass hourglass(this);
        save(saved);
    } catch (const Error &error) { // the journal cannot be kept
        saved.failure = error;
    }
    if (tellSaved(saved))
        Unload();
}

// All rows, checked or not. What is missing now, or cannot be written, does not keep the others.
void frmTagWizardPg1::save(Saved &saved)
{
    std::vector<std::pair<QString, CddbID3Tag>> tags;
    for (int row = 1; row <= rowCount(); ++row) {
        const QString path = pathOf(row);
        if (FileExists(path))
            tags.emplace_back(path, tagOfRow(row));
        else
            saved.missing.append(path);
    }
    LongWork work(*this, GetMessage("xSavingTags"));
    const CddbTagManager::Batch batch(*mTagManager, QDir(Folder).path(), tags);
    for (const auto &[path, tag] : tags) {
        if (work.isCancelled())
            break;
        saveOne(path, tag, saved);
        work.step(saved.files, qint64(tags.size()));
    }
    saved.cancelled = work.isCancelled() && saved.files < int(tags.size());
}

void frmTagWizardPg1::saveOne(const QString &path, const CddbID3Tag &tag, Saved &saved)
{
    try {
        mTagManager->SaveTagToFile(tag, path, 1);
        ++saved.files;
        gTagsChanged = true;
    } catch (const Error &error) {
        if (error.Number == errTagNotAccessible && FileExists(path))
            saved.notAccessible = true;
        else if (error.Number == errTagNotAccessible)
            saved.missing.append(path); // gone in this moment
        else if (!saved.failure)
            saved.failure = error;
    }
}

// Whether the screen is through: what could not be written, and what the user has stopped, stays in
// the list to be saved once more.
bool frmTagWizardPg1::tellSaved(const Saved &saved)
{
    for (const QString &path : saved.missing)
        errorBox(GetMessage("MP3ProcCouldNotSaveMP3TagPart1") + path +
                 GetMessage("MP3ProcCouldNotSaveMP3TagPart2"));
    if (saved.notAccessible)
        errorBox(GetMessage("MP3ProcFileNotAccessed"));
    if (saved.failure)
        errorBox(saved.failure->numbered(), GetMessage("MsgSysErr"));
    if (saved.cancelled)
        informationBox(GetMessage("xTagsCancelledPart1") + QString::number(saved.files) +
                       GetMessage("xTagsCancelledPart2") + QString::number(rowCount()) +
                       GetMessage("xTagsCancelledPart3"));
    if (saved.notAccessible || saved.failure || saved.cancelled)
        return false;
    if (saved.missing.isEmpty())
        informationBox(GetMessage("MP3ProcAllTagsSaved"));
    else
        warningBox(GetMessage("MP3ProcNotAllTagsSaved"));
    return true;
}
