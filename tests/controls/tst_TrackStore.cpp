// Label: unit
#include "controls/trackcompletion.h"
#include "controls/trackmodel.h"
#include "controls/trackstore.h"
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "support/testcatalogue.h"

#include <QTest>

using Artists = TrackStore::Artists;

/// The tracks of a disc in a real catalogue: what a save writes, and what it leaves alone.
///
/// Titles 1 (compilation, discs 1 and 2), 2 (compilation), 3 (album of Abba). Track 1, Waterloo by
/// Abba, is on all of them; tracks 2 and 3 are on disc 1 of title 1 alone.
class tst_TrackStore : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup() { mCatalogue.reset(); }
    void loads();
    void writesOnlyWhatChanged_data();
    void writesOnlyWhatChanged();
    void valuesOfAFoundTrack_data();
    void valuesOfAFoundTrack();
    void theSameSongTwice();
    void albums();
    void linksThatAreGoneComeBack();
    void noLinkWithoutATitle();
    void removes();
    void aFailureLeavesAllAsItWas();
    void completes_data();
    void completes();
    void completesTitles();

private:
    using Edit = std::function<void(TrackModel &)>;
    TrackStore::Outcome save(const Edit &edit, qint64 cdId = 1, int disc = 1,
                             Artists artists = Artists::OfTracks);
    void watchWrites();

    std::unique_ptr<TestCatalogue> mCatalogue;
};

void tst_TrackStore::init()
{
    mCatalogue = std::make_unique<TestCatalogue>();
    mCatalogue->exec(QStringLiteral(
        "insert into artiesten values (1,'Abba'),(2,'Beck');"
        "insert into tracks values (1,1,'Waterloo','Pop',1974),(2,1,'SOS','Pop',1975),"
        "(3,2,'Loser',NULL,NULL);"
        "insert into cdtitels values (1,'Hits',NULL,'V',NULL,NULL),(2,'More',NULL,'V',NULL,NULL),"
        "(3,'Gold',1,'E',NULL,NULL);"
        "insert into compactdiscs values (10,1,1,1,1,NULL),(11,1,1,2,2,NULL),(12,1,1,3,3,NULL),"
        "(13,1,2,1,1,NULL),(14,2,1,1,1,NULL),(15,3,1,1,1,NULL)"));
}

TrackStore::Outcome tst_TrackStore::save(const Edit &edit, qint64 cdId, int disc, Artists artists)
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
void tst_TrackStore::watchWrites()
{
    mCatalogue->exec(QStringLiteral("create table seen(what text)"));
    const std::pair<const char *, const char *> kinds[] = {
        {"insert", "'+%1 '||new.id"}, {"update", "'%1 '||new.id"}, {"delete", "'-%1 '||old.id"}};
    for (const char *table : {"Artiesten", "Tracks", "CompactDiscs"}) {
        for (const auto &[kind, line] : kinds)
            mCatalogue->exec(
                QStringLiteral("create trigger %1%2 after %2 on %1 begin "
                               "insert into seen values (%3); end")
                    .arg(QLatin1String(table), QLatin1String(kind),
                         QString::fromLatin1(line).replace(u"%1"_qs, QLatin1String(table))));
    }
}

void tst_TrackStore::loads()
{
    mCatalogue->exec(
        QStringLiteral("update compactdiscs set trackno = 7 where id = 10;"
                       "insert into compactdiscs values (20,1,1,2,99,NULL);" // to no track
                       "insert into tracks values (4,99,'Lost','',1990);"    // of no artist
                       "insert into compactdiscs values (21,1,1,9,4,NULL)"));
    QStringList lines;
    for (const StoredTrack &track : TrackStore(*gConnection, 1, 1, Artists::OfTracks).load())
        lines.append(QString::number(track.linkId) + u' ' +
                     QStringList(track.texts.begin(), track.texts.end()).join(u'|'));
    QCOMPARE(lines, texts("11 Abba|SOS|Pop|1975", "12 Beck|Loser||", "10 Abba|Waterloo|Pop|1974",
                          "21 |Lost||1990"));
    QVERIFY(TrackStore(*gConnection, 1, 3, Artists::OfTracks).load().isEmpty());
}

