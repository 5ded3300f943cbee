// Label: screen
#include "collection/frmCDRootE.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/editing.h"

#include <QApplication>
#include <QLabel>
#include <QTest>

/// The editor of albums, as far as it differs from that of compilations: the artist.
class tst_frmCDRootE : public QObject
{
    Q_OBJECT

private slots:
    void init() { mE = std::make_unique<Editing>(languageEnglish); }
    void cleanup() { mE.reset(); }
    void aNewRecord_data();
    void aNewRecord();
    void anUnknownModeIsToldByItsKey();
    void theArtistIsAskedForFirst_data();
    void theArtistIsAskedForFirst();
    void firstSave_data();
    void firstSave();
    void leavingTheGrid();
    void changingTheArtist_data();
    void changingTheArtist();
    void theOldArtistStaysWhereItIsNeeded();
    void theNewArtistsOwnTrackWins();
    void aTrackSharedWithACompilationStays();
    void aSongTwiceOnTheAlbum();
    void twoArtistsOfOneNameGiveAThird();
    void whatASaveTouches_data();
    void whatASaveTouches();
    void aFailureTakesTheArtistBackToo();
    void anAlbumOfTheSameNameByAnother();
    void aChangedArtistAsksAtTheEnd();

private:
    // Album 3 "Album" by Anna (1): tracks 1 and 2 on disc 1, 3 on disc 2. Track 1 is on compilation
    // 4 too. Bob (2) has a track "Two" of his own, on compilation 4.
    CdEditor *openAlbum();
    QStringList artists()
    {
        return mE->catalogue.rows(QStringLiteral("select Naam from Artiesten order by ID"));
    }

    std::unique_ptr<Editing> mE;
};

CdEditor *tst_frmCDRootE::openAlbum()
{
    mE->catalogue.exec(QStringLiteral(R"(
        insert into Artiesten values (1,'Anna'),(2,'Bob');
        insert into Tracks values (1,1,'One','Pop',1985),(2,1,'Two','Jazz',1986),(3,1,'Three',null,null),
            (4,2,'Two','Rock',2000);
        insert into CDTitels values (3,'Album',1,'E','Rock',1999),(4,'Hits',null,'V',null,null);
        insert into CompactDiscs values (1,3,1,1,1,null),(2,3,1,2,2,null),(3,3,2,1,3,null),(4,4,1,1,1,null),
            (5,4,1,2,4,null);)"));
    return mE->open<frmCDRootE>(QStringLiteral("U"), 3);
}

void tst_frmCDRootE::aNewRecord_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<QString>("artist");
    QTest::newRow("English") << languageEnglish << QStringLiteral("Album")
                             << QStringLiteral("Artist:");
    QTest::newRow("Dutch") << languageDutch << QStringLiteral("Enkel-CD")
                           << QStringLiteral("Artiest:");
}

void tst_frmCDRootE::aNewRecord()
{
    QFETCH(int, language);
    gLanguage = language;
    CdEditor *editor = mE->open<frmCDRootE>(QStringLiteral("I"));
    QTEST(editor->windowTitle(), "caption");
    QTEST(mE->control<QLabel>("lblArtist")->text(), "artist");
    QCOMPARE(mE->control<QLabel>("lblHitYear")->text(), GetMessage("HitYear") + QLatin1Char(':'));
    QCOMPARE(QApplication::focusWidget(), mE->field("txtArtiest"));
    QCOMPARE(mE->disk()->objectName(), QStringLiteral("TheDiskE"));
}

void tst_frmCDRootE::anUnknownModeIsToldByItsKey()
{
    mE->desktop.expectBox(QStringLiteral("error [System error] MsgModeFalse"));
    QVERIFY(mE->open<frmCDRootE>(QStringLiteral("x"), 3)->isUnloaded());
}

void tst_frmCDRootE::theArtistIsAskedForFirst_data()
{
    QTest::addColumn<QString>("artist");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("box");
    QTest::newRow("neither") << QString() << QString()
                             << QStringLiteral("artist or band of this album!");
    QTest::newRow("no artist") << QString() << QStringLiteral("T")
                               << QStringLiteral("artist or band of this album!");
    QTest::newRow("no title") << QStringLiteral("A") << QString()
                              << QStringLiteral("the title of this album!");
}

void tst_frmCDRootE::theArtistIsAskedForFirst()
{
    QFETCH(QString, artist);
    QFETCH(QString, title);
    QFETCH(QString, box);
    CdEditor *editor = mE->open<frmCDRootE>(QStringLiteral("I"));
    mE->field("txtArtiest")->setText(artist);
    mE->field("txtTitel")->setText(title);
    mE->field("txtYear")->setText(QStringLiteral("19"));
    mE->desktop.expectBox(box);
    editor->SaveAtUserRequest();
    QCOMPARE(mE->desktop.boxes.size(), 1);
    QVERIFY(artists().isEmpty());
}

