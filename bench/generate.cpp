#include "generate.h"

#include "catalogue/cataloguefile.h"
#include "names.h"
#include "rawdatabase.h"

#include <QString>
#include <unordered_map>

namespace
{

constexpr double compilationShare = 0.3, boxSetShare = 0.08, sharedShare = 0.25;

/// Indexes are taken away while rows are written and made again from all rows at once; what the
/// catalogue says of their statistics would go with them and is put back too.
class WithoutIndexes
{
public:
    explicit WithoutIndexes(RawDatabase &database) : mDatabase(database)
    {
        std::string drop;
        RawStatement indexes(database, "select name, sql from sqlite_schema "
                                       "where type='index' and sql is not null");
        while (indexes.step()) {
            drop += "drop index " + text(indexes, 0) + ';';
            mCreate += text(indexes, 1) + ';';
        }
        database.exec("create temp table Kept as select * from sqlite_stat1;" + drop);
    }

    void putBack()
    {
        mDatabase.exec(mCreate + "delete from sqlite_stat1;"
                                 "insert into sqlite_stat1 select * from Kept");
    }

private:
    static std::string text(RawStatement &row, int column)
    {
        return reinterpret_cast<const char *>(sqlite3_column_text(row.handle(), column));
    }

    RawDatabase &mDatabase;
    std::string mCreate;
};

/// The artists of a catalogue. Each gets its row when it is picked first, so that none is without
/// a track or title.
class Artists
{
public:
    Artists(RawDatabase &database, Names &names, int count, double orphans)
        : mInsert(database, "insert into Artiesten(ID, Naam) values(?, ?)"),
          mNames(names.artists(std::size_t(count * (1 + orphans)) + 1)),
          mIds(std::size_t(count)),
          mPlaces(std::size_t(count), 10, 0.9)
    {
    }

    int pick(Random &random)
    {
        const auto place = mPlaces.pick(random);
        if (mIds[place] == 0)
            mIds[place] = add(mNames[place]);
        return mIds[place];
    }

    /// An artist that pick() never gives; 0 if all of those are used up.
    int addUnused()
    {
        const auto next = mIds.size() + std::size_t(mUnused++);
        return next < mNames.size() ? add(mNames[next]) : 0;
    }

    int count() const { return mCount; }

private:
    int add(const std::string &name)
    {
        mInsert.run(++mCount, name);
        return mCount;
    }

    RawStatement mInsert;
    std::vector<std::string> mNames;
    std::vector<int> mIds;
    Zipf mPlaces;
    int mCount = 0, mUnused = 0;
};

class Generator
{
public:
    Generator(RawDatabase &database, const CataloguePlan &plan)
        : mPlan(plan),
          mNames(plan.seed),
          mArtists(database, mNames, std::max(20, plan.discs * 6 / 10), plan.orphans),
          mInsertTrack(database, "insert into Tracks(ID, Artiest_ID, Titel, Genre, Hitjaar) "
                                 "values(?, ?, ?, ?, ?)"),
          mInsertTitle(database, "insert into CDTitels(ID, Titel, Artiest_ID, CD_Type, Genre, "
                                 "Hitjaar) values(?, ?, ?, ?, ?, ?)"),
          mInsertLink(database, "insert into CompactDiscs(ID, CDTitels_ID, DiskNo, TrackNo, "
                                "Track_ID) values(?, ?, ?, ?, ?)"),
          mInsertCollection(database, "insert into MP3Collections(ID, Map, Album) values(?, ?, ?)"),
          mInsertFile(database, "insert into MP3Files(ID, Volgnummer, FileName, CollectionId) "
                                "values(?, ?, ?, ?)")
    {
    }

    CatalogueCounts run()
    {
        while (mCounts.discs < mPlan.discs)
            addTitle();
        for (int i = 1; i <= mPlan.mp3Collections; ++i)
            addCollection(i);
        mCounts.artists = mArtists.count();
        return mCounts;
    }

private:
    Random &random() { return mNames.random; }

    void addTitle()
    {
        const bool compilation = random().chance(compilationShare);
        const int artist = compilation ? 0 : mArtists.pick(random());
        insertTitle(artist);
        const int title = mCounts.titles;
        const int discs = random().chance(boxSetShare) ? random().between(2, 6) : 1;
        for (int disc = 1; disc <= discs && mCounts.discs < mPlan.discs; ++disc)
            addDisc(title, disc, artist);
        if (random().chance(mPlan.orphans))
            addOrphanTitle();
    }

