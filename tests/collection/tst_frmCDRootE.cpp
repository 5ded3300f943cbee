// Label: screen
#include "collection/frmCDRootE.h"
#include "support/editing.h"

#include <QApplication>

/// The editor of albums, as far as it differs from that of compilations: the artist.
class tst_frmCDRootE : public QObject
{
    Q_OBJECT

private:
    // Album 3 "Album" by Anna (1): tracks 1 and 2 on disc 1, 3 on disc 2. Track 1 is on compilation
    // 4 too. Bob (2) has a track "Two" of his own, on compilation 4.
    CdEditor *openAlbum()
    {
        mE->catalogue.exec(R"(
            insert into Artiesten values (1,'Anna'),(2,'Bob');
            insert into Tracks values (1,1,'One','Pop',1985),(2,1,'Two','Jazz',1986),(3,1,'Three',null,null),
                (4,2,'Two','Rock',2000);
            insert into CDTitels values (3,'Album',1,'E','Rock',1999),(4,'Hits',null,'V',null,null);
            insert into CompactDiscs values (1,3,1,1,1,null),(2,3,1,2,2,null),(3,3,2,1,3,null),(4,4,1,1,1,null),
                (5,4,1,2,4,null);)");
        return mE->open<frmCDRootE>("U", 3);
    }

    QStringList artists() { return mE->catalogue.rows("select Naam from Artiesten order by ID"); }

    std::unique_ptr<Editing> mE;

private slots:
    void init() { mE = std::make_unique<Editing>(languageEnglish); }
    void cleanup() { mE.reset(); }

    void theArtistIsTheFirstField()
    {
        mE->open<frmCDRootE>("I");
        QCOMPARE(QApplication::focusWidget(), mE->field("txtArtiest"));
        mE->disk()->setFocus();
        emit mE->disk()->LeaveForward();
        QCOMPARE(QApplication::focusWidget(), mE->field("txtArtiest"));
        emit mE->disk()->LeaveBackward();
        QCOMPARE(QApplication::focusWidget(), mE->field("txtYear"));
    }

    void anUnknownModeIsToldByItsKey()
    {
        mE->desktop.expectBox(u"error [System error] MsgModeFalse"_s);
        QVERIFY(mE->open<frmCDRootE>("x", 3)->isUnloaded());
    }

    void theArtistIsAskedForFirst()
    {
        CdEditor *editor = mE->open<frmCDRootE>("I");
        mE->field("txtYear")->setText(u"19"_s);
        mE->desktop.expectBox(u"artist or band of this album!"_s);
        editor->SaveAtUserRequest();
        mE->field("txtArtiest")->setText(u"A"_s);
        mE->desktop.expectBox(u"the title of this album!"_s);
        editor->SaveAtUserRequest();
        QVERIFY(artists().isEmpty());
    }

    void changingTheArtist_data()
    {
        // told: the spelling that the catalogue keeps
        const DataRows<QString, QStringList, QStringList, QString> row("artist", "artistsAfter",
                                                                       "tracksAfter", "told");
        row("to a new name", "Cleo", texts("Anna", "Bob", "Cleo"),
            texts("1/1 Cleo - One", "1/2 Cleo - Two", "2/1 Cleo - Three"), "");
        const auto bobs = texts("1/1 Bob - One", "1/2 Bob - Two", "2/1 Bob - Three");
        row("to an existing one", "Bob", texts("Anna", "Bob"), bobs, "");
        row("to one in other letters", "bob", texts("Anna", "Bob"), bobs, "Bob");
        row("to one with blanks around", "\tBob ", texts("Anna", "Bob"), bobs, "");
        row("of case only", "ANNA", texts("Anna", "Bob"),
            texts("1/1 Anna - One", "1/2 Anna - Two", "2/1 Anna - Three"), "Anna");
    }