void tst_frmCDRootE::firstSave_data()
{
    QTest::addColumn<QString>("artist");
    for (const char *artist : {"Ann \"O'Neill\"", "100%1 _ percent", "\U0001F3B5 duo"})
        QTest::newRow(artist) << QString::fromUtf8(artist);
}

void tst_frmCDRootE::firstSave()
{
    QFETCH(QString, artist);
    CdEditor *editor = mE->open<frmCDRootE>(QStringLiteral("I"));
    keyboard::fill({artist, QStringLiteral("First"), QString(), QStringLiteral("2001")});
    mE->addTracks({QStringLiteral("One|Pop|1985"), QStringLiteral("Two")});
    editor->SaveKeepingPosition();
    QCOMPARE(mE->catalogue.rows(QStringLiteral(
                 "select ID, Titel, Artiest_ID, CD_Type, Genre, Hitjaar from CDTitels")),
             texts("1|First|1|E|NULL|2001"));
    QCOMPARE(mE->tracks(1),
             QStringList({QStringLiteral("1/1 ") + artist + QStringLiteral(" - One"),
                          QStringLiteral("1/2 ") + artist + QStringLiteral(" - Two")}));
    QCOMPARE(editor->Mode, QStringLiteral("U"));
    QCOMPARE(mE->browser->refreshed, 1);
}

void tst_frmCDRootE::leavingTheGrid()
{
    openAlbum();
    mE->disk()->setFocus();
    emit mE->disk()->LeaveForward();
    QCOMPARE(QApplication::focusWidget(), mE->field("txtArtiest"));
    emit mE->disk()->LeaveBackward();
    QCOMPARE(QApplication::focusWidget(), mE->field("txtYear"));
}

void tst_frmCDRootE::changingTheArtist_data()
{
    QTest::addColumn<QString>("artist");
    QTest::addColumn<QStringList>("artistsAfter");
    QTest::addColumn<QStringList>("tracksAfter");
    QTest::newRow("to a new name") << QStringLiteral("Cleo") << texts("Anna", "Bob", "Cleo")
                                   << texts("1/1 Cleo - One", "1/2 Cleo - Two", "2/1 Cleo - Three");
    QTest::newRow("to an existing one")
        << QStringLiteral("bob") << texts("Anna", "Bob")
        << texts("1/1 Bob - One", "1/2 Bob - Two", "2/1 Bob - Three");
    QTest::newRow("of case only") << QStringLiteral("ANNA") << texts("Anna", "Bob")
                                  << texts("1/1 Anna - One", "1/2 Anna - Two", "2/1 Anna - Three");
}

// Anna stays: she has a track on a compilation.
void tst_frmCDRootE::changingTheArtist()
{
    QFETCH(QString, artist);
    CdEditor *editor = openAlbum();
    mE->field("txtArtiest")->setText(artist);
    editor->SaveAtUserRequest();
    QTEST(artists(), "artistsAfter");
    QTEST(mE->tracks(3), "tracksAfter");
    QCOMPARE(mE->tracks(4), texts("1/1 Anna - One", "1/2 Bob - Two"));
    QCOMPARE(mE->browser->refreshed, 1);
}

void tst_frmCDRootE::theOldArtistStaysWhereItIsNeeded()
{
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(QStringLiteral("delete from CompactDiscs where ID=4"));
    mE->field("txtArtiest")->setText(QStringLiteral("Cleo"));
    editor->SaveAtUserRequest();
    QCOMPARE(artists(), texts("Bob", "Cleo"));
    QCOMPARE(mE->catalogue.rows(QStringLiteral(
                 "select Titel, Genre, Hitjaar from Tracks where Artiest_ID=3 order by ID")),
             texts("One|Pop|1985", "Two|Jazz|1986", "Three|NULL|NULL"));
}