void tst_TrackStore::writesOnlyWhatChanged_data()
{
    QTest::addColumn<Edit>("edit");
    QTest::addColumn<QString>("writes");
    const auto row = [](const char *name, const Edit &edit, const char *writes) {
        QTest::newRow(name) << edit << QString::fromUtf8(writes);
    };
    const auto type = [](int row, TrackField field, const char *text) {
        return [=](TrackModel &m) { m.setText(row, field, QString::fromUtf8(text)); };
    };
    const auto add = [](int row, const char *artist, const char *title) {
        return [=](TrackModel &m) {
            m.setText(row, ArtistField, QString::fromUtf8(artist));
            m.setText(row, TitleField, QString::fromUtf8(title));
        };
    };
    row(
        "nothing", [](TrackModel &) {}, "");
    row("genre of a track of this disc's", type(1, GenreField, "Rock"), "Tracks 2");
    row("title to a new one", type(1, TitleField, "Chiquitita"), "+Tracks 4;CompactDiscs 11");
    row("song to one that is there", add(2, "Abba", "Waterloo"), "CompactDiscs 12");
    row("spelling of the title", type(1, TitleField, "Sos"), "Tracks 2");
    row("artist to a new one", type(2, ArtistField, "O'Neil"),
        "+Artiesten 3;+Tracks 4;CompactDiscs 12");
    row("artist to one that is there", type(2, ArtistField, "ABBA"), "+Tracks 4;CompactDiscs 12");
    row("a known song at the end", add(3, "Beck", "Loser"), "+CompactDiscs 16");
    row("a new song of a known artist", add(3, "Beck", "Devil's Haircut"),
        "+Tracks 4;+CompactDiscs 16");
    row(
        "two new songs of a new artist",
        [=](TrackModel &m) {
            add(3, "Cher", "Believe")(m);
            add(4, "cher", "One by One")(m);
        },
        "+Artiesten 3;+Tracks 4;+CompactDiscs 16;+Tracks 5;+CompactDiscs 17");
    row(
        "a row put in",
        [=](TrackModel &m) {
            m.insertTrack(1);
            add(1, "Beck", "Loser")(m);
        },
        "+CompactDiscs 16;CompactDiscs 11;CompactDiscs 12");
    row(
        "an empty row put in", [](TrackModel &m) { m.insertTrack(1); }, "");
    row(
        "the last row deleted", [](TrackModel &m) { m.removeTrack(2); }, "-CompactDiscs 12");
    row(
        "the first row deleted", [](TrackModel &m) { m.removeTrack(0); },
        "-CompactDiscs 10;CompactDiscs 11;CompactDiscs 12");
    row(
        "all deleted",
        [](TrackModel &m) {
            for (int i = 0; i < 3; ++i)
                m.removeTrack(0);
        },
        "-CompactDiscs 10;-CompactDiscs 11;-CompactDiscs 12");
}

void tst_TrackStore::writesOnlyWhatChanged()
{
    QFETCH(Edit, edit);
    watchWrites();
    const auto outcome = save(edit);
    QTEST(mCatalogue->rows(QStringLiteral("select what from seen")).join(u';'), "writes");
    QVERIFY(!outcome.refused && outcome.keptValues.isEmpty());
    QCOMPARE(mCatalogue
                 ->rows(QStringLiteral("select id, trackno from compactdiscs where "
                                       "cdtitels_id=1 and diskno=1 order by trackno"))
                 .size(),
             outcome.linkIds.size());
    QCOMPARE(mCatalogue->count(QStringLiteral(
                 "select count(*) from compactdiscs where cdtitels_id=1 and diskno=1 and trackno "
                 "not between 1 and (select count(*) from compactdiscs where cdtitels_id=1 and "
                 "diskno=1)")),
             0);
}

void tst_TrackStore::valuesOfAFoundTrack_data()
{
    QTest::addColumn<QString>("typed"); // artist|title|genre|year, into a new row
    QTest::addColumn<QString>("row");   // of Tracks then
    QTest::addColumn<QString>("kept");  // values, artists
    const auto row = [](const char *typed, const char *row, const char *kept) {
        QTest::newRow(typed) << QString::fromUtf8(typed) << QString::fromUtf8(row)
                             << QString::fromUtf8(kept);
    };
    row("Abba|Waterloo|Pop|1974", "1|1|Waterloo|Pop|1974", "");
    row("Abba|Waterloo||", "1|1|Waterloo|Pop|1974", ""); // nothing said, nothing lost
    row("Abba|Waterloo|Rock|1974", "1|1|Waterloo|Pop|1974", "values");
    row("Abba|Waterloo|Pop|1975", "1|1|Waterloo|Pop|1974", "values");
    row("Abba|WATERLOO|Pop|1974", "1|1|Waterloo|Pop|1974", "values");
    row("ABBA|Waterloo|Pop|1974", "1|1|Waterloo|Pop|1974", "artists");
    row("Abba|SOS|Rock|1e10", "2|1|SOS|Rock|10000000000", "");
    row("Abba|sos||", "2|1|sos|Pop|1975", "");
    row("Beck|Loser|R&B, 'x'|1999", "3|2|Loser|R&B, 'x'|1999", "");
    row("Beck|SOS|Rock|1980", "4|2|SOS|Rock|1980", "");
}

