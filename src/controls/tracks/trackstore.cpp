#include "controls/tracks/trackstore.h"

#include "catalogue/ids.h"
#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

using Literal = QLatin1String;

QString digits(qint64 number)
{
    return QString::number(number);
}

QString whereDisc(qint64 cdId, int discNo)
{
    return Literal(" where CDTitels_ID = ") + digits(cdId) + Literal(" and DiskNo = ") +
           digits(discNo);
}

QString selectTracksOfDisc(qint64 cdId, int discNo)
{
    return Literal("select cds.ID as ID, art.Naam as Artiest, trk.Titel as Titel, "
                   "trk.Genre as Genre, trk.Hitjaar as Hitjaar "
                   "from CompactDiscs cds, Tracks trk "
                   "left join Artiesten art on art.ID = trk.Artiest_ID "
                   "where trk.ID = cds.Track_ID and cds.CDTitels_ID = ") +
           digits(cdId) + Literal(" and cds.DiskNo = ") + digits(discNo) +
           Literal(" order by cds.TrackNo, cds.ID");
}

QString selectLinks(qint64 cdId, int discNo)
{
    return Literal("select ID, TrackNo, Track_ID from CompactDiscs") + whereDisc(cdId, discNo);
}

QString selectTitle(qint64 cdId)
{
    return Literal("select Artiest_ID from CDTitels where ID = ") + digits(cdId);
}

QString selectArtist(const QString &name)
{
    return Literal("SELECT id, Naam FROM Artiesten where Naam = ") + quoted(name);
}

QString insertArtist(qint64 id, const QString &name)
{
    return Literal("Insert into artiesten(id,naam) values (") + digits(id) + u',' + quoted(name) +
           u')';
}

QString selectTrack(qint64 artistId, const QString &title)
{
    return Literal("SELECT id, Titel, Genre, Hitjaar From Tracks where artiest_id = ") +
           digits(artistId) + Literal(" and Titel = ") + quoted(title);
}

QString insertTrack(qint64 id, qint64 artistId, const TrackTexts &texts)
{
    return Literal("Insert into Tracks(id,artiest_id,titel,genre,hitjaar) values (") + digits(id) +
           u',' + digits(artistId) + u',' + quoted(texts[TitleField]) + u',' +
           quotedOrNull(texts[GenreField]) + u',' + numberOrNull(texts[YearField]) + u')';
}

QString updateTrack(qint64 id, const TrackTexts &texts)
{
    return Literal("update Tracks set titel = ") + quoted(texts[TitleField]) +
           Literal(", genre = ") + quotedOrNull(texts[GenreField]) + Literal(", hitjaar = ") +
           numberOrNull(texts[YearField]) + Literal(" where ID = ") + digits(id);
}

QString selectOtherHolders(qint64 trackId, qint64 cdId, int discNo)
{
    return Literal("select '1' from CompactDiscs where Track_ID = ") + digits(trackId) +
           Literal(" and not (CDTitels_ID = ") + digits(cdId) + Literal(" and DiskNo = ") +
           digits(discNo) + u')';
}

QString insertLink(qint64 id, qint64 cdId, int discNo, qint64 trackNo, qint64 trackId)
{
    return Literal("Insert into CompactDiscs(ID,CDTitels_ID,DiskNo,TrackNo,Track_ID,Opmerking) "
                   "values (") +
           digits(id) + u',' + digits(cdId) + u',' + digits(discNo) + u',' + digits(trackNo) +
           u',' + digits(trackId) + Literal(",NULL)");
}

QString updateLink(qint64 id, qint64 trackNo, qint64 trackId)
{
    return Literal("update CompactDiscs set TrackNo = ") + digits(trackNo) +
           Literal(", Track_ID = ") + digits(trackId) + Literal(" where ID = ") + digits(id);
}

QString deleteLink(qint64 id)
{
    return Literal("delete from CompactDiscs where ID = ") + digits(id);
}

QString deleteDisc(qint64 cdId, int discNo)
{
    return Literal("delete from CompactDiscs") + whereDisc(cdId, discNo);
}

QString moveDiscsUp(qint64 cdId, int discNo)
{
    return Literal("update CompactDiscs set DiskNo = DiskNo - 1 where CDTitels_ID = ") +
           digits(cdId) + Literal(" and DiskNo > ") + digits(discNo);
}

