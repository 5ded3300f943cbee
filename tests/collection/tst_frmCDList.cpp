// Label: screen
#include "collection/frmCDList.h"
#include "controls/list/DBListViewCTL.h"
#include "mp3/frmCDRootMP3.h"
#include "platform/ado/connection.h"
#include "support/editing.h"
#include "support/screentest.h"

#include <QPushButton>
#include <QStatusBar>
#include <QTabWidget>

/// The browser on a real catalogue file.
class tst_frmCDList : public ScreenTest
{
    Q_OBJECT

private slots:
    void anEmptyCatalogue()
    {
        mCatalogue->exec(u"insert into CDTitels values (1,'Only',null,'V',null,null)"_s);
        show();
        mDesktop->expectBox(u"yes-no"_s, vbYes);
        QTest::keyClick(list("ColList"), Qt::Key_Delete);
        QVERIFY(!list("ColList")->SelectedItem());
        for (const char *name : {"ColList", "SngList", "MP3List"})
            QVERIFY(!list(name)->isEnabled() && list(name)->ListItems().Count() == 0);
        QVERIFY(!button("cmdUpdate")->isEnabled() && !button("cmdDelete")->isEnabled());
        QCOMPARE(status(), u"Number of compilations in your collection: 0"_s);
    }

    void listsAreSortedOnTheirFirstColumn()
    {
        fill();
        show();
        QCOMPARE(column(list("ColList"), 1), texts("Best, the", "Übel"));
        QCOMPARE(column(list("SngList"), 1), texts("alone", "Eddy", "Édith"));
        QCOMPARE(column(list("MP3List"), 1), texts("/a", "/b"));
        emit list("SngList")->ColumnClick(3);
        QCOMPARE(column(list("SngList"), 2), texts("Aap", "Mid", "Zebra"));
    }

    void pagesShowTheirCommandsAndCounts()
    {
        fill();
        show();
        const auto counts = texts(
            "compilations in your collection: 2", "albums in your collection: 3",
            "different tracks in your collection: 4", "MP3 collections in your collection: 2");
        const char *const lists[] = {"ColList", "SngList", "Platenbak", "MP3List"};
        for (int i : {1, 2, 3, 0}) {
            page(i);
            QCOMPARE(button("cmdInsert")->isVisible(), i != 2);
            QCOMPARE(button("cmdDelete")->isVisible(), i != 2);
            QCOMPARE(button("cmdDelete")->isEnabled(), i != 2);
            QCOMPARE(button("cmdStartReport")->isEnabled(), i != 3);
            QCOMPARE(status(), u"Number of "_s + counts[i]);
            QCOMPARE(mScreen->focusWidget(), control<QWidget>(lists[i]));
        }
    }

    void deleteRemovesWhatTheDiscAloneHeld()
    {
        fill();
        show();
        page(1);
        select("SngList", 1); // Mid, by alone
        pressDelete();
        QCOMPARE(mCatalogue->rows(u"select Naam from Artiesten order by ID"_s),
                 texts("Zed", "Édith", "Eddy"));
        QCOMPARE(mCatalogue->rows(u"select ID from Tracks"_s), texts("1", "2", "4"));
        QCOMPARE(column(list("SngList"), 2), texts("Aap", "Zebra"));
        // Track 2 stands on a compilation too: it stays with its artist.
        select("SngList", 2);
        pressDelete();
        QCOMPARE(mCatalogue->count(u"select count(*) from Tracks where ID=2 and Artiest_ID=2"_s),
                 1);
    }

    void noStillCleansUp()
    {
        fill();
        mCatalogue->exec(u"insert into Artiesten values (9,'Nobody')"_s);
        show();
        pressDelete(vbNo);
        QCOMPARE(mCatalogue->count(u"select count(*) from Artiesten where ID=9"_s), 0);
        QCOMPARE(mCatalogue->count(u"select count(*) from CDTitels"_s), 5);
    }

    void deleteOfAnMP3Collection()
    {
        fill();
        mCatalogue->exec(u"insert into Artiesten values (9,'Nobody')"_s);
        show();
        page(3);
        pressDelete();
        QCOMPARE(mCatalogue->rows(u"select ID, Map from MP3Collections"_s), texts("1|/b"));
        QCOMPARE(mCatalogue->rows(u"select ID from MP3Files"_s), texts("1"));
        QCOMPARE(mCatalogue->count(u"select count(*) from Artiesten where ID=9"_s), 1);
    }

