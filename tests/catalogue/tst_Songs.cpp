// Label: unit
#include "catalogue/quoting.h"
#include "catalogue/songs.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

namespace
{

const auto everything = u"select group_concat(v, ' ') from (select 'a'||ID||Naam as v from "
                        "Artiesten union all select 't'||ID||Titel||Artiest_ID from Tracks)"_s;

} // namespace

/// What is found and what is made: rows with the ids that come next, whoever writes meanwhile.
class tst_Songs : public QObject
{
    Q_OBJECT

private:
    QString left() { return mCatalogue->rows(everything).value(0); }

    std::unique_ptr<TestCatalogue> mCatalogue;

private slots:
    void init()
    {
        mCatalogue.reset(); // first: each one holds gConnection
        mCatalogue = std::make_unique<TestCatalogue>();
    }

    // Each look-up twice: what is remembered must be what would be found.
    void artists_data()
    {
        const DataRows<QString, QString, QString> row("before", "names", "after");
        row("none", "", "X|x|Y", "a1X a2Y");
        row("one", "insert into Artiesten values (7,'Édith')", "ÉDITH|É|Édith", "a7Édith a8É");
        row("two are as good as none", "insert into Artiesten values (3,'X'),(4,'x')", "X|x",
            "a3X a4x a5X a6X a7x a8x");
        row("apostrophes and NFC", "", u"d'Arc'; --|e\u0301|\u00e9"_s, u"a1d'Arc'; -- a2\u00e9"_s);
    }

    void artists()
    {
        QFETCH(QString, before);
        QFETCH(QString, names);
        mCatalogue->exec(before);
        Songs songs(*gConnection);
        for (const QString &name : names.split(u'|')) {
            songs.findOrMakeArtist(name.toStdString());
            songs.findOrMakeArtist(name.toStdString());
        }
        QTEST(left(), "after");
    }

    void tracks_data()
    {
        const DataRows<QString, int> row("before", "found"); // for the title Y by artist 1
        row("none", "insert into Tracks values (5,1,'X',NULL,NULL),(6,2,'Y',NULL,NULL)", 0);
        row("one", "insert into Tracks values (5,1,'y','Pop',1985),(6,2,'Y',NULL,NULL)", 5);
        row("two", "insert into Tracks values (5,1,'Y',NULL,NULL),(6,1,'y',NULL,NULL)", 0);
    }

    void tracks()
    {
        QFETCH(QString, before);
        mCatalogue->exec(before);
        Songs songs(*gConnection);
        QTEST(int(songs.findTrack(1, "Y").value_or(0)), "found");
        QCOMPARE(songs.makeTrack(1, "Y", textOrNull(""), wholeOrNull("2e03")), 7);
        QCOMPARE(songs.makeTrack(1, "Y", textOrNull("x"), wholeOrNull("")), 8);
        QCOMPARE(mCatalogue->rows("select * from Tracks where ID > 6"),
                 texts("7|1|Y|NULL|2000", "8|1|Y|x|NULL"));
    }

    void titlesAndLinks()
    {
        mCatalogue->exec("insert into CompactDiscs(ID) values (4)");
        Songs songs(*gConnection);
        songs.makeTitle({1, "Hits"});
        songs.makeTitle({.id = 2, .name = "Gold", .artist = 9, .genre = u"Pop"_s, .year = 1985});
        QCOMPARE(mCatalogue->rows("select * from CDTitels"),
                 texts("1|Hits|NULL|V|NULL|NULL", "2|Gold|9|E|Pop|1985"));
        QCOMPARE(songs.makeLink({.title = 1, .disc = 2, .trackNo = 3, .track = 8}), 5);
        songs.makeLink(9, {1, 2, 4, 8});
        QCOMPARE(mCatalogue->rows("select * from CompactDiscs where ID > 4"),
                 texts("5|1|2|3|8|NULL", "9|1|2|4|8|NULL"));
    }

    // Another routine, in a pump, takes the next ids, removes what was found and doubles a name.
    void othersWriteMeanwhile()
    {
        mCatalogue->exec("create trigger T after insert on Artiesten when new.Naam = 'Twin' begin "
                         "insert into Artiesten select max(ID) + 1, 'Other' from Artiesten; end");
        Songs songs(*gConnection);
        QCOMPARE(songs.findOrMakeArtist("X"), 1);
        QCOMPARE(songs.makeTrack(1, "T", nullptr, nullptr), 1);
        gConnection->Execute(u"insert into Artiesten(ID,Naam) values (2,'Y')"_s);
        QCOMPARE(songs.findOrMakeArtist("Z"), 3);
        gConnection->Execute(u"insert into Tracks(ID,Titel,Artiest_ID) values (2,'U',1)"_s);
        QCOMPARE(songs.makeTrack(1, "V", nullptr, nullptr), 3);
        gConnection->Execute(u"update Artiesten set Naam = 'z' where ID = 1"_s);
        QCOMPARE(songs.findOrMakeArtist("Z"), 4);
        gConnection->Execute(u"delete from Artiesten where ID > 2"_s);
        QCOMPARE(songs.findOrMakeArtist("Twin"), 3); // and a trigger makes the fourth
        QCOMPARE(songs.findOrMakeArtist("W"), 5);
        QCOMPARE(left(), u"a1z a2Y a3Twin a4Other a5W t1T1 t2U1 t3V1"_s);
    }

    void textsThatNobodyDoubled_data()
    {
        const DataRows<QString, QString> row("text", "value");
        row("Pop", "Pop");
        row("''R''", "'R'");
        row("''''", "''");
        for (const char *refused :
             {"'", "Rock 'n Roll", "x'''", "x' or '1", "x',1985),(51,1,'r','y"})
            row(refused, "refused");
    }

    void textsThatNobodyDoubled()
    {
        QFETCH(QString, text);
        QString value = u"refused"_s;
        gConnection->Errors.clear();
        try {
            value = QString::fromStdString(undoubled(*gConnection, text.toStdString()));
        } catch (const Error &error) {
            QCOMPARE(error.Number, int(errSyntax));
            QCOMPARE(gConnection->Errors.size(), 1u);
        }
        QTEST(value, "value");
    }
};

QTEST_GUILESS_MAIN(tst_Songs)
#include "tst_Songs.moc"
