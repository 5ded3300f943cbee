// Label: screen
#include "mp3/importascd.h"
#include "platform/ado/connection.h"
#include "support/countingbrowser.h"
#include "support/rowstest.h"

namespace
{

const auto titles = u"select Titel, ifnull(Naam,'-'), CD_Type from CDTitels left join Artiesten "
                    "on Artiest_ID = Artiesten.ID order by CDTitels.ID"_s;
const auto links =
    u"select CDTitels_ID, DiskNo, TrackNo, Naam, Tracks.Titel, Tracks.Genre, Hitjaar "
    "from CompactDiscs, Tracks, Artiesten where Track_ID = Tracks.ID and "
    "Tracks.Artiest_ID = Artiesten.ID order by CompactDiscs.ID"_s;

} // namespace

/// Rows of a collection into the catalogue, with all questions and refusals.
class tst_ImportAsCD : public RowsTest
{
    Q_OBJECT

private:
    // Rows "album|artist|title|part of set|year|genre", from the fourth of the list on; boxes
    // parted by ";".
    void import(const QString &rows, const QString &boxes)
    {
        using enum CollectionField;
        expect(boxes.split(u';', Qt::SkipEmptyParts));
        importAsCD(*mScreen, u"My collection"_s,
                   rowsOf(rows, {Album, LeadArtist, Title, PartOfSet, TrackYear, Genre}, 4));
    }

private slots:
    void whatRowsBecome_data()
    {
        const auto album = "add this album=Yes;CD imported."_L1;
        const auto compilation = "add this compilation=Yes;CD imported."_L1;
        const DataRows<QString, QString, QStringList, QStringList> row("rows", "boxes", "titles",
                                                                       "links");
        row("one row", "It's|O'Neill|One||1985|Rock", album, texts("It's|O'Neill|E"),
            texts("1|1|1|O'Neill|One|Rock|1985"));
        row("no album", "|A|One||19xx|", album, texts("My collection|A|E"),
            texts("1|1|1|A|One|NULL|NULL"));
        row("two albums of an artist", "X|A|One\nY|A|Two|3||", album, texts("My collection|A|E"),
            texts("1|1|1|A|One|NULL|NULL", "1|1|2|A|Two|NULL|NULL"));
        row("artists by spelling", "X|A|One\nX|A|Two\nX|a|Two", compilation, texts("X|-|V"),
            texts("1|1|1|A|One|NULL|NULL", "1|1|2|A|Two|NULL|NULL", "1|1|3|A|Two|NULL|NULL"));
        row("a box set", "X|A|a|1/2\nX|A|b|1/2\nX|A|c| 2/2 \nX|A|d|1/2", album, texts("X|A|E"),
            texts("1|1|1|A|a|NULL|NULL", "1|1|2|A|b|NULL|NULL", "1|2|1|A|c|NULL|NULL",
                  "1|1|1|A|d|NULL|NULL"));
        row("a set of many", "X|A|a|09/12\nX|B|b|10/12", compilation, texts("X|-|V"),
            texts("1|9|1|A|a|NULL|NULL", "1|10|1|B|b|NULL|NULL"));
        row("totals that differ", "X|A|a|1/2\nX|A|b|2/3",
            "add this album=Yes;A box set cannot be created=Yes;CD imported.", texts("X|A|E"),
            texts("1|1|1|A|a|NULL|NULL", "1|1|2|A|b|NULL|NULL"));
        row("totals that differ, No", "X|A|a|1/2\nX|A|b|2/3",
            "add this album=Yes;A box set cannot be created=No", QStringList(), QStringList());
        row("missing files", "?|?|?|?|?|?", "add this album=Yes;CD imported.", texts("?|?|E"),
            texts("1|1|1|?|?|?|NULL"));
        row("no row", "", album, texts("||E"), QStringList());
        row("No", "X|A|a", "add this album=No", QStringList(), QStringList());
        row("no artist", "X|A|a\nX||b", "error [Songcase] Error at row 5: Name of artist",
            QStringList(), QStringList());
        row("no title", "X|A|", "error [Songcase] Error at row 4: Name of track", QStringList(),
            QStringList());
        row("a total that is none", "X|A|a|1/x", "error [System error] 13 - ", QStringList(),
            QStringList());
        row("a disc of twelve", "X|A|a|10/12\nX|A|b|1/12", "album=Yes;error [System error] 13 - ",
            QStringList(), QStringList());
        row("apostrophe in a genre", "X|A|a\nX|B|b|||Drum 'n bass",
            "compilation=Yes;error [System error] ", QStringList(), QStringList());
    }
    void whatRowsBecome()
    {
        QFETCH(QString, rows);
        QFETCH(QString, boxes);
        const auto browser = new CountingBrowser;
        browser->Load();
        import(rows, boxes);
        QTEST(mCatalogue->rows(titles), "titles");
        QTEST(mCatalogue->rows(links), "links");
        QCOMPARE(browser->refreshed, boxes.contains("imported"_L1) ? 1 : 0);
        const bool isEmpty = mCatalogue->count("select count(*) from CDTitels") == 0;
        QCOMPARE(mCatalogue->count("select count(*) from Artiesten") == 0, isEmpty);
    }

