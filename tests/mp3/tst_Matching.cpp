// Label: screen
#include "mp3/frmMatchWithSongcase.h"
#include "mp3/frmTracks.h"
#include "mp3/matchchoice.h"
#include "mp3/matchtags.h"
#include "mp3/matchtree.h"
#include "support/screentest.h"

#include <QCheckBox>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QTreeView>

/// Discs and tracks of the catalogue found for files.
class tst_Matching : public ScreenTest
{
    Q_OBJECT

    QPointer<frmMatchWithSongcase> mForm;

    template <typename Control> Control *in(const char *name) const
    {
        return mForm->findChild<Control *>(QLatin1String(name));
    }
    QTreeView *tree() const { return in<QTreeView>("TreeViewCD"); }
    void press(const char *button) const { in<QPushButton>(button)->click(); }
    void check(const char *box, bool on) const
    {
        if (in<QCheckBox>(box)->isChecked() != on)
            in<QCheckBox>(box)->click();
    }

    void open(int tracks, bool chooseTracks, const QString &artist = {}, const QString &title = {})
    {
        mForm = new frmMatchWithSongcase;
        mForm->NumberOfTracks = tracks;
        mForm->ChooseTracks = chooseTracks;
        mForm->Artist = artist;
        mForm->Title = title;
        mForm->Show();
        QVERIFY(QTest::qWaitForWindowActive(mForm));
    }

    // The texts of the discs, or of the tracks of one.
    QStringList nodes(int disc = -1) const
    {
        QAbstractItemModel *model = tree()->model();
        const QModelIndex parent = disc < 0 ? QModelIndex() : model->index(disc, 0);
        if (model->canFetchMore(parent))
            model->fetchMore(parent);
        QStringList texts;
        for (int row = 0; row < model->rowCount(parent); ++row)
            texts.append(model->index(row, 0, parent).data().toString());
        return texts;
    }

    QString chosen() const
    {
        return gMatchChosen ? u"%1 %2 %3"_s.arg(gMatchCDId).arg(gMatchDiscNo).arg(gMatchTrackNo)
                            : u"none"_s;
    }

private slots:
    void init()
    {
        ScreenTest::init();
        mCatalogue->exec(uR"(
            insert into Artiesten values (1,'Nora'),(2,'Zoë');
            insert into Tracks values (1,1,'One','Rock',1985),(2,2,'Two',null,null);
            insert into CDTitels values (1,'Harbour',1,'E',null,1990),(2,'O''Best',null,'V',null,1990),
                (3,'Alone',2,'E',null,1990);
            insert into CompactDiscs values (1,1,1,1,1,null),(2,1,2,2,2,null),(3,1,2,1,1,null),
                (4,2,1,1,1,null),(5,2,1,2,2,null),(6,3,1,7,2,null);)"_s);
        gMatchChosen = true;
    }

