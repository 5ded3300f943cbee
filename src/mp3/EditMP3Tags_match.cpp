#include "discdata/cddbcontrol.h"
#include "discdata/cddbtagmanager.h"
#include "discdata/discservice.h"
#include "mp3/EditMP3Tags.h"
#include "mp3/frmMatchWithSongcase.h"
#include "mp3/frmTracks.h"
#include "mp3/matchchoice.h"
#include "mp3/matchtags.h"
#include "mp3/ui_EditMP3Tags.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/messages.h"
#include "tags/filenameparts.h"

// The tag editor filled from the services, or from the catalogue.

void EditMP3Tags::cmdMatchFileWithCDDB_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    try {
        matchWithCddb();
    } catch (const Error &error) {
        if (error.Number != errLookupCancelled) // by the user himself
            errorBox(error.numbered());
    }
}

void EditMP3Tags::matchWithCddb()
{
    CddbDiscPtr disc = lookUp();
    if (!disc) {
        const CddbMatchListPtr matches = mControl->GetFileMatches();
        if (!matches) {
            errorBox(GetMessage("NoMatchFoundForThisFile"));
            return;
        }
        disc = chosenOf(matches);
    }
    if (disc && MatchedTrack >= 1 && !isUnloaded())
        substitute(*disc);
}

// By the identifier of the file only where the user wants so.
CddbDiscPtr EditMP3Tags::lookUp()
{
    const QString fileId = TagObject.FileId();
    const bool byId = !fileId.isEmpty() &&
                      askYesNo(GetMessage("FileAlreadyContainsID"), GetMessage("IDFound")) == vbYes;
    const Hourglass hourglass(this);
    return byId ? mControl->LookupByFileId(fileId, 0, MatchedTrack)
                : TagManager->LookupByFile(TagFilePath, 0, MatchedTrack);
}

// By design: whatever goes wrong here ends without a word.
CddbDiscPtr EditMP3Tags::chosenOf(const CddbMatchListPtr &matches)
{
    try {
        CddbDiscPtr disc = mControl->ShowFuzzyDialog(matches);
        if (!disc || isUnloaded())
            return nullptr;
        disc = mControl->GetFullDisc(disc, 0);
        auto *tracks = new frmTracks;
        tracks->setDisc(disc);
        tracks->ShowModal();
        MatchedTrack = tracks->TrackNum();
        return disc;
    } catch (const Error &) {
        return nullptr;
    }
}

void EditMP3Tags::substitute(const CddbDisc &disc)
{
    const CddbID3Tag tag = TagManager->TagForTrack(disc, MatchedTrack);
    if (!differsFrom(tag)) {
        informationBox(GetMessage("TagInfoNotDifferent"));
        return;
    }
    showTag(tag);
    informationBox(GetMessage("TagItemsHaveBeenSubstituted"));
}

void EditMP3Tags::cmdMatchFileWithSongCase_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    try {
        matchWithCatalogue();
    } catch (const Error &error) {
        plainBox(error.numbered());
    }
}

// What the tag does not say the names of file and folder may.
void EditMP3Tags::matchWithCatalogue()
{
    const FileNameParts name = filenameParts(TagFilePath);
    const QString artist = mUi->txtArtist->text().trimmed();
    const QString title = mUi->txtTitle->text().trimmed();
    auto &search = defaultInstance<frmMatchWithSongcase>();
    search.NumberOfTracks = -99;
    search.ChooseTracks = true;
    search.Artist =
        !artist.isEmpty() ? artist : (name.artist.isEmpty() ? name.albumArtist : name.artist);
    search.Title = !title.isEmpty() || name.albumArtist.isEmpty() ? title : name.album;
    const int number = mUi->txtTrack->text().section(u'/', 0, 0).toInt();
    search.Track = number > 0 ? number : name.track;
    search.ShowModal();
    Desktop::current().pump();
    if (!gMatchChosen || isUnloaded())
        return;
    showTag(tagOfTrack(gMatchCDId, gMatchDiscNo, gMatchTrackNo));
    informationBox(GetMessage("MP3ProcTagItemsSubstituted"));
}
