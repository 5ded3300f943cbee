#include "bareload.h"

#include "catalogue/cataloguefile.h"

#include <QFile>
#include <charconv>

namespace
{

/// Takes lines off the front of the bytes.
class Lines
{
public:
    explicit Lines(std::string_view bytes) : mRest(bytes) {}

    bool atEnd() const { return mRest.empty(); }

    std::string_view next()
    {
        const auto end = std::min(mRest.find('\n'), mRest.size());
        const auto line = mRest.substr(0, end);
        mRest.remove_prefix(std::min(end + 1, mRest.size()));
        return line;
    }

    int nextNumber()
    {
        const auto line = next();
        int number = 0;
        std::from_chars(line.data(), line.data() + line.size(), number);
        return number;
    }

    std::string_view nextOrNone() // "*" stands for none
    {
        const auto line = next();
        return line == "*" ? std::string_view() : line;
    }

private:
    std::string_view mRest;
};

std::string_view cutField(std::string_view &line)
{
    const auto end = std::min(line.find('*'), line.size());
    const auto field = line.substr(0, end);
    line.remove_prefix(std::min(end + 1, line.size()));
    return field;
}

std::vector<BareTrack> parseNested(Lines lines, bool albums)
{
    std::vector<BareTrack> tracks;
    while (!lines.atEnd()) {
        BareTrack track{.newTitle = true};
        if (albums)
            track.artist = lines.next();
        track.mainTitle = lines.next();
        const int discs = lines.nextNumber();
        for (track.disc = 1; track.disc <= discs; ++track.disc) {
            const int count = lines.nextNumber();
            for (track.number = 1; track.number <= count; ++track.number) {
                if (!albums)
                    track.artist = lines.next();
                track.title = lines.next();
                track.genre = lines.nextOrNone();
                track.year = lines.nextOrNone();
                tracks.push_back(track);
                track.newTitle = false;
            }
        }
    }
    return tracks;
}

std::vector<BareTrack> parseFlat(Lines lines, bool albums)
{
    std::vector<BareTrack> tracks;
    BareTrack track;
    while (!lines.atEnd()) {
        auto line = lines.next();
        if (line.empty() || line == "*") {
            ++track.disc;
            track.number = 1;
        } else if (line.find('*') != line.npos) {
            if (!albums)
                track.artist = cutField(line);
            track.title = cutField(line);
            track.genre = cutField(line);
            track.year = line;
            tracks.push_back(track);
            ++track.number;
            track.newTitle = false;
        } else {
            track = BareTrack{.artist = albums ? line : std::string_view(), .newTitle = true};
            track.mainTitle = albums ? lines.next() : line;
        }
    }
    return tracks;
}

/// The six statements of the loop.
class Loader
{
public:
    Loader(RawDatabase &database, bool albums)
        : mDatabase(database),
          mAlbums(albums),
          mFindArtist(database, "select ID from Artiesten where Naam=?"),
          mAddArtist(database, "insert into Artiesten(Naam) values(?)"),
          mFindTrack(database, "select ID from Tracks where Artiest_ID=? and Titel=?"),
          mAddTrack(database,
                    "insert into Tracks(Artiest_ID, Titel, Genre, Hitjaar) values(?, ?, ?, ?)"),
          mAddTitle(database, "insert into CDTitels(Titel, Artiest_ID, CD_Type) values(?, ?, ?)"),
          mAddLink(database, "insert into CompactDiscs(CDTitels_ID, DiskNo, TrackNo, Track_ID) "
                             "values(?, ?, ?, ?)")
    {
    }

    void add(const BareTrack &row)
    {
        const auto artist = findOrAddArtist(row.artist);
        const auto track = findOrAddTrack(artist, row);
        if (row.newTitle)
            mTitle = addTitle(row.mainTitle, artist);
        mAddLink.run(mTitle, row.disc, row.number, track);
        ++mCounts.links;
    }

    const BareCounts &counts() const { return mCounts; }

private:
    sqlite3_int64 findOrAddArtist(std::string_view name)
    {
        if (const auto id = mFindArtist.number(name))
            return id;
        mAddArtist.run(name);
        ++mCounts.artists;
        return mDatabase.lastId();
    }

    sqlite3_int64 findOrAddTrack(sqlite3_int64 artist, const BareTrack &row)
    {
        if (const auto id = mFindTrack.number(artist, row.title))
            return id;
        mAddTrack.bind(artist, row.title, row.genre, row.year);
        if (row.genre.empty())
            sqlite3_bind_null(mAddTrack.handle(), 3);
        if (row.year.empty())
            sqlite3_bind_null(mAddTrack.handle(), 4);
        mAddTrack.step();
        sqlite3_reset(mAddTrack.handle());
        ++mCounts.tracks;
        return mDatabase.lastId();
    }

    sqlite3_int64 addTitle(std::string_view title, sqlite3_int64 artist)
    {
        if (mAlbums)
            mAddTitle.run(title, artist, std::string_view("E"));
        else
            mAddTitle.run(title, nullptr, std::string_view("V"));
        ++mCounts.titles;
        return mDatabase.lastId();
    }

    RawDatabase &mDatabase;
    bool mAlbums;
    RawStatement mFindArtist, mAddArtist, mFindTrack, mAddTrack, mAddTitle, mAddLink;
    BareCounts mCounts;
    sqlite3_int64 mTitle = 0;
};

} // namespace

std::vector<BareTrack> parseBare(char format, std::string_view bytes)
{
    const bool albums = format == 'B' || format == 'D';
    return format < 'C' ? parseNested(Lines(bytes), albums) : parseFlat(Lines(bytes), albums);
}

BareCounts loadBare(RawDatabase &database, const std::vector<BareTrack> &tracks, bool albums)
{
    database.exec("begin immediate");
    Loader loader(database, albums);
    for (const BareTrack &track : tracks)
        loader.add(track);
    database.exec("commit");
    return loader.counts();
}

void createNocaseCatalogue(const std::string &file)
{
    const std::string model = file + ".model";
    QFile::remove(QString::fromStdString(model));
    cataloguefile::create(QString::fromStdString(model));
    {
        RawDatabase from(model), to(file);
        RawStatement schema(from, "select replace(sql, 'SONGCASE', 'NOCASE') from sqlite_schema "
                                  "where name not like 'sqlite_%' order by type desc");
        while (schema.step())
            to.exec(reinterpret_cast<const char *>(sqlite3_column_text(schema.handle(), 0)));
    }
    QFile::remove(QString::fromStdString(model));
}