    void search_data()
    {
        const DataRows<int, QString, QString, QString> row("tracks", "boxes", "texts", "found");
        const char *const all = "O'Best Disc 1 (2 tracks)|Nora - Harbour Disc 1 (1 tracks)|"
                                "Nora - Harbour Disc 2 (2 tracks)|Zoë - Alone Disc 1 (1 tracks)";
        row("all", -99, "VE", "|", all);
        row("albums of an artist", -99, "E", "or|",
            "Nora - Harbour Disc 1 (1 tracks)|Nora - Harbour Disc 2 (2 tracks)");
        row("compilations come whatever the artist", -99, "VE", "zoë|",
            "O'Best Disc 1 (2 tracks)|Zoë - Alone Disc 1 (1 tracks)");
        row("compilations alone, by title", -99, "V", "|o'b", "O'Best Disc 1 (2 tracks)");
        row("of two tracks", 2, "VE", "|",
            "O'Best Disc 1 (2 tracks)|Nora - Harbour Disc 2 (2 tracks)");
        row("exactly", -99, "Ex", "nor|", "");
        row("exactly, wild", -99, "Ex", "n_ra|harb%",
            "Nora - Harbour Disc 1 (1 tracks)|Nora - Harbour Disc 2 (2 tracks)");
        row("neither", -99, "", "|", "");
    }
    void search()
    {
        QFETCH(int, tracks);
        QFETCH(QString, boxes);
        QFETCH(QString, texts);
        QFETCH(QString, found);
        open(tracks, false, texts.section(u'|', 0, 0), texts.section(u'|', 1));
        check("chkCompilations", boxes.contains(u'V'));
        check("chkAlbums", boxes.contains(u'E'));
        check("chkExactMatchArtist", boxes.contains(u'x'));
        check("chkExactMatchTitle", boxes.contains(u'x'));
        QCOMPARE(in<QLineEdit>("txtArtist")->isEnabled(), boxes.contains(u'E'));
        QCOMPARE(in<QLineEdit>("txtTitle")->isEnabled(), !boxes.isEmpty());
        if (found.isEmpty())
            mDesktop->expectBox(
                GetMessage(boxes.isEmpty() ? "PleaseCheckMatchFilesWith" : "NoMatchFound"));
        press("cmdSearch");
        QCOMPARE(nodes().join(u'|'), found.isEmpty() ? GetMessage("DefaultTreeText") : found);
        QCOMPARE(in<QPushButton>("cmdChoose")->isEnabled(), !found.isEmpty());
    }

    // What the caller knows is there to be searched for at once.
    void keysAlone()
    {
        open(-99, true, u"Nora"_s, u"Harbour"_s);
        QCOMPARE(in<QLineEdit>("txtArtist")->selectedText(), u"Nora"_s);
        check("chkCompilations", false);
        press("cmdChoose"); // disabled, and the default text is no answer
        QVERIFY(mForm);
        in<QLineEdit>("txtArtist")->setFocus();
        QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
        QCOMPARE(QApplication::focusWidget(), tree());
        QTest::keyClick(tree(), Qt::Key_Down);
        QTest::keyClick(tree(), Qt::Key_Return); // a disc is no track: it opens
        QVERIFY(!mForm->isUnloaded());
        QCOMPARE(nodes(1), texts("Track 1: Nora - One", "Track 2: Zoë - Two"));
        QTest::keyClick(tree(), Qt::Key_Down);
        QTest::keyClick(tree(), Qt::Key_Down);
        QTest::keyClick(tree(), Qt::Key_Enter);
        QCOMPARE(chosen(), u"1 2 2"_s);
    }

    // One press searches and one chooses.
    void proposedTrack()
    {
        open(-99, true, u"Zoë"_s, u"Alone"_s);
        mForm->Track = 7;
        check("chkCompilations", false);
        press("cmdSearch");
        press("cmdChoose");
        QCOMPARE(chosen(), u"3 1 7"_s);
    }

    void tracksThatAreGone()
    {
        open(-99, true);
        press("cmdSearch");
        mCatalogue->exec(u"drop table Tracks"_s);
        mDesktop->expectBox(u"no such table"_s);
        QVERIFY(nodes(0).isEmpty());
        QCoreApplication::processEvents();
        mCatalogue->exec(u"alter table Artiesten rename to X"_s);
        mDesktop->expectBox(u"no such table"_s);
        press("cmdSearch");
        QVERIFY(numberOf([] { tagOfTrack(1, 1, 9); }) != 0);
    }

    void trackOfADisc()
    {
        DiscRecord record;
        auto *form = new frmTracks;
        for (int count : {0, 99}) {
            record.tracks.resize(size_t(count));
            form->setDisc(std::make_shared<CddbDisc>(record, std::make_shared<GenreTable>()));
        }
        form->Show();
        auto *list = form->findChild<QListWidget *>(u"lstTracks"_s);
        QCOMPARE(list->count(), 99);
        QCOMPARE(list->currentItem()->text(), u"1  - "_s);
        list->setCurrentRow(98);
        QTest::keyClick(list, Qt::Key_Return);
        QCOMPARE(form->TrackNum(), 99);
    }
};

QTEST_MAIN(tst_Matching)
#include "tst_Matching.moc"