    void addDisc(int title, int disc, int artist)
    {
        ++mCounts.discs;
        const int owed = mCounts.discs * mPlan.tracksPerDisc - mCounts.links;
        const bool last = mCounts.discs == mPlan.discs;
        const int tracks = last ? owed : std::max(1, owed + random().between(-4, 4));
        for (int number = 1; number <= tracks; ++number) {
            const int track = pickTrack(artist);
            mInsertLink.run(++mCounts.links, title, disc, number, track);
            if (random().chance(mPlan.orphans))
                addOrphanTrack();
        }
    }

    int pickTrack(int artist)
    {
        const bool compilation = artist == 0;
        if (compilation && !mLinked.empty() && random().chance(sharedShare))
            return mLinked[std::size_t(random().between(0, int(mLinked.size()) - 1))];
        const int by = compilation ? mArtists.pick(random()) : artist;
        const std::string title = mNames.title();
        int &track = mKnown[std::to_string(by) + ' ' + title];
        if (track == 0) {
            track = insertTrack(by, title);
            mLinked.push_back(track);
        }
        return track;
    }

    int insertTrack(int artist, const std::string &title)
    {
        const std::string genre = random().chance(0.93) ? mNames.genre() : std::string();
        mInsertTrack.bind(++mCounts.tracks, artist, title);
        finishWithGenreAndYear(mInsertTrack, 4, genre);
        return mCounts.tracks;
    }

    void insertTitle(int artist)
    {
        const std::string title = mNames.title();
        const std::string genre = random().chance(0.9) ? mNames.genre() : std::string();
        mInsertTitle.bind(++mCounts.titles, title, artist, artist ? "E" : "V");
        if (artist == 0)
            sqlite3_bind_null(mInsertTitle.handle(), 3);
        finishWithGenreAndYear(mInsertTitle, 5, genre);
    }

    void finishWithGenreAndYear(RawStatement &insert, int place, const std::string &genre)
    {
        if (genre.empty())
            sqlite3_bind_null(insert.handle(), place);
        else
            sqlite3_bind_text(insert.handle(), place, genre.data(), int(genre.size()),
                              SQLITE_STATIC);
        sqlite3_bind_int(insert.handle(), place + 1, mNames.year());
        insert.step();
        sqlite3_reset(insert.handle());
    }

    // Every other orphan track belongs to an artist that has nothing else.
    void addOrphanTrack()
    {
        const int unused = mCounts.tracks % 2 ? mArtists.addUnused() : 0;
        // A title longer than any other: nothing ever finds it.
        insertTrack(unused ? unused : mArtists.pick(random()),
                    mNames.title() + " / " + mNames.title());
    }

    void addOrphanTitle() { insertTitle(mArtists.pick(random())); }

    void addCollection(int id)
    {
        const std::string name = mNames.title();
        mInsertCollection.run(id, "/music/" + name, name);
        for (int number = 1; number <= 12; ++number) {
            const std::string file = std::to_string(number) + " - " + mNames.title() + ".mp3";
            mInsertFile.run(++mFiles, number, file, id);
        }
    }

    CataloguePlan mPlan;
    CatalogueCounts mCounts;
    Names mNames;
    Artists mArtists;
    RawStatement mInsertTrack, mInsertTitle, mInsertLink, mInsertCollection, mInsertFile;
    std::unordered_map<std::string, int> mKnown; // "artist title": a track is never there twice
    std::vector<int> mLinked;                    // tracks that a disc holds
    int mFiles = 0;
};

} // namespace

CatalogueCounts generateCatalogue(const std::string &file, const CataloguePlan &plan)
{
    cataloguefile::create(QString::fromStdString(file));
    RawDatabase database(file);
    database.exec("pragma journal_mode=off; pragma synchronous=off; pragma cache_size=-200000; "
                  "pragma temp_store=memory");
    WithoutIndexes indexes(database);
    database.exec("begin");
    const CatalogueCounts counts = Generator(database, plan).run();
    indexes.putBack();
    database.exec("commit");
    return counts;
}