void tst_TrackStore::valuesOfAFoundTrack()
{
    QFETCH(QString, typed);
    const QStringList cells = typed.split(u'|');
    const auto outcome = save([&](TrackModel &m) { m.paste(3, 1, {cells}); });
    QTEST(mCatalogue
              ->rows(QStringLiteral("select * from tracks where id = (select track_id from "
                                    "compactdiscs where id = 16)"))
              .join(u';'),
          "row");
    const QList<qsizetype> fourth{3};
    const QString kept = (outcome.keptValues == fourth ? QStringLiteral("values") : QString()) +
                         (outcome.keptArtists == fourth ? QStringLiteral("artists") : QString());
    QTEST(kept, "kept");
}

// On one disc, with values that contradict: the first is written, the second told.
void tst_TrackStore::theSameSongTwice()
{
    const auto outcome = save([](TrackModel &m) {
        m.paste(3, 1,
                TrackModel::parted(QStringLiteral("Cher\tBelieve\tPop\nCher\tBelieve\tRock"
                                                  "\nCher\tBelieve\t\t1998\nCher\tBelieve")));
    });
    QCOMPARE(
        mCatalogue->rows(QStringLiteral("select titel, genre, hitjaar from tracks where id>3")),
        texts("Believe|Pop|NULL"));
    QCOMPARE(outcome.keptValues, (QList<qsizetype>{4, 5}));
    // Emptied on purpose, in one of the rows.
    save([](TrackModel &m) { m.setText(4, GenreField, {}); });
    QCOMPARE(mCatalogue->rows(QStringLiteral("select genre from tracks where id>3")),
             texts("NULL"));
    // Shared with another disc by now: a new title makes a new row, the old one stays.
    mCatalogue->exec(QStringLiteral("insert into compactdiscs values (99,2,1,2,4,NULL)"));
    save([](TrackModel &m) { m.setText(4, TitleField, QStringLiteral("Believer")); });
    QCOMPARE(mCatalogue->rows(QStringLiteral("select id, titel from tracks where id>3")),
             texts("4|Believe", "5|Believer"));
}

void tst_TrackStore::albums()
{
    const auto add = [](TrackModel &m) { m.setText(1, TitleField, QStringLiteral("sos")); };
    auto outcome = save(add, 3, 1, Artists::OfTitle);
    QCOMPARE(outcome.linkIds, (QList<qint64>{15, 16}));
    QCOMPARE(mCatalogue->rows(QStringLiteral("select track_id from compactdiscs where id=16")),
             texts("2"));
    QCOMPARE(outcome.keptValues, QList<qsizetype>{1});
    // Two rows of that title: neither is taken.
    mCatalogue->exec(QStringLiteral("insert into tracks values (8,1,'Fernando',NULL,NULL),"
                                    "(9,1,'fernando','x',NULL)"));
    save([](TrackModel &m) { m.setText(0, TitleField, QStringLiteral("Fernando")); }, 3, 1,
         Artists::OfTitle);
    QCOMPARE(mCatalogue->rows(QStringLiteral("select track_id from compactdiscs where id=15")),
             texts("10"));
    mCatalogue->exec(QStringLiteral("update cdtitels set artiest_id = NULL where id = 3"));
    outcome = save([](TrackModel &m) { m.setText(0, TitleField, QStringLiteral("x")); }, 3, 1,
                   Artists::OfTitle);
    QVERIFY(outcome.refused);
}

// The title was deleted while it was being edited, and the screen has put it back.
void tst_TrackStore::linksThatAreGoneComeBack()
{
    save([this](TrackModel &) {
        mCatalogue->exec(QStringLiteral("delete from compactdiscs where cdtitels_id = 1;"
                                        "delete from tracks where id > 1"));
        // Its ids are given again.
        mCatalogue->exec(QStringLiteral("insert into compactdiscs values (10,2,1,2,1,NULL)"));
    });
    QCOMPARE(mCatalogue->rows(QStringLiteral("select id, diskno, trackno, track_id from "
                                             "compactdiscs where cdtitels_id = 1")),
             texts("16|1|1|1", "17|1|2|2", "18|1|3|3"));
    QCOMPARE(mCatalogue->rows(QStringLiteral("select cdtitels_id from compactdiscs where id=10")),
             texts("2"));
    QCOMPARE(mCatalogue->rows(QStringLiteral("select titel, genre from tracks where id = 2")),
             texts("SOS|Pop"));
}

