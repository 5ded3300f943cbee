// Label: unit
#include "controls/tracks/trackcompletion.h"
#include "controls/tracks/trackmodel.h"
#include "controls/tracks/trackstore.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

using Artists = TrackStore::Artists;

/// The tracks of a disc in a real catalogue: what a save writes, and what it leaves alone.
///
/// Titles 1 (compilation, discs 1 and 2), 2 (compilation), 3 (album of Abba). Track 1, Waterloo by
/// Abba, is on all of them; tracks 2 and 3 are on disc 1 of title 1 alone.
class tst_TrackStore : public QObject
{
    Q_OBJECT

private:
    using Edit = std::function<void(TrackModel &)>;
    TrackStore::Outcome save(const Edit &edit, qint64 cdId = 1, int disc = 1,
                             Artists artists = Artists::OfTracks)
    {
        TrackModel model(artists == Artists::OfTracks);
        TrackStore store(*gConnection, cdId, disc, artists);
        model.load(store.load());
        edit(model);
        ADODB::Transaction transaction(*gConnection);
        const auto outcome = store.save(model.toSave(), model.savedLinks());
        transaction.CommitTrans();
        return outcome;
    }

    // Each write to a row leaves a line like "+Tracks 4" in a table of its own.
    void watchWrites()
    {
        QString triggers = u"create table seen(what text);"_s;
        for (const char *table : {"Artiesten", "Tracks", "CompactDiscs"})
            triggers +=
                u"create trigger %1A after insert on %1 begin insert into seen values "
                "('+%1 '||new.id); end; create trigger %1B after update on %1 begin insert "
                "into seen values ('%1 '||new.id); end; create trigger %1C after delete on %1 "
                "begin insert into seen values ('-%1 '||old.id); end;"_s.arg(QLatin1String(table));
        mCatalogue->exec(triggers);
    }

    std::unique_ptr<TestCatalogue> mCatalogue;

private slots:
    void init()
    {
        mCatalogue = std::make_unique<TestCatalogue>();
        mCatalogue->exec(
            "insert into artiesten values (1,'Abba'),(2,'Beck');"
            "insert into tracks values (1,1,'Waterloo','Pop',1974),(2,1,'SOS','Pop',1975),"
            "(3,2,'Loser',NULL,NULL);insert into cdtitels values "
            "(1,'Hits',NULL,'V',NULL,NULL),(2,'More',NULL,'V',NULL,NULL),"
            "(3,'Gold',1,'E',NULL,NULL);"
            "insert into compactdiscs values (10,1,1,1,1,NULL),(11,1,1,2,2,NULL),(12,1,1,3,3,NULL),"
            "(13,1,2,1,1,NULL),(14,2,1,1,1,NULL),(15,3,1,1,1,NULL)");
    }

    void cleanup() { mCatalogue.reset(); }

    void loads()
    {
        mCatalogue->exec("update compactdiscs set trackno = 7 where id = 10;"
                         "insert into compactdiscs values (20,1,1,2,99,NULL);" // to no track
                         "insert into tracks values (4,99,'Lost','',1990);"    // of no artist
                         "insert into compactdiscs values (21,1,1,9,4,NULL)");
        QStringList lines;
        for (const StoredTrack &track : TrackStore(*gConnection, 1, 1, Artists::OfTracks).load())
            lines.append(QString::number(track.linkId) + u' ' +
                         QStringList(track.texts.begin(), track.texts.end()).join(u'|'));
        QCOMPARE(lines, texts("11 Abba|SOS|Pop|1975", "12 Beck|Loser||",
                              "10 Abba|Waterloo|Pop|1974", "21 |Lost||1990"));
        QVERIFY(TrackStore(*gConnection, 1, 3, Artists::OfTracks).load().isEmpty());
    }

