// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "discdata/discimport.h"
#include "discdata/frmWhatCD.h"
#include "platform/ado/connection.h"
#include "support/screentest.h"

#include <QPushButton>

namespace
{

const auto titles =
    u"select ID, Titel, Artiest_ID, CD_Type, Genre, Hitjaar from CDTitels order by ID"_s;
const auto discs =
    u"select CDTitels_ID, DiskNo, TrackNo, Naam, Tracks.Titel, Tracks.Genre, Tracks.Hitjaar "
    "from CompactDiscs, Tracks, Artiesten where Track_ID = Tracks.ID and "
    "Tracks.Artiest_ID = Artiesten.ID order by CompactDiscs.ID"_s;

// Tracks by lines "artist|title|genre|year"; those of an album begin with "|".
ADODB::RecordsetPtr tracksOf(const QStringList &lines, bool withArtist)
{
    const auto rows = std::make_shared<ADODB::Recordset>();
    QStringList fields = {u"Nr"_s, u"Artiest"_s, u"Titel"_s, u"Genre"_s, u"Hitjaar"_s};
    if (!withArtist)
        fields.removeAt(1);
    for (const QString &field : std::as_const(fields))
        rows->appendField(field, ADODB::adVarWChar, 255);
    rows->Open();
    for (int number = 1; const QString &line : lines) {
        const QStringList cells = line.split(u'|');
        rows->AddNew();
        rows->Fields(u"Nr").setValue(QString::number(number++));
        if (withArtist)
            rows->Fields(u"Artiest").setValue(cells.value(0));
        rows->Fields(u"Titel").setValue(cells.value(1));
        if (!cells.value(2).isEmpty()) // a genre that is not known stays unset
            rows->Fields(u"Genre").setValue(cells.value(2));
        rows->Fields(u"Hitjaar").setValue(cells.value(3));
    }
    return rows;
}

} // namespace

/// A disc of the screen into the catalogue, with all its questions and refusals.
class tst_DiscImport : public ScreenTest
{
    Q_OBJECT

private:
    bool compilation(const QString &title, const QStringList &tracks,
                     const QString &number = u"1"_s, const QString &total = u"1"_s,
                     const QString &year = u"1999"_s)
    {
        return DiscImport(
                   {u"Various"_s, title, u"Pop"_s, year, number, total, tracksOf(tracks, true)})
            .ImportCompilation();
    }
    bool album(const QString &artist, const QString &title, const QStringList &tracks,
               const QString &number = u"1"_s, const QString &total = u"1"_s)
    {
        return DiscImport({artist, title, {}, {}, number, total, tracksOf(tracks, false)})
            .ImportAlbum();
    }

private slots:
    void compilationWithDummies()
    {
        QVERIFY(
            compilation(u"Hits '99"_s, {u"|"_s, u"  |One|Rock|1970"_s, u"|"_s, u"Édith|Two"_s}));
        QCOMPARE(mCatalogue->rows(titles), QStringList(u"1|Hits '99|NULL|V|Pop|1999"_s));
        QCOMPARE(mCatalogue->rows(discs),
                 (QStringList{u"1|1|1|?|?|NULL|NULL"_s, u"1|1|2|?|One|Rock|1970"_s,
                              u"1|1|3|?|?|NULL|NULL"_s, u"1|1|4|Édith|Two|NULL|NULL"_s}));
        QCOMPARE(mCatalogue->count("select count(*) from Tracks"), 3);
    }

    void albumOfABlankTitle()
    {
        QVERIFY(album(u"O'Neill"_s, u"It's"_s, {u"||Jazz|"_s, u"|B|Jazz|1980"_s}));
        QCOMPARE(mCatalogue->rows(titles), QStringList(u"1|It's|1|E|NULL|NULL"_s));
        QCOMPARE(mCatalogue->rows(discs),
                 (QStringList{u"1|1|1|O'Neill|?|Jazz|NULL"_s, u"1|1|2|O'Neill|B|Jazz|1980"_s}));
    }