    void aFailedDeleteTakesAllBack()
    {
        fill();
        mCatalogue->exec(u"create trigger refuse before delete on CDTitels when old.ID=2 "
                         "begin select raise(abort, 'not this one'); end"_s);
        show();
        mDesktop->expectBox(u"yes-no"_s, vbYes);
        mDesktop->expectBox(u"not this one"_s);
        mDesktop->expectBox(u"not this one"_s);
        button("cmdDelete")->click();
        QCOMPARE(mCatalogue->count(u"select count(*) from CompactDiscs where CDTitels_ID=2"_s), 1);
        QVERIFY(mScreen->updatesEnabled());
    }

    // Above a size nobody compares indexes with their tables beforehand.
    void aDamagedIndexLeavesNoLinksBehind()
    {
        fill();
        OtherProgram(mCatalogue->file())
            .run("create table Kept as select * from sqlite_schema where name='CompactDiscsTitel';"
                 "pragma writable_schema=on;"
                 "delete from sqlite_schema where name='CompactDiscsTitel'");
        OtherProgram(mCatalogue->file())
            .run("insert into CompactDiscs select 99, CDTitels_ID, 1, 50, Track_ID, null from "
                 "CompactDiscs where CDTitels_ID=2; pragma writable_schema=on;"
                 "insert into sqlite_schema select * from Kept; drop table Kept");
        show();
        mDesktop->expectBox(u"yes-no"_s, vbYes);
        mDesktop->expectBox(u"malformed"_s);
        mDesktop->expectBox(u"malformed"_s); // the clean-up's own
        button("cmdDelete")->click();
        QCOMPARE(mCatalogue->count(u"select count(*) from CDTitels"_s), 5);
    }

    void theRememberedRowIsSelectedAgain()
    {
        for (int i = 1; i <= 7; ++i)
            mCatalogue->exec(u"insert into CDTitels values (%1,'T%1',null,'V',null,null);"
                             "insert into CompactDiscs values (%1,%1,1,1,1,null)"_s.arg(i));
        show();
        auto *col = list("ColList");
        QTest::keyClick(col, Qt::Key_End);
        QCOMPARE(col->SelectedItem().Index(), 7);
        mScreen->RefreshLists();
        QCOMPARE(col->SelectedItem().Index(), 7);
        mCatalogue->exec(u"delete from CDTitels where ID > 5"_s);
        mScreen->RefreshLists();
        QCOMPARE(col->SelectedItem().Index(), 5);
    }

    void keysInAList()
    {
        fill();
        show();
        QTest::keyClicks(list("ColList"), u".-!\"#"_s); // signs, no Delete or Insert
        mDesktop->expectBox(u"yes-no"_s, vbNo);
        QTest::keyClick(list("ColList"), Qt::Key_Delete);
        QTest::keyClick(mScreen, Qt::Key_Escape);
        QVERIFY(mScreen->isUnloaded());
    }

    void adding()
    {
        fill();
        show();
        button("cmdInsert")->click();
        QTest::keyClick(list("ColList"), Qt::Key_Insert, Qt::ControlModifier);
        QCOMPARE(openEditors(), texts("frmCDRoot I 0"));
        page(1);
        QTest::keyClick(list("SngList"), Qt::Key_Insert);
        QCOMPARE(openEditors(), texts("frmCDRoot I 0", "frmCDRootE I 0"));
    }

    void editing()
    {
        fill();
        show();
        DBListViewCTL *rows = list("ColList");
        button("cmdUpdate")->click();
        QTest::keyClick(rows, Qt::Key_Return); // one editor per record
        QCOMPARE(openEditors(), texts("frmCDRoot U 2"));
        const QPoint second = rows->visualRect(rows->model()->index(1, 1)).center();
        QTest::mouseDClick(rows->viewport(), Qt::LeftButton, {}, second);
        QCOMPARE(openEditors(), texts("frmCDRoot U 2", "frmCDRoot U 1"));
        page(1);
        select("SngList", 2);
        QTest::keyClick(list("SngList"), Qt::Key_Return);
        QCOMPARE(openEditors().last(), u"frmCDRootE U 4"_s);
    }