    void writesOnlyWhatChanged_data()
    {
        const DataRows<Edit, QString> row("edit", "writes");
        const auto type = [](int row, TrackField field, const char *text) {
            return [=](TrackModel &m) { m.setText(row, field, QString::fromUtf8(text)); };
        };
        const auto add = [](int row, const char *artist, const char *title) {
            return [=](TrackModel &m) { m.paste(row, ArtistField, {texts(artist, title)}); };
        };
        const auto insert = [](TrackModel &m) { m.insertTrack(1); };
        const auto remove = [](int row) { return [=](TrackModel &m) { m.removeTrack(row); }; };
        const auto both = [](const Edit &first, const Edit &second) {
            return [=](TrackModel &m) {
                first(m);
                second(m);
            };
        };
        row("genre of a track of this disc's", type(1, GenreField, "Rock"), "Tracks 2");
        row("title to a new one", type(1, TitleField, "Chiquitita"), "+Tracks 4;CompactDiscs 11");
        row("song to one that is there", add(2, "Abba", "Waterloo"), "CompactDiscs 12");
        row("spelling of the title", type(1, TitleField, "Sos"), "Tracks 2");
        row("artist to one that is there", type(2, ArtistField, "ABBA"),
            "+Tracks 4;CompactDiscs 12");
        row("a known song at the end", add(3, "Beck", "Loser"), "+CompactDiscs 16");
        row("two new songs of a new artist",
            both(add(3, "O'Neil", "Believe"), add(4, "o'neil", "One by One")),
            "+Artiesten 3;+Tracks 4;+CompactDiscs 16;+Tracks 5;+CompactDiscs 17");
        row("a row put in", both(insert, add(1, "Beck", "Loser")),
            "+CompactDiscs 16;CompactDiscs 11;CompactDiscs 12");
        row("an empty row put in", insert, "");
        row("the first row deleted", remove(0), "-CompactDiscs 10;CompactDiscs 11;CompactDiscs 12");
    }

    void writesOnlyWhatChanged()
    {
        QFETCH(Edit, edit);
        watchWrites();
        const auto outcome = save(edit);
        QTEST(mCatalogue->rows("select what from seen").join(u';'), "writes");
        QVERIFY(!outcome.refused && outcome.keptValues.isEmpty());
        const auto numbers = mCatalogue->rows(
            "select trackno from compactdiscs where cdtitels_id=1 and diskno=1 order by trackno");
        QCOMPARE(numbers, texts("1", "2", "3", "4", "5").mid(0, outcome.linkIds.size()));
    }

    void valuesOfAFoundTrack_data()
    {
        // typed: artist|title|genre|year, into a new row
        // row: of Tracks then
        // kept: values, artists
        const DataRows<QString, QString, QString> row("typed", "row", "kept");
        row("Abba|Waterloo|Pop|1974", "1|1|Waterloo|Pop|1974", "");
        row("Abba|Waterloo||", "1|1|Waterloo|Pop|1974", ""); // nothing said, nothing lost
        row("Abba|Waterloo|Rock|1974", "1|1|Waterloo|Pop|1974", "values");
        row("Abba|WATERLOO|Pop|1974", "1|1|Waterloo|Pop|1974", "values");
        row("ABBA|Waterloo|Pop|1974", "1|1|Waterloo|Pop|1974", "artists");
        row("Abba|SOS|Rock|1e10", "2|1|SOS|Rock|10000000000", "");
        row("Abba|sos||", "2|1|sos|Pop|1975", "");
        row("Beck|Loser|R&B, 'x'|1999", "3|2|Loser|R&B, 'x'|1999", "");
        row("Beck|SOS|Rock|1980", "4|2|SOS|Rock|1980", "");
    }

    void valuesOfAFoundTrack()
    {
        QFETCH(QString, typed);
        const QStringList cells = typed.split(u'|');
        const auto outcome = save([&](TrackModel &m) { m.paste(3, 1, {cells}); });
        QTEST(mCatalogue
                  ->rows("select * from tracks where id = (select track_id from "
                         "compactdiscs where id = 16)")
                  .join(u';'),
              "row");
        const QList<qsizetype> fourth{3};
        const QString kept = (outcome.keptValues == fourth ? u"values"_s : QString()) +
                             (outcome.keptArtists == fourth ? u"artists"_s : QString());
        QTEST(kept, "kept");
    }

    // On one disc, with values that contradict: the first is written, the second told.
    void theSameSongTwice()
    {
        const auto outcome = save([](TrackModel &m) {
            m.paste(3, 1,
                    TrackModel::parted(u"Cher\tBelieve\tPop\nCher\tBelieve\tRock"
                                       "\nCher\tBelieve\t\t1998\nCher\tBelieve"_s));
        });
        QCOMPARE(mCatalogue->rows("select titel, genre, hitjaar from tracks where id>3"),
                 texts("Believe|Pop|NULL"));
        QCOMPARE(outcome.keptValues, (QList<qsizetype>{4, 5}));
        // Emptied on purpose, in one of the rows.
        save([](TrackModel &m) { m.setText(4, GenreField, {}); });
        QCOMPARE(mCatalogue->rows("select genre from tracks where id>3"), texts("NULL"));
        // Shared with another disc by now: a new title makes a new row, the old one stays.
        mCatalogue->exec("insert into compactdiscs values (99,1,2,2,4,NULL)");
        QVERIFY(
            !save([](TrackModel &m) { m.setText(4, GenreField, u"Rock"_s); }).keptValues.isEmpty());
        QCOMPARE(mCatalogue->rows("select genre from tracks where id>3"), texts("NULL"));
        save([](TrackModel &m) { m.setText(4, TitleField, u"Believer"_s); });
        QCOMPARE(mCatalogue->rows("select id, titel from tracks where id>3"),
                 texts("4|Believe", "5|Believer"));
    }