    void aSecondOfTheSameTitleIsAQuestion()
    {
        QVERIFY(compilation(u"Hits"_s, {u"A|One"_s}));
        mDesktop->expectBox(u"exactly the same title!"_s, vbNo);
        QVERIFY(!compilation(u"Hits"_s, {u"B|Two"_s}));
        QCOMPARE(mCatalogue->count("select count(*) from Artiesten"), 1);
        mDesktop->expectBox(u"exactly the same title!"_s, vbYes);
        QVERIFY(compilation(u"Hits"_s, {u"B|Two"_s}));

        QVERIFY(album(u"C"_s, u"Hits"_s, {u"|One"_s}));
        mDesktop->expectBox(u"already contains an album of this artist/band"_s, vbNo);
        QVERIFY(!album(u"C"_s, u"Hits"_s, {u"|Two"_s}));
        QCOMPARE(mCatalogue->rows("select Naam from Artiesten"),
                 (QStringList{u"A"_s, u"B"_s, u"C"_s}));
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 3);
    }

    // A song that is there already: silently where no other disc has it, else as the user says.
    void songsThatAreThere()
    {
        mCatalogue->exec(
            "insert into Artiesten values (1,'A''s'); insert into Tracks values "
            "(1,1,'Shared','Rock',1970),(2,1,'Lone','Rock',1970),(3,1,'Same','Pop',1980);"
            "insert into CDTitels values (1,'Old',NULL,'V',NULL,NULL);"
            "insert into CompactDiscs values (1,1,1,1,1,NULL)");
        mDesktop->expectBox(u"yes-no [Wijzigen track] Track title 1 by ''A''s'' also appears"_s,
                            vbNo);
        QVERIFY(compilation(
            u"New"_s, {u"A's|Shared|Pop|1971"_s, u"A's|Lone||1971"_s, u"A's|Same|Pop|1980"_s}));
        QCOMPARE(mCatalogue->rows("select Genre, Hitjaar from Tracks order by ID"),
                 (QStringList{u"Rock|1970"_s, u"NULL|1971"_s, u"Pop|1980"_s}));
        mDesktop->expectBox(u"by '''A''s''' also"_s, vbYes);
        QVERIFY(album(u"A's"_s, u"Third"_s, {u"|Shared|Pop|1971"_s}));
        QCOMPARE(mCatalogue->rows("select Genre, Hitjaar from Tracks where ID = 1"),
                 QStringList(u"Pop|1971"_s));
        QCOMPARE(mCatalogue->count("select count(*) from Tracks"), 3);
    }

    void boxSetInOrder()
    {
        mDesktop->expectBox(u"Currently the database contains no CD's of this type"_s);
        QVERIFY(!compilation(u"Box"_s, {u"A|One"_s}, u"2"_s, u"3"_s));
        QVERIFY(compilation(u"Box"_s, {u"A|One"_s}, u"1"_s, u"3"_s));
        mDesktop->expectBox(u"Please first fill in disc number 2 of this box set!"_s);
        QVERIFY(!compilation(u"Box"_s, {u"A|Three"_s}, u"3"_s, u"3"_s));
        QVERIFY(compilation(u"Box"_s, {u"A|Two"_s}, u"2"_s, u"3"_s));
        QVERIFY(compilation(u"box"_s, {u"A|Three"_s}, u"3"_s, u"3"_s));
        mDesktop->expectBox(u"Total number of discs in this set is already inserted"_s);
        QVERIFY(!compilation(u"Box"_s, {u"A|Four"_s}, u"3"_s, u"3"_s));
        QCOMPARE(mCatalogue->rows("select DiskNo from CompactDiscs order by ID"),
                 (QStringList{u"1"_s, u"2"_s, u"3"_s}));
        QCOMPARE(mCatalogue->count("select count(*) from CDTitels"), 1);
    }

    // Texts are compared, so "3" comes behind "12".
    void thirdOfTwelve()
    {
        QVERIFY(album(u"A"_s, u"Box"_s, {u"|One"_s}, u"1"_s, u"12"_s));
        mDesktop->expectBox(u"Total number of discs in this set is already inserted"_s);
        QVERIFY(!album(u"A"_s, u"Box"_s, {u"|Two"_s}, u"2"_s, u"12"_s));
        mDesktop->expectBox(u"Please fill in disc number 1 of this box set!"_s);
        QVERIFY(!album(u"Nobody"_s, u"Box"_s, {u"|Two"_s}, u"2"_s, u"12"_s));
    }

    void titleOfTheSetIsChosen()
    {
        QVERIFY(album(u"A"_s, u"The Box"_s, {u"|One"_s}, u"1"_s, u"2"_s));
        QVERIFY(album(u"B"_s, u"Other"_s, {u"|One"_s}));
        mDesktop->expectModal(u"frmWhatCD"_s, [](Form &form) {
            auto *list = form.findChild<DBListViewCTL *>(u"CDList"_s);
            QCOMPARE(list->ListItems().Count(), 1); // what holds the text before the bracket
            form.findChild<QPushButton *>(u"cmdShowAll"_s)->click();
            QCOMPARE(list->ListItems().Count(), 2);
            list->setSelectedItem(list->ListItems().Item(1));
            form.findChild<QPushButton *>(u"OKButton"_s)->click();
        });
        QVERIFY(album(u"A"_s, u"Box (Disc 2: It's)"_s, {u"|Two"_s}, u"2"_s, u"2"_s));
        QCOMPARE(mCatalogue->rows("select CDTitels_ID, DiskNo from CompactDiscs where DiskNo > 1"),
                 QStringList(u"1|2"_s));

        mDesktop->expectModal(u"frmWhatCD"_s, [](Form &form) {
            form.findChild<QPushButton *>(u"CancelButton"_s)->click();
        });
        QVERIFY(!album(u"A"_s, u"Nothing like it"_s, {u"|Two"_s}, u"2"_s, u"2"_s));
        mCatalogue->exec("update CDTitels set cd_type = 'V'");
        mDesktop->expectBox(u"CD's of this type have not yet been imported"_s);
        mDesktop->expectModal(u"frmWhatCD"_s, [](Form &form) {
            QVERIFY(!form.findChild<DBListViewCTL *>(u"CDList"_s)->isEnabled());
            form.findChild<QPushButton *>(u"OKButton"_s)->click();
        });
        QVERIFY(!album(u"A"_s, u"Gone"_s, {u"|Two"_s}, u"2"_s, u"2"_s));
    }

    void noTracks()
    {
        mDesktop->expectBox(u"No track info available!"_s);
        QVERIFY(!album(u"A"_s, u"Empty"_s, {}));
        QCOMPARE(mCatalogue->count(
                     "select (select count(*) from Artiesten) + (select count(*) from CDTitels)"),
                 0);
    }

    // What stands half-written is rolled back before anything else is written.
    void anErrorIsToldAndLeavesNothing_data()
    {
        const DataRows<QString, QString> row("year", "trackYear");
        row("of the disc", "19x5", "");
        row("of a track", "1985", "1985) --");
    }

    void anErrorIsToldAndLeavesNothing()
    {
        QFETCH(QString, year);
        QFETCH(QString, trackYear);
        mDesktop->expectBox(u"error [System error] "_s);
        QVERIFY(!compilation(u"Broken"_s, {u"A|One||1980"_s, u"A|Two||"_s + trackYear}, u"1"_s,
                             u"1"_s, year));
        QVERIFY(album(u"B"_s, u"Whole"_s, {u"|One"_s}));
        QCOMPARE(mCatalogue->rows("select Naam from Artiesten"), QStringList(u"B"_s));
        QCOMPARE(mCatalogue->rows("select Titel from CDTitels"), QStringList(u"Whole"_s));
        QCOMPARE(mCatalogue->count("select count(*) from CompactDiscs"), 1);
    }
};

QTEST_MAIN(tst_DiscImport)
#include "tst_DiscImport.moc"
