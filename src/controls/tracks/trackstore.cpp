#include "controls/tracks/trackstore.h"

#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "platform/text/normalform.h"

#include <algorithm>

namespace
{

constexpr std::string_view selectTracksOfDisc =
    "select cds.ID as ID, art.Naam as Artiest, trk.Titel as Titel, "
    "trk.Genre as Genre, trk.Hitjaar as Hitjaar "
    "from CompactDiscs cds, Tracks trk "
    "left join Artiesten art on art.ID = trk.Artiest_ID "
    "where trk.ID = cds.Track_ID and cds.CDTitels_ID = ? and cds.DiskNo = ? "
    "order by cds.TrackNo, cds.ID";
constexpr std::string_view selectLinks =
    "select ID, TrackNo, Track_ID from CompactDiscs where CDTitels_ID = ? and DiskNo = ?";
constexpr std::string_view selectTitle = "select Artiest_ID from CDTitels where ID = ?";
constexpr std::string_view selectName = "select Naam from Artiesten where ID = ?";
constexpr std::string_view selectTrack = "select Titel, Genre, Hitjaar from Tracks where ID = ?";
constexpr std::string_view updateTrack =
    "update Tracks set Titel = ?, Genre = ?, Hitjaar = ? where ID = ?";
constexpr std::string_view selectOtherHolder =
    "select ID from CompactDiscs where Track_ID = ? and not (CDTitels_ID = ? and DiskNo = ?) "
    "limit 1";
constexpr std::string_view updateLink =
    "update CompactDiscs set TrackNo = ?, Track_ID = ? where ID = ?";
constexpr std::string_view deleteLink = "delete from CompactDiscs where ID = ?";
constexpr std::string_view deleteDisc =
    "delete from CompactDiscs where CDTitels_ID = ? and DiskNo = ?";
constexpr std::string_view moveDiscsUp =
    "update CompactDiscs set DiskNo = DiskNo - 1 where CDTitels_ID = ? and DiskNo > ?";

bool sameYear(const QString &a, const QString &b)
{
    return a == b || (!a.isEmpty() && !b.isEmpty() && a.toDouble() == b.toDouble());
}

ADODB::Parameter genreOf(const TrackTexts &texts)
{
    return texts[GenreField].isEmpty() ? ADODB::Parameter(nullptr) : texts[GenreField];
}

ADODB::Parameter yearOf(const TrackTexts &texts)
{
    return wholeOrNull(texts[YearField].toStdString());
}

// What the row of a track would say if it were the track's own. An empty cell says nothing unless
// it was emptied: a song typed once more without its genre must not take the genre away.
TrackTexts wanted(const TrackToSave &track, const TrackTexts &found)
{
    TrackTexts texts = found;
    texts[TitleField] = track.texts[TitleField];
    for (const TrackField field : {GenreField, YearField}) {
        if (!track.texts[field].isEmpty() || !track.was[field].isEmpty())
            texts[field] = track.texts[field];
    }
    if (sameYear(texts[YearField], found[YearField]))
        texts[YearField] = found[YearField];
    return texts;
}

bool nothingToDo(const QList<TrackToSave> &tracks, const QList<qint64> &was, const auto &links)
{
    return std::equal(tracks.begin(), tracks.end(), was.begin(), was.end(),
                      [&](const TrackToSave &track, qint64 link) {
                          return track.linkId == link && !track.changed && links.contains(link);
                      });
}

} // namespace

ADODB::Recordset TrackStore::run(std::string_view statement,
                                 std::initializer_list<ADODB::Parameter> values) const
{
    return ADODB::Command(mConnection, statement).Execute(values);
}

QList<StoredTrack> TrackStore::load() const
{
    const auto rows = run(selectTracksOfDisc, {mCdId, mDiscNo}).rows();
    QList<StoredTrack> tracks;
    for (qsizetype row = 0; row < rows->rowCount(); ++row) {
        StoredTrack track{rows->id(row, 0), {}};
        for (int field = 0; field < trackFields; ++field)
            track.texts[std::size_t(field)] = rows->text(row, 1 + field);
        tracks.append(track);
    }
    return tracks;
}

TrackStore::Outcome TrackStore::save(const QList<TrackToSave> &tracks, const QList<qint64> &was)
{
    Outcome outcome;
    const Links links = readLinks();
    if (nothingToDo(tracks, was, links)) {
        outcome.linkIds = was;
        return outcome;
    }
    outcome.refused = !tracks.isEmpty() && !readTitle();
    if (outcome.refused)
        return outcome;
    mSettled.clear();
    mSongs.emplace(mConnection);
    deleteLinks(tracks, was, links);
    for (qsizetype place = 0; place < tracks.size(); ++place)
        outcome.linkIds.append(write(tracks[place], place, links, outcome));
    return outcome;
}

