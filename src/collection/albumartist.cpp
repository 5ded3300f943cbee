#include "collection/albumartist.h"

#include "catalogue/songs.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"

namespace albumartist
{

namespace
{

constexpr std::string_view selectTracksOf =
    "select trk.id as ID, trk.titel as Titel, trk.genre as Genre, trk.hitjaar as Hitjaar "
    "from tracks trk, compactdiscs cds where trk.id = cds.track_id and cds.cdtitels_id = ?";
constexpr std::string_view updateLinks =
    "update compactdiscs set track_id = ? where cdtitels_id = ? and track_id = ?";
constexpr std::string_view selectName = "select Naam from Artiesten where ID = ?";

// A NULL stays one, and an empty text of another program's stays that.
qint64 trackOf(Songs &songs, qint64 artist, ADODB::Recordset &old)
{
    const std::string title = old.Fields(u"Titel").Value().toText().toStdString();
    if (const auto own = songs.findTrack(artist, title))
        return *own;
    const ADODB::Value genre = old.Fields(u"Genre").Value(), year = old.Fields(u"Hitjaar").Value();
    return songs.makeTrack(artist, title, genre, year);
}

} // namespace

qint64 findOrMake(const QString &name)
{
    return Songs(*gConnection).findOrMakeArtist(name.toStdString());
}

QString nameOf(qint64 artist)
{
    return ADODB::Command(*gConnection, selectName).Execute({artist}).Fields(0).Value().toText();
}

void moveTracks(qint64 cd, qint64 artist)
{
    Songs songs(*gConnection);
    ADODB::Command move(*gConnection, updateLinks);
    ADODB::Recordset tracks = ADODB::Command(*gConnection, selectTracksOf).Execute({cd});
    for (; !tracks.isEOF(); tracks.MoveNext()) {
        const qint64 old = tracks.Fields(u"ID").Value().toLong();
        move.Execute({trackOf(songs, artist, tracks), cd, old});
    }
}

} // namespace albumartist
