#include "catalogue/songs.h"

#include "platform/ado/recordset.h"

Songs::Songs(ADODB::Connection &connection)
    : mConnection(connection),
      mFindArtist(connection, "select ID from Artiesten where Naam = ?"),
      mAddArtist(connection, "insert into Artiesten(ID,Naam) values (?,?)"),
      mFindTrack(connection, "select ID from Tracks where Artiest_ID = ? and Titel = ?"),
      mAddTrack(connection,
                "insert into Tracks(ID,Artiest_ID,Titel,Genre,Hitjaar) values (?,?,?,?,?)"),
      mAddTitle(connection, "insert into CDTitels(ID,Titel,Artiest_ID,CD_Type,Genre,Hitjaar) "
                            "values (?,?,?,?,?,?)"),
      mAddLink(connection, "insert into CompactDiscs(ID,CDTitels_ID,DiskNo,TrackNo,Track_ID) "
                           "values (?,?,?,?,?)"),
      mChanges(connection.changes())
{
}

// By design: two artists of one name are as good as none; each search for it makes another.
qint64 Songs::findOrMakeArtist(std::string_view name)
{
    noticeOthers();
    if (const auto known = mArtists.find(name); known != mArtists.end())
        return known->second;
    auto [rows, id] = mFindArtist.find({name});
    if (rows != 1) {
        id = next(Table::Artiesten);
        insert(mAddArtist, {id, name});
    }
    if (rows < 2)
        mArtists.emplace(name, id);
    return id;
}

std::optional<qint64> Songs::findTrack(qint64 artist, std::string_view title)
{
    const auto match = mFindTrack.find({artist, title});
    return match.rows == 1 ? std::optional(match.id) : std::nullopt;
}

qint64 Songs::makeTrack(qint64 artist, std::string_view title, ADODB::Parameter genre,
                        ADODB::Parameter year)
{
    const qint64 id = next(Table::Tracks);
    insert(mAddTrack, {id, artist, title, genre, year});
    return id;
}

void Songs::makeTitle(const Title &title)
{
    const auto artist = title.artist ? ADODB::Parameter(*title.artist) : nullptr;
    const std::string_view type = title.artist ? "E" : "V";
    insert(mAddTitle, {title.id, title.name, artist, type, title.genre, title.year});
}

void Songs::makeLink(qint64 id, const Link &link)
{
    insert(mAddLink, {id, link.title, link.disc, link.trackNo, link.track});
}

qint64 Songs::makeLink(const Link &link)
{
    const qint64 id = next(Table::CompactDiscs);
    makeLink(id, link);
    return id;
}

// What was read before is not to be relied on once another routine has written, in a pump of this
// one's or because this one does so by statements of its own.
void Songs::noticeOthers()
{
    const qint64 changes = mConnection.changes();
    if (changes == mChanges)
        return;
    mChanges = changes;
    mArtists.clear();
    mNext.fill(0);
}

qint64 Songs::next(Table table)
{
    noticeOthers();
    qint64 &next = mNext[std::size_t(table)];
    if (next == 0)
        next = nextId(table, mConnection);
    return next++;
}

// Counts its own row alone: what a trigger adds is another's.
void Songs::insert(ADODB::Command &command, std::initializer_list<ADODB::Parameter> values)
{
    command.Execute(values);
    ++mChanges;
}
