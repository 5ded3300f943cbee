#include "collection/albumartist.h"

#include "catalogue/ids.h"
#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace albumartist
{

namespace
{

const auto nextArtistId = u"SELECT max(id)+1 as id FROM Artiesten"_s;
const auto nextTrackId = u"SELECT max(id)+1 as id FROM Tracks"_s;
const auto idField = "id"_L1;

QString selectArtist(const QString &name)
{
    return u"SELECT id FROM Artiesten where Naam = "_s + quoted(name);
}

QString selectName(qint64 artist)
{
    return u"SELECT Naam FROM Artiesten where ID = "_s + QString::number(artist);
}

QString insertArtist(qint64 id, const QString &name)
{
    return u"Insert into artiesten(id,naam) values ("_s + QString::number(id) + u',' +
           quoted(name) + u')';
}

QString selectTracksOf(qint64 cd)
{
    return u"select trk.id as ID, "
           "trk.titel as Titel, "
           "trk.genre as Genre, "
           "trk.hitjaar as Hitjaar "
           "from tracks trk, compactdiscs cds "
           "where trk.id = cds.track_id "
           "and cds.cdtitels_id= "_s +
           QString::number(cd);
}

QString selectTrack(qint64 artist, const QString &title)
{
    return u"SELECT id From Tracks where artiest_id = "_s + QString::number(artist) +
           u" and Titel = "_s + quoted(title);
}

QString insertTrack(qint64 id, qint64 artist, const QString &title, const QString &genre,
                    const QString &year)
{
    return u"Insert into Tracks(id,artiest_id,titel,genre,hitjaar) values ("_s +
           QString::number(id) + u',' + QString::number(artist) + u',' + title + u',' + genre +
           u',' + year + u')';
}

QString updateLinks(qint64 cd, qint64 from, qint64 to)
{
    return u"update compactdiscs set track_id= "_s + QString::number(to) +
           u" where cdtitels_id = "_s + QString::number(cd) + u" and track_id = "_s +
           QString::number(from);
}

// 0 unless there is exactly one.
qint64 onlyId(const QString &statement)
{
    ADODB::Recordset answer;
    answer.Open(statement, *gConnection);
    return answer.RecordCount() == 1 ? answer.Fields(0).Value().toLong() : 0;
}

// A NULL stays one, and an empty text of another program's stays that.
QString sameText(const ADODB::Value &value)
{
    return value.isNull() ? u"NULL"_s : quoted(value.toText());
}

qint64 trackOf(qint64 artist, ADODB::Recordset &old)
{
    const QString title = old.Fields(u"Titel").Value().toText();
    if (const qint64 own = onlyId(selectTrack(artist, title)))
        return own;
    const qint64 id = nextId(nextTrackId, idField);
    gConnection->Execute(insertTrack(id, artist, quoted(title),
                                     sameText(old.Fields(u"Genre").Value()),
                                     numberOrNull(old.Fields(u"Hitjaar").Value().toText())));
    return id;
}

} // namespace

qint64 findOrMake(const QString &name)
{
    if (const qint64 known = onlyId(selectArtist(name)))
        return known;
    const qint64 id = nextId(nextArtistId, idField);
    gConnection->Execute(insertArtist(id, name));
    return id;
}

QString nameOf(qint64 artist)
{
    ADODB::Recordset answer;
    answer.Open(selectName(artist), *gConnection);
    return answer.Fields(0).Value().toText();
}

void moveTracks(qint64 cd, qint64 artist)
{
    ADODB::Recordset tracks;
    tracks.Open(selectTracksOf(cd), *gConnection);
    for (; !tracks.isEOF(); tracks.MoveNext()) {
        const qint64 old = tracks.Fields(u"ID").Value().toLong();
        gConnection->Execute(updateLinks(cd, old, trackOf(artist, tracks)));
    }
}

} // namespace albumartist