    // Anna stays: she has a track on a compilation.
    void changingTheArtist()
    {
        QFETCH(QString, artist);
        CdEditor *editor = openAlbum();
        QFETCH(QString, told);
        mE->field("txtArtiest")->setText(artist);
        if (!told.isEmpty())
            mE->desktop.expectBox(GetMessage("xKeptArtist") + told);
        editor->SaveAtUserRequest();
        editor->SaveAtUserRequest(); // nothing more, and nothing is told again
        QCOMPARE(mE->field("txtArtiest")->text(), told.isEmpty() ? artist.trimmed() : told);
        QTEST(artists(), "artistsAfter");
        QTEST(mE->tracks(3), "tracksAfter");
        QCOMPARE(mE->tracks(4), texts("1/1 Anna - One", "1/2 Bob - Two"));
        QCOMPARE(mE->catalogue.rows("select Genre, Hitjaar from Tracks where ID=4"),
                 texts("Rock|2000")); // Bob's own "Two" keeps its own
        QCOMPARE(mE->browser->refreshed, 1);
    }

    void theOldArtistStaysWhereItIsNeeded()
    {
        CdEditor *editor = openAlbum();
        mE->catalogue.exec("delete from CompactDiscs where ID=4");
        mE->field("txtArtiest")->setText(u"Cleo"_s);
        editor->SaveAtUserRequest();
        QCOMPARE(artists(), texts("Bob", "Cleo"));
        QCOMPARE(mE->catalogue.rows(
                     "select Titel, Genre, Hitjaar from Tracks where Artiest_ID=3 order by ID"),
                 texts("One|Pop|1985", "Two|Jazz|1986", "Three|NULL|NULL"));
    }

    void twoArtistsOfOneNameGiveAThird()
    {
        CdEditor *editor = openAlbum();
        mE->catalogue.exec(
            "insert into Artiesten values (7,'anna'); insert into CDTitels values "
            "(9,'X',7,'E',null,null); insert into CompactDiscs values (9,9,1,1,4,null)");
        mE->field("txtYear")->setText(u"2001"_s);
        editor->SaveAtUserRequest();
        QCOMPARE(artists(), texts("Anna", "Bob", "anna", "Anna"));
        QCOMPARE(mE->catalogue.rows("select Artiest_ID from CDTitels where ID=3"), texts("8"));
    }

    void aFailureTakesTheArtistBackToo()
    {
        CdEditor *editor = openAlbum();
        mE->catalogue.exec("create trigger refuse before insert on Tracks when new.Titel='Three' "
                           "begin select raise(abort, 'not this one'); end");
        mE->field("txtArtiest")->setText(u"Cleo"_s);
        mE->desktop.expectBox(u"not this one"_s);
        editor->SaveAtUserRequest();
        QCOMPARE(artists(), texts("Anna", "Bob"));
        QCOMPARE(mE->tracks(3), texts("1/1 Anna - One", "1/2 Anna - Two", "2/1 Anna - Three"));
    }

    // The id of a deleted album may be given to another of the same name.
    void anAlbumOfTheSameNameByAnother()
    {
        CdEditor *editor = openAlbum();
        mE->catalogue.exec("update CDTitels set Artiest_ID=2 where ID=3");
        mE->field("txtYear")->setText(u"2001"_s);
        mE->desktop.expectBox(GetMessage("xOtherRecord"));
        editor->SaveAtUserRequest();
        QCOMPARE(mE->catalogue.rows("select Artiest_ID, Hitjaar from CDTitels where ID=3"),
                 texts("2|1999"));
        mE->catalogue.exec(
            "delete from CompactDiscs where CDTitels_ID=3; delete from CDTitels where ID=3");
        mE->desktop.expectBox(GetMessage("xSaveAnew"), vbYes);
        editor->SaveAtUserRequest();
        QCOMPARE(mE->catalogue.rows("select Titel, Artiest_ID, CD_Type, Hitjaar from CDTitels"),
                 texts("Hits|NULL|V|NULL", "Album|1|E|2001"));
        QCOMPARE(mE->tracks(editor->CdId), texts("1/1 Anna - One", "1/2 Anna - Two"));
    }
};

QTEST_MAIN(tst_frmCDRootE)
#include "tst_frmCDRootE.moc"