void tst_frmCDRootE::theNewArtistsOwnTrackWins()
{
    CdEditor *editor = openAlbum();
    mE->field("txtArtiest")->setText(QStringLiteral("Bob"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.rows(QStringLiteral(
                 "select ID, Genre, Hitjaar from Tracks where Artiest_ID=2 and Titel='Two'")),
             texts("4|Rock|2000"));
    QCOMPARE(mE->catalogue.rows(QStringLiteral("select Track_ID from CompactDiscs where ID=2")),
             texts("4"));
}

void tst_frmCDRootE::aTrackSharedWithACompilationStays()
{
    CdEditor *editor = openAlbum();
    mE->field("txtArtiest")->setText(QStringLiteral("Cleo"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.rows(QStringLiteral(
                 "select Track_ID from CompactDiscs where CDTitels_ID=4 order by TrackNo")),
             texts("1", "4"));
    QCOMPARE(mE->catalogue.rows(QStringLiteral("select Artiest_ID, Titel from Tracks where ID=1")),
             texts("1|One"));
}

void tst_frmCDRootE::aSongTwiceOnTheAlbum()
{
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(QStringLiteral("update CompactDiscs set Track_ID=1 where ID=3"));
    mE->field("txtArtiest")->setText(QStringLiteral("Cleo"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->tracks(3), texts("1/1 Cleo - One", "1/2 Cleo - Two", "2/1 Cleo - One"));
    QCOMPARE(mE->catalogue.count(QStringLiteral("select count(*) from Tracks where Artiest_ID=3")),
             2);
}

void tst_frmCDRootE::twoArtistsOfOneNameGiveAThird()
{
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(QStringLiteral(
        "insert into Artiesten values (7,'anna'); insert into CDTitels values "
        "(9,'X',7,'E',null,null); insert into CompactDiscs values (9,9,1,1,4,null)"));
    mE->field("txtYear")->setText(QStringLiteral("2001"));
    editor->SaveAtUserRequest();
    QCOMPARE(artists(), texts("Anna", "Bob", "anna", "Anna"));
    QCOMPARE(mE->catalogue.rows(QStringLiteral("select Artiest_ID from CDTitels where ID=3")),
             texts("8"));
}

void tst_frmCDRootE::whatASaveTouches_data()
{
    QTest::addColumn<QString>("field");
    QTest::addColumn<bool>("updates");
    QTest::addColumn<bool>("moves");
    QTest::addColumn<int>("refreshes");
    QTest::newRow("nothing") << QString() << false << false << 0;
    QTest::newRow("year") << QStringLiteral("txtYear") << true << false << 0;
    QTest::newRow("title") << QStringLiteral("txtTitel") << true << false << 1;
    QTest::newRow("artist") << QStringLiteral("txtArtiest") << true << true << 1;
}

void tst_frmCDRootE::whatASaveTouches()
{
    QFETCH(QString, field);
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(QStringLiteral(
        "create table Log(x); create trigger t after update on CDTitels begin insert "
        "into Log values ('title'); end; create trigger l after update on CompactDiscs "
        "begin insert into Log values ('link'); end"));
    if (!field.isEmpty())
        mE->editor->findChild<QLineEdit *>(field)->setText(QStringLiteral("2001"));
    editor->SaveAtUserRequest();
    QTEST(mE->catalogue.count(QStringLiteral("select count(*) from Log where x='title'")) > 0,
          "updates");
    QTEST(mE->catalogue.count(QStringLiteral("select count(*) from Log where x='link'")) > 0,
          "moves");
    QTEST(mE->browser->refreshed, "refreshes");
}

void tst_frmCDRootE::aFailureTakesTheArtistBackToo()
{
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(
        QStringLiteral("create trigger refuse before insert on Tracks when new.Titel='Three' "
                       "begin select raise(abort, 'not this one'); end"));
    mE->field("txtArtiest")->setText(QStringLiteral("Cleo"));
    mE->desktop.expectBox(QStringLiteral("not this one"));
    editor->SaveAtUserRequest();
    QCOMPARE(artists(), texts("Anna", "Bob"));
    QCOMPARE(mE->tracks(3), texts("1/1 Anna - One", "1/2 Anna - Two", "2/1 Anna - Three"));
    mE->catalogue.exec(QStringLiteral("drop trigger refuse"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->tracks(3), texts("1/1 Cleo - One", "1/2 Cleo - Two", "2/1 Cleo - Three"));
}

// The id of a deleted album may be given to another of the same name.
void tst_frmCDRootE::anAlbumOfTheSameNameByAnother()
{
    CdEditor *editor = openAlbum();
    mE->catalogue.exec(QStringLiteral("update CDTitels set Artiest_ID=2 where ID=3"));
    mE->field("txtYear")->setText(QStringLiteral("2001"));
    mE->desktop.expectBox(GetMessage("xOtherRecord"));
    editor->SaveAtUserRequest();
    QCOMPARE(
        mE->catalogue.rows(QStringLiteral("select Artiest_ID, Hitjaar from CDTitels where ID=3")),
        texts("2|1999"));
    mE->catalogue.exec(QStringLiteral(
        "delete from CompactDiscs where CDTitels_ID=3; delete from CDTitels where ID=3"));
    editor->SaveAtUserRequest();
    QCOMPARE(mE->catalogue.rows(QStringLiteral(
                 "select Titel, Artiest_ID, CD_Type, Hitjaar from CDTitels where ID=3")),
             texts("Album|1|E|2001"));
    QCOMPARE(mE->tracks(3), texts("1/1 Anna - One", "1/2 Anna - Two"));
}

void tst_frmCDRootE::aChangedArtistAsksAtTheEnd()
{
    CdEditor *editor = openAlbum();
    mE->field("txtArtiest")->setText(QStringLiteral("Cleo"));
    mE->desktop.expectBox(QStringLiteral("Do yo want to save changes?"), vbYes);
    QVERIFY(editor->close());
    QCOMPARE(mE->tracks(3).value(0), QStringLiteral("1/1 Cleo - One"));
}

QTEST_MAIN(tst_frmCDRootE)
#include "tst_frmCDRootE.moc"