    void albums()
    {
        const auto saveTitle = [this](int row, const QString &title) {
            return save([&](TrackModel &m) { m.setText(row, TitleField, title); }, 3, 1,
                        Artists::OfTitle);
        };
        const auto outcome = saveTitle(1, u"sos"_s);
        QCOMPARE(outcome.linkIds, (QList<qint64>{15, 16}));
        QCOMPARE(mCatalogue->rows("select track_id from compactdiscs where id=16"), texts("2"));
        QCOMPARE(outcome.keptValues, QList<qsizetype>{1});
        // Two rows of that title: neither is taken.
        mCatalogue->exec("insert into tracks values (8,1,'Fernando',NULL,NULL),"
                         "(9,1,'fernando','x',NULL)");
        saveTitle(0, u"Fernando"_s);
        QCOMPARE(mCatalogue->rows("select track_id from compactdiscs where id=15"), texts("10"));
        mCatalogue->exec("update cdtitels set artiest_id = NULL where id = 3");
        QVERIFY(saveTitle(0, u"x"_s).refused);
    }

    // The title was deleted while it was being edited, and the screen has put it back.
    void linksThatAreGoneComeBack()
    {
        save([this](TrackModel &) {
            mCatalogue->exec("delete from compactdiscs where cdtitels_id = 1;"
                             "delete from tracks where id > 1");
            // Its ids are given again.
            mCatalogue->exec("insert into compactdiscs values (10,2,1,2,1,NULL)");
        });
        QCOMPARE(mCatalogue->rows("select id, diskno, trackno, track_id from "
                                  "compactdiscs where cdtitels_id = 1"),
                 texts("16|1|1|1", "17|1|2|2", "18|1|3|3"));
        QCOMPARE(mCatalogue->rows("select cdtitels_id from compactdiscs where id=10"), texts("2"));
        QCOMPARE(mCatalogue->rows("select titel, genre from tracks where id = 2"),
                 texts("SOS|Pop"));
    }

    void removes()
    {
        mCatalogue->exec("insert into compactdiscs values (30,1,4,1,1,NULL)");
        TrackStore(*gConnection, 1, 1, Artists::OfTracks).remove();
        TrackStore(*gConnection, 1, 2, Artists::OfTracks).remove(); // not in the catalogue
        QCOMPARE(mCatalogue->rows("select id, diskno from compactdiscs order by id"),
                 texts("13|1", "14|1", "15|1", "30|2"));
    }

    void completes()
    {
        mCatalogue->exec(
            "insert into artiesten(naam) values ('ABC'),('Édith Piaf'),('O''Neil'),('10cc');"
            "with recursive n(i) as (select 1 union all select i+1 from n where i<12) "
            "insert into artiesten(naam) select 'Z'||i from n;"
            "insert into tracks values (4,1,'sos','x',NULL),(5,2,'Sissyneck',NULL,NULL)");
        using namespace trackcompletion;
        const auto found = [](const char *start) {
            return artists(*gConnection, QString::fromUtf8(start)).join(u',');
        };
        QCOMPARE(found("abb"), u"Abba"_s);
        QCOMPARE(found("ed"), u"Édith Piaf"_s);
        QCOMPARE(found("o'"), u"O'Neil"_s);
        QCOMPARE(found("%"), QString());
        QCOMPARE(found("10"), u"10cc"_s);
        QCOMPARE(found("z"), u"Z1,Z10,Z11,Z12,Z2,Z3,Z4,Z5,Z6,Z7"_s);
        QCOMPARE(titles(*gConnection, u"abba"_s, u"s"_s), texts("SOS"));
        QCOMPARE(titles(*gConnection, u"nobody"_s, u"S"_s), QStringList());
        QCOMPARE(titles(*gConnection, 3, u"w"_s), texts("Waterloo"));
    }
};

QTEST_GUILESS_MAIN(tst_TrackStore)
#include "tst_TrackStore.moc"
