#include "mp3/importascd.h"

#include "catalogue/quoting.h"
#include "catalogue/songs.h"
#include "mp3/importascdrows.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "platform/text/textrules.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

enum class Outcome { Nothing, Imported, Cancelled };

QString albumsWithTitle(const QString &title, qint64 artist)
{
    return u"select '1' from CDTitels where Titel = "_s + quoted(title) + u" and Artiest_ID = "_s +
           QString::number(artist);
}

QString titlesWithTitle(const QString &title)
{
    return u"select '1' from CDTitels where Titel = "_s + quoted(title);
}

// By design: the names in the questions have their apostrophes doubled, as the statements do.
QString albumQuestion(const DiscOfRows &disc)
{
    return GetMessage("QuestImpAlbPart1") + doubled(disc.artist) + GetMessage("QuestImpAlbPart2") +
           doubled(disc.title) + GetMessage("QuestImpAlbPart3");
}

QString compilationQuestion(const DiscOfRows &disc)
{
    return GetMessage("QuestImpMainTitlePart1") + doubled(disc.title) +
           GetMessage("QuestImpMainTitlePart2");
}

bool mayDouble(const QString &statement, const QString &question)
{
    return gConnection->Execute(statement).RecordCount() == 0 || askYesNoCancel(question) == vbYes;
}

/// Writes the tracks of a disc one behind the other.
class TrackWriter
{
public:
    TrackWriter(Songs &songs, const DiscOfRows &disc, qint64 title)
        : mSongs(songs), mDisc(disc), mTitle(title)
    {
    }

    void write(const DiscOfRows::Track &track, qint64 artist);

private:
    qint64 findOrMake(const DiscOfRows::Track &track, qint64 artist);

    Songs &mSongs;
    const DiscOfRows &mDisc;
    const qint64 mTitle;
    qint64 mNumber = 0, mLastDisc = 0;
};

void TrackWriter::write(const DiscOfRows::Track &track, qint64 artist)
{
    ++mNumber;
    const qint64 id = findOrMake(track, artist);
    const qint64 disc = mDisc.isSet ? discNumber(track.partOfSet) : 1;
    if (disc != mLastDisc)
        mNumber = 1;
    mSongs.makeLink({mTitle, disc, mNumber, id});
    mLastDisc = disc;
}

// By design: a track that is there keeps its genre and year, whatever the tag says; and an
// apostrophe in the genre of a new one is not doubled, so it breaks the statement.
qint64 TrackWriter::findOrMake(const DiscOfRows::Track &track, qint64 artist)
{
    const std::string title = track.title.toStdString();
    if (const auto found = mSongs.findTrack(artist, title))
        return *found;
    const std::string genre = undoubled(*gConnection, track.genre.toStdString());
    const std::string year = text::isNumeric(track.year) ? track.year.toStdString() : std::string();
    return mSongs.makeTrack(artist, title, textOrNull(genre), wholeOrNull(year));
}

qint64 makeTitle(Songs &songs, const DiscOfRows &disc, std::optional<qint64> artist)
{
    const qint64 id = nextId(Table::CDTitels);
    const std::string title = disc.title.toStdString();
    songs.makeTitle({id, title, artist});
    return id;
}

bool writeAlbum(const DiscOfRows &disc)
{
    Songs songs(*gConnection);
    const qint64 artist = songs.findOrMakeArtist(disc.artist.toStdString());
    if (!mayDouble(albumsWithTitle(disc.title, artist), albumQuestion(disc)))
        return false;
    TrackWriter writer(songs, disc, makeTitle(songs, disc, artist));
    for (const DiscOfRows::Track &track : disc.tracks)
        writer.write(track, artist);
    return true;
}

bool writeCompilation(const DiscOfRows &disc)
{
    if (!mayDouble(titlesWithTitle(disc.title), compilationQuestion(disc)))
        return false;
    Songs songs(*gConnection);
    TrackWriter writer(songs, disc, makeTitle(songs, disc, {}));
    for (const DiscOfRows::Track &track : disc.tracks)
        writer.write(track, songs.findOrMakeArtist(track.artist.toStdString()));
    return true;
}

// In one transaction. After a failure nothing of it is left when the user is told.
Outcome write(const DiscOfRows &disc)
{
    ADODB::Transaction transaction(*gConnection);
    try {
        const bool written = disc.isAlbum ? writeAlbum(disc) : writeCompilation(disc);
        if (written)
            transaction.CommitTrans();
        else
            transaction.RollbackTrans();
        return written ? Outcome::Imported : Outcome::Cancelled;
    } catch (...) {
        transaction.RollbackTrans();
        throw;
    }
}

bool isWanted(const DiscOfRows &disc)
{
    const char *const question = disc.isAlbum ? "AdAlbumToDatabase" : "AddCompilationToDatabase";
    return askYesNo(GetMessage(question)) == vbYes &&
           (disc.isSet || askYesNo(GetMessage("NotCreateBoxSet")) == vbYes);
}

// What fails is told, and nothing of it is in the catalogue then.
Outcome import(const QString &collectionTitle, const std::vector<CollectionRow> &rows)
{
    try {
        const DiscOfRows disc = discOf(rows, collectionTitle);
        return isWanted(disc) ? write(disc) : Outcome::Nothing;
    } catch (const RowRefused &refused) {
        errorBox(GetMessage("ErrorAtRow") + QString::number(refused.row) +
                 GetMessage(refused.artistMissing ? "NameArtistAdjustTag" : "TrackAdjustTag"));
    } catch (const Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
    return Outcome::Nothing;
}

void tellImported(Form &screen)
{
    refreshBrowser();
    screen.repaint();
    Desktop::current().pump();
    informationBox(GetMessage("CDImported"));
}

} // namespace

void importAsCD(Form &screen, const QString &collectionTitle,
                const std::vector<CollectionRow> &rows)
{
    if (!LongWork::mayBegin(screen))
        return;
    const LongWork work(screen);
    Outcome outcome;
    {
        const Hourglass hourglass(&screen);
        outcome = import(collectionTitle, rows);
    }
    if (outcome == Outcome::Imported)
        tellImported(screen);
    if (outcome == Outcome::Cancelled)
        informationBox(GetMessage("MsgImpCancel"));
}