    void mp3Collections()
    {
        fill();
        show();
        page(3);
        for (const auto key : {Qt::Key_Return, Qt::Key_Return, Qt::Key_Insert, Qt::Key_Insert})
            QTest::keyClick(list("MP3List"), key);
        QStringList open;
        for (Form *form : Form::openForms()) {
            if (const auto *editor = qobject_cast<frmCDRootMP3 *>(form))
                open.append(editor->Mode + QString::number(editor->CollectionId));
        }
        QCOMPARE(open, texts("U2", "I-999", "I-999"));
        mDesktop->expectBox(u"delete this MP3 collection"_s, vbYes);
        control<QPushButton>("cmdDelete")->click();
        QVERIFY(Form::openForms()[1]->windowTitle().endsWith(u"First - deleted"_s));
    }

    void aLargePageIsReadWhenItIsLookedAt()
    {
        fill();
        mCatalogue->exec(u"with recursive n(i) as (select 11 union all select i+1 from n where "
                         "i<10100) insert into CDTitels select i,'T'||i,2,'E',null,null from n"_s);
        show();
        const int before = list("SngList")->ListItems().Count();
        mCatalogue->exec(u"delete from CDTitels where ID in (1, 5)"_s);
        mScreen->RefreshLists();
        QCOMPARE(column(list("ColList"), 1), texts("Best, the"));
        QCOMPARE(list("SngList")->ListItems().Count(), before);
        page(1);
        QCOMPARE(list("SngList")->ListItems().Count(), before - 1);
        QVERIFY(status().endsWith(QString::number(before - 1)));
        mCatalogue->exec(u"delete from CDTitels where ID = 3"_s);
        mScreen->RefreshLists();
        QCOMPARE(list("SngList")->ListItems().Count(), before - 2);
    }

    void tracksAreCountedWhenTheirPageShows()
    {
        mCatalogue->exec(u"alter table Tracks rename to Elsewhere"_s);
        show();
        mScreen->RefreshLists();
        mDesktop->expectBox(u"error [Unable to initialise list!]"_s);
        mDesktop->expectBox(u"no such table"_s);
        page(2);
        mCatalogue->exec(u"alter table Elsewhere rename to Tracks;"
                         "insert into Tracks values (1,1,'One',null,null)"_s);
        mScreen->RefreshLists();
        QCOMPARE(status(), u"Number of different tracks in your collection: 1"_s);
    }

private:
    // Two compilations, three albums, two collections. Track 2 stands on compilation 2 and album 3;
    // artist 3 has album 5 alone.
    void fill()
    {
        mCatalogue->exec(uR"(
            insert into Artiesten values (1,'Zed'),(2,'Édith'),(3,'alone'),(4,'Eddy');
            insert into Tracks values (1,1,'One',null,null),(2,2,'Two',null,1985),(3,3,'Three',null,null),
                (4,4,'Four',null,null);
            insert into CDTitels values (1,'Übel',null,'V',null,null),(2,'Best, the',null,'v',null,null),
                (3,'Zebra',2,'E',null,null),(4,'Aap',4,'E',null,null),(5,'Mid',3,'E',null,null);
            insert into CompactDiscs values (1,1,1,1,1,null),(2,2,1,1,2,null),(3,3,1,1,2,null),(4,4,1,1,4,null),
                (5,5,1,1,3,null);
            insert into MP3Collections values (1,'/b','Second'),(2,'/a','First');
            insert into MP3Files values (1,1,'x.mp3',1),(2,1,'y.mp3',2);)"_s);
    }

    void show()
    {
        mScreen = new frmCDList;
        mScreen->Show();
        mScreen->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(mScreen));
    }

    template <typename Control> Control *control(const char *name) const
    {
        return mScreen->findChild<Control *>(QLatin1String(name));
    }
    QPushButton *button(const char *name) const { return control<QPushButton>(name); }
    void pressDelete(BoxAnswer answer = vbYes)
    {
        mDesktop->expectBox(u"yes-no [Delete] Are you"_s, answer);
        button("cmdDelete")->click();
    }
    void select(const char *name, int n) const
    {
        list(name)->setSelectedItem(list(name)->ListItems().Item(n));
    }
    DBListViewCTL *list(const char *name) const { return control<DBListViewCTL>(name); }
    void page(int index) { control<QTabWidget>("CDTab")->setCurrentIndex(index); }
    QString status() const { return control<QStatusBar>("TheStatusBar")->currentMessage(); }
    static QStringList column(DBListViewCTL *list, int n)
    {
        QStringList found;
        for (int i = 1; i <= list->ListItems().Count(); ++i)
            found.append(list->ListItems().Item(i).SubItems(n));
        return found;
    }

    QPointer<frmCDList> mScreen;
};

QTEST_MAIN(tst_frmCDList)
#include "tst_frmCDList.moc"