    // A track that is there is used as it is; of two with one name a third is made, of artists too.
    void whatIsThereAlready()
    {
        mCatalogue->exec("insert into Artiesten values (1,'A'),(2,'B'),(3,'b');"
                         "insert into Tracks values (1,1,'One','Pop',1970),(2,1,'Two',null,null),"
                         "(3,1,'two',null,null)");
        import(u"X|a|one||1999|Drum 'n bass\nX|a|Two"_s, u"=Yes;CD imported."_s);
        QCOMPARE(mCatalogue->rows(links), texts("1|1|1|A|One|Pop|1970", "1|1|2|A|Two|NULL|NULL"));
        import(u"Y|B|One"_s, u"=Yes;CD imported."_s);
        QCOMPARE(mCatalogue->count("select count(*) from Artiesten"), 4);
        QCOMPARE(mCatalogue->count("select count(*) from Tracks"), 5);
    }

    void aSecondOfTheSameTitleIsAQuestion()
    {
        const auto cancelled = u";Cancelled importing."_s, imported = u";CD imported."_s;
        const auto album = u"=Yes;An album by A''s entitled 'It''s' is already"_s;
        import(u"It's|A's|One"_s, u"=Yes;CD imported."_s);
        import(u"It's|A's|One"_s, album + u"=No"_s + cancelled);
        import(u"It's|A's|One"_s, album + u"=Yes"_s + imported);
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 2);
        QCOMPARE(mCatalogue->count("select count(*) from Tracks"), 1);
        const auto compilation = u"=Yes;A compilation entitled 'It''s ' is already"_s;
        import(u"It's|B|Two\nIt's|C|Three"_s, compilation + cancelled);
        QCOMPARE(mCatalogue->count("select count(*) from Artiesten"), 1);
        import(u"It's|B|Two\nIt's|C|Three"_s, compilation + u"=Yes"_s + imported);
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 3);
    }

    // In the middle, and at the end of it.
    void whatTheEngineRefusesLeavesNothing_data()
    {
        const DataRows<QString> row("trigger");
        row("a link", "create trigger t after insert on CompactDiscs when new.TrackNo = 2 "
                      "begin select raise(abort, 'no room'); end");
        row("a title", "create trigger t after insert on CDTitels "
                       "begin select raise(rollback, 'no room'); end");
    }
    void whatTheEngineRefusesLeavesNothing()
    {
        QFETCH(QString, trigger);
        mCatalogue->exec(trigger);
        import(u"X|A|a\nX|A|b"_s, u"=Yes;error [System error]"_s);
        QCOMPARE(mCatalogue->count("select count(*) from Artiesten"), 0);
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 0);
        mCatalogue->exec("drop trigger t");
        import(u"X|A|a\nX|A|b"_s, u"=Yes;CD imported."_s);
    }

    // The end of the program comes while the question stands open.
    void theScreenGoesInABox()
    {
        mDesktop->duringBox = [this] {
            QVERIFY(mScreen->isBusy());
            QVERIFY(!mScreen->Unload());
            if (gConnection->State() == ADODB::adStateOpen)
                gConnection->Close();
        };
        import(u"X|A|a"_s, u"=Yes;error"_s);
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 0);
    }
};

QTEST_MAIN(tst_ImportAsCD)
#include "tst_ImportAsCD.moc"