void tst_TrackStore::noLinkWithoutATitle()
{
    mCatalogue->exec(QStringLiteral("delete from cdtitels where id = 1"));
    watchWrites();
    const auto outcome = save([](TrackModel &m) { m.setText(0, TitleField, QStringLiteral("x")); });
    QVERIFY(outcome.refused);
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from seen")), 0);
}

void tst_TrackStore::removes()
{
    mCatalogue->exec(QStringLiteral("insert into compactdiscs values (30,1,4,1,1,NULL)"));
    TrackStore(*gConnection, 1, 1, Artists::OfTracks).remove();
    const auto left = [this] {
        return mCatalogue->rows(
            QStringLiteral("select id, diskno from compactdiscs where cdtitels_id=1"));
    };
    QCOMPARE(left(), texts("13|1", "30|3"));
    TrackStore(*gConnection, 1, 2, Artists::OfTracks).remove(); // not in the catalogue
    QCOMPARE(left(), texts("13|1", "30|2"));
    QCOMPARE(mCatalogue->count(QStringLiteral("select count(*) from compactdiscs")), 4);
}

void tst_TrackStore::aFailureLeavesAllAsItWas()
{
    const QString all = QStringLiteral("select * from compactdiscs");
    const QStringList before = mCatalogue->rows(all);
    mCatalogue->exec(QStringLiteral("create trigger t before update on compactdiscs begin "
                                    "select raise(abort,'no'); end"));
    QVERIFY_EXCEPTION_THROWN(TrackStore(*gConnection, 1, 1, Artists::OfTracks).remove(),
                             ADODB::Error);
    QCOMPARE(mCatalogue->rows(all), before);
    QVERIFY_EXCEPTION_THROWN(save([](TrackModel &m) {
                                 m.setText(3, TitleField, QStringLiteral("x"));
                                 m.removeTrack(0);
                             }),
                             ADODB::Error);
    gConnection->RollbackTrans();
    QCOMPARE(mCatalogue->rows(all), before);
}

void tst_TrackStore::completes_data()
{
    QTest::addColumn<QString>("start");
    QTest::addColumn<QStringList>("found");
    const auto row = [](const char *start, const QStringList &found) {
        QTest::newRow(start) << QString::fromUtf8(start) << found;
    };
    row("a", texts("ABC", "Abba", "Ace of Base"));
    row("AB", texts("ABC", "Abba"));
    row("abba", texts("Abba"));
    row("abbaa", {});
    row("édith", texts("Édith Piaf"));
    row("ed", texts("Édith Piaf"));
    row("o'", texts("O'Neil"));
    row("%", {});
    row("10", texts("10cc"));
    row("\U0001F3B5", texts("\U0001F3B5 Band"));
    row("z", texts("Z1", "Z10", "Z11", "Z12", "Z2", "Z3", "Z4", "Z5", "Z6", "Z7"));
}

void tst_TrackStore::completes()
{
    QFETCH(QString, start);
    mCatalogue->exec(QString::fromUtf8(
        "insert into artiesten(naam) values ('ABC'),('Ace of Base'),('Édith Piaf'),('O''Neil'),"
        "('10cc'),('\U0001F3B5 Band');"
        "with recursive n(i) as (select 1 union all select i+1 from n where i<12) "
        "insert into artiesten(naam) select 'Z'||i from n"));
    QStringList found = trackcompletion::artists(*gConnection, start);
    if (start == QLatin1String("a") || start == QLatin1String("AB"))
        std::sort(found.begin(), found.end()); // the order is the catalogue's
    QTEST(found, "found");
}

void tst_TrackStore::completesTitles()
{
    mCatalogue->exec(QStringLiteral("insert into tracks values (4,1,'sos','x',NULL),"
                                    "(5,2,'Sissyneck',NULL,NULL)"));
    using namespace trackcompletion;
    QCOMPARE(titles(*gConnection, QStringLiteral("abba"), QStringLiteral("s")), texts("SOS"));
    QCOMPARE(titles(*gConnection, QStringLiteral("Beck"), QStringLiteral("S")), texts("Sissyneck"));
    QCOMPARE(titles(*gConnection, QStringLiteral("nobody"), QStringLiteral("S")), QStringList());
    QCOMPARE(titles(*gConnection, 3, QStringLiteral("w")), texts("Waterloo"));
    QCOMPARE(titles(*gConnection, 1, QStringLiteral("w")), QStringList());
}

QTEST_GUILESS_MAIN(tst_TrackStore)
#include "tst_TrackStore.moc"