const auto nextArtist = u"SELECT max(id)+1 as id FROM Artiesten"_s;
const auto nextTrack = u"SELECT max(id)+1 as id FROM Tracks"_s;
const auto nextLink = u"SELECT max(id)+1 as id FROM compactdiscs"_s;
constexpr QLatin1String idField("id");

bool sameYear(const QString &a, const QString &b)
{
    return a == b || (!a.isEmpty() && !b.isEmpty() && a.toDouble() == b.toDouble());
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

QList<StoredTrack> TrackStore::load() const
{
    ADODB::Recordset answer;
    answer.Open(selectTracksOfDisc(mCdId, mDiscNo), mConnection);
    const auto rows = answer.rows();
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
    deleteLinks(tracks, was, links);
    for (qsizetype place = 0; place < tracks.size(); ++place)
        outcome.linkIds.append(write(tracks[place], place, links, outcome));
    return outcome;
}

// As they are now: the screen may have moved them to another artist's tracks, and what was loaded
// may be gone.
TrackStore::Links TrackStore::readLinks() const
{
    ADODB::Recordset answer;
    answer.Open(selectLinks(mCdId, mDiscNo), mConnection);
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
    ADODB::Recordset answer;
    answer.Open(selectTitle(mCdId), mConnection);
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
            mConnection.Execute(deleteLink(link));
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
        return addLink(number, trackId);
    if (link->trackNo != number || link->trackId != trackId)
        mConnection.Execute(updateLink(track.linkId, number, trackId));
    return track.linkId;
}

qint64 TrackStore::artistOf(const TrackTexts &texts, bool &otherSpelling)
{
    if (mArtists == Artists::OfTitle)
        return mTitleArtist;
    ADODB::Recordset answer;
    answer.Open(selectArtist(texts[ArtistField]), mConnection);
    if (answer.RecordCount() == 1) {
        otherSpelling = answer.Fields(1).Value().toText() != texts[ArtistField];
        return answer.Fields(0).Value().toLong();
    }
    const qint64 id = nextId(nextArtist, idField, mConnection);
    mConnection.Execute(insertArtist(id, texts[ArtistField]));
    return id;
}

qint64 TrackStore::trackOf(qint64 artistId, const TrackToSave &track, bool &keptValues)
{
    ADODB::Recordset answer;
    answer.Open(selectTrack(artistId, track.texts[TitleField]), mConnection);
    if (answer.RecordCount() != 1)
        return addTrack(artistId, track.texts);
    const qint64 id = answer.Fields(0).Value().toLong();
    TrackTexts found;
    for (const TrackField field : {TitleField, GenreField, YearField})
        found[field] = answer.Fields(int(field)).Value().toText();
    const TrackTexts texts = wanted(track, found);
    const bool settled = mSettled.contains(id);
    mSettled.insert(id);
    if (texts == found)
        return id;
    keptValues = settled || heldElsewhere(id);
    if (!keptValues)
        mConnection.Execute(updateTrack(id, texts));
    return id;
}

qint64 TrackStore::addTrack(qint64 artistId, const TrackTexts &texts)
{
    const qint64 id = nextId(nextTrack, idField, mConnection);
    mConnection.Execute(insertTrack(id, artistId, texts));
    mSettled.insert(id);
    return id;
}

qint64 TrackStore::addLink(qint64 trackNo, qint64 trackId)
{
    const qint64 id = nextId(nextLink, idField, mConnection);
    mConnection.Execute(insertLink(id, mCdId, mDiscNo, trackNo, trackId));
    return id;
}

bool TrackStore::heldElsewhere(qint64 trackId) const
{
    const QString statement = selectOtherHolders(trackId, mCdId, mDiscNo);
    return mConnection.firstRows(statement, 1).RecordCount() > 0;
}

void TrackStore::remove()
{
    ADODB::Transaction transaction(mConnection);
    try {
        mConnection.Execute(deleteDisc(mCdId, mDiscNo));
        mConnection.Execute(moveDiscsUp(mCdId, mDiscNo));
        transaction.CommitTrans();
    } catch (const Error &) {
        transaction.RollbackTrans();
        throw;
    }
}