// As they are now: the screen may have moved them to another artist's tracks, and what was loaded
// may be gone.
TrackStore::Links TrackStore::readLinks() const
{
    ADODB::Recordset answer = run(selectLinks, {mCdId, mDiscNo});
    Links links;
    for (; !answer.isEOF(); answer.MoveNext()) {
        const auto number = [&](int column) {
            const ADODB::Value value = answer.Fields(column).Value();
            return value.isNull() ? 0 : value.toLong();
        };
        links.insert(number(0), {number(1), number(2)});
    }
    return links;
}

bool TrackStore::readTitle()
{
    ADODB::Recordset answer = run(selectTitle, {mCdId});
    if (answer.isEOF())
        return false;
    const ADODB::Value artist = answer.Fields(0).Value();
    mTitleArtist = artist.isNull() ? 0 : artist.toLong();
    return mArtists == Artists::OfTracks || !artist.isNull();
}

void TrackStore::deleteLinks(const QList<TrackToSave> &tracks, const QList<qint64> &was,
                             const Links &links)
{
    QSet<qint64> kept;
    for (const TrackToSave &track : tracks)
        kept.insert(track.linkId);
    for (const qint64 link : was) {
        if (!kept.contains(link) && links.contains(link))
            run(deleteLink, {link});
    }
}

qint64 TrackStore::write(const TrackToSave &track, qsizetype place, const Links &links,
                         Outcome &outcome)
{
    const auto link = links.constFind(track.linkId);
    const bool linked = link != links.cend();
    qint64 trackId = linked ? link->trackId : 0;
    if (!linked || track.changed) {
        bool otherSpelling = false, keptValues = false;
        trackId = trackOf(artistOf(track.texts, otherSpelling), track, keptValues);
        if (keptValues)
            outcome.keptValues.append(place);
        if (otherSpelling)
            outcome.keptArtists.append(place);
    }
    const qint64 number = place + 1;
    if (!linked)
        return mSongs->makeLink({mCdId, mDiscNo, number, trackId});
    if (link->trackNo != number || link->trackId != trackId)
        run(updateLink, {number, trackId, track.linkId});
    return track.linkId;
}

qint64 TrackStore::artistOf(const TrackTexts &texts, bool &otherSpelling)
{
    if (mArtists == Artists::OfTitle)
        return mTitleArtist;
    const QByteArray name = text::nfc(texts[ArtistField]);
    const qint64 id = mSongs->findOrMakeArtist(name.toStdString());
    const auto rows = run(selectName, {id}).rows();
    otherSpelling = rows->text(0, 0).toUtf8() != name;
    return id;
}

qint64 TrackStore::trackOf(qint64 artistId, const TrackToSave &track, bool &keptValues)
{
    const auto id = mSongs->findTrack(artistId, track.texts[TitleField].toStdString());
    if (!id)
        return addTrack(artistId, track.texts);
    const TrackTexts found = readTrack(*id);
    const TrackTexts texts = wanted(track, found);
    const bool settled = mSettled.contains(*id);
    mSettled.insert(*id);
    if (texts == found)
        return *id;
    keptValues = settled || heldElsewhere(*id);
    if (!keptValues)
        run(updateTrack, {texts[TitleField], genreOf(texts), yearOf(texts), *id});
    return *id;
}

TrackTexts TrackStore::readTrack(qint64 id) const
{
    const auto rows = run(selectTrack, {id}).rows();
    TrackTexts texts;
    for (const TrackField field : {TitleField, GenreField, YearField})
        texts[field] = rows->text(0, field - TitleField);
    return texts;
}

qint64 TrackStore::addTrack(qint64 artistId, const TrackTexts &texts)
{
    const qint64 id =
        mSongs->makeTrack(artistId, texts[TitleField].toStdString(), genreOf(texts), yearOf(texts));
    mSettled.insert(id);
    return id;
}

bool TrackStore::heldElsewhere(qint64 trackId) const
{
    return run(selectOtherHolder, {trackId, mCdId, mDiscNo}).RecordCount() > 0;
}

void TrackStore::remove()
{
    ADODB::Transaction transaction(mConnection);
    try {
        run(deleteDisc, {mCdId, mDiscNo});
        run(moveDiscsUp, {mCdId, mDiscNo});
        transaction.CommitTrans();
    } catch (const Error &) {
        transaction.RollbackTrans();
        throw;
    }
}
