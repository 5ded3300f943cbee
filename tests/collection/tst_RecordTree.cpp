// Label: screen
#include "collection/frmCDList.h"
#include "collection/recordtree.h"
#include "controls/list/DBListViewCTL.h"
#include "support/editing.h"
#include "support/screentest.h"

#include <QElapsedTimer>
#include <QTabWidget>

/// The record tree in the browser, level by level, down to the editor of a disc.
class tst_RecordTree : public ScreenTest
{
    Q_OBJECT

private:
    // Track 1 stands on compilation 1 and album 2, and twice on disc 2 of the album.
    void fill()
    {
        mCatalogue->exec(R"(
            insert into Artiesten values (1,'Zed'),(2,'Édith'),(3,'eddy'),(4,'10cc'),(5,'''Til'),(12,'Emma');
            insert into Tracks values (1,12,'Same',null,null),(2,12,'another',null,null),(3,1,'Z',null,null),
                (4,2,'E',null,null),(5,3,'e',null,null),(6,4,'10',null,null),(7,5,'t',null,null);
            insert into CDTitels values (1,'Best of 1990',null,'v',null,null),(2,'Album',12,'E',null,null);
            insert into CompactDiscs values (1,1,1,3,1,null),(2,2,2,1,1,null),(3,2,2,5,1,null),(4,2,1,1,2,null),
                (5,1,1,1,3,null),(6,1,1,2,4,null),(7,1,1,4,5,null),(8,1,1,5,6,null),(9,1,1,6,7,null);)");
    }

    void show()
    {
        mScreen = new frmCDList;
        mScreen->Show();
        mScreen->findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(2);
        mTree = mScreen->findChild<RecordTree *>(u"Platenbak"_s);
        mScreen->activateWindow();
        QVERIFY(QTest::qWaitForWindowActive(mScreen));
    }

    QTreeWidgetItem *open(const char *key)
    {
        QTreeWidgetItem *node = mTree->node(QLatin1String(key));
        if (node)
            node->setExpanded(true);
        else
            QTest::qFail(key, __FILE__, __LINE__);
        return node;
    }

    static QStringList below(const QTreeWidgetItem *node, bool keys = false)
    {
        QStringList found;
        for (int i = 0; i < node->childCount(); ++i)
            found.append(keys ? RecordTree::keyOf(node->child(i)) : node->child(i)->text(0));
        return found;
    }

    void click(const QString &key)
    {
        QTreeWidgetItem *node = mTree->node(key);
        mTree->scrollToItem(node);
        QTest::mouseClick(mTree->viewport(), Qt::LeftButton, {},
                          mTree->visualItemRect(node).center());
    }

    QPointer<frmCDList> mScreen;
    RecordTree *mTree = nullptr;

private slots:
    void closedNodesHoldAPlaceholder_data()
    {
        const DataRows<int, QString> row("language", "other");
        row("English", languageEnglish, "Other");
        row("Dutch", languageDutch, "Overige");
    }

    void closedNodesHoldAPlaceholder()
    {
        QFETCH(int, language);
        QFETCH(QString, other);
        gLanguage = language;
        fill();
        show();
        QCOMPARE(mTree->topLevelItemCount(), 27);
        QCOMPARE(below(mTree->topLevelItem(4), true), texts("dummyArtistE"));
        QCOMPARE(below(mTree->topLevelItem(4)), texts("dummyE"));
        QCOMPARE(below(mTree->node(other), true), QStringList(u"dummyArtist"_s + other));
        open("E");
        QCOMPARE(below(mTree->node(u"A12"_s), true), texts("dummyTA12"));
        QCOMPARE(below(open("A12")->child(0), true), texts("dummyCT2"));
    }

    void artistsUnderTheirRoots_data()
    {
        const DataRows<QByteArray, QStringList> row("root", "artists");
        row("either case, not accents", "E", texts("eddy", "Emma"));
        row("digits", "Other", texts("10cc"));
        row("not signs", "T", QStringList());
    }

    void artistsUnderTheirRoots()
    {
        QFETCH(QByteArray, root);
        fill();
        show();
        QTEST(below(open(root.constData())), "artists");
    }

    void fromArtistToDisc()
    {
        fill();
        show();
        open("E");
        QCOMPARE(below(open("A12")), texts("another", "Same"));
        QCOMPARE(below(open("T1")), texts("Album (Track 1 of disc 2)", "Album (Track 5 of disc 2)",
                                          "Best of 1990 (Track 3 of disc 1)"));
        QCOMPARE(mTree->node(u"C1"_s)->childCount(), 0);
    }

    void aDiscOpensItsEditor()
    {
        fill();
        show();
        for (const char *key : {"E", "A12", "T1"})
            open(key);
        click(u"C3"_s);
        QCOMPARE(openEditors(), texts("frmCDRootE U 2"));
        click(u"C2"_s);
        QCOMPARE(openEditors().size(), 1);
        mTree->setCurrentItem(mTree->node(u"C1"_s));
        QTest::keyClick(mTree, Qt::Key_Return);
        QCOMPARE(openEditors(), texts("frmCDRootE U 2", "frmCDRoot U 1"));
    }

    // A catalogue that somebody prepared: tables without keys, with ids that are missing, doubled
    // or no numbers.
    void rowsThatTheRulesForbid()
    {
        mCatalogue->exec(R"(
            drop table Artiesten; create table Artiesten(ID, Naam);
            drop table Tracks; create table Tracks(ID, Artiest_ID, Titel, Genre, Hitjaar);
            drop table CDTitels; create table CDTitels(ID, Titel, Artiest_ID, CD_Type, Genre, Hitjaar);
            drop table CompactDiscs;
            create table CompactDiscs(ID, CDTitels_ID, DiskNo, TrackNo, Track_ID, Opmerking);
            insert into Artiesten values (null,'Abby'),(1,'Abe'),('1 or 1','Al'),(1,'Ann');
            insert into Tracks values (1,1,'One',null,null),(1,1,'Two',null,null),(null,1,'X',null,null);
            insert into CDTitels values (3,'Hits',null,'V',null,null),(3,'Hits',null,'V',null,null),
                (null,'None',null,'V',null,null);
            insert into CompactDiscs values (1,3,1,1,1,null),(1,3,1,2,1,null),(null,3,1,3,1,null),
                ('x',3,1,4,1,null);)");
        show();
        QCOMPARE(below(open("A")), texts("Abe"));
        QCOMPARE(below(open("A1")), texts("One"));
        QCOMPARE(below(open("T1"), true), texts("C1"));
        mTree->expandAll();
        click(u"C1"_s);
        QCOMPARE(openEditors(), texts("frmCDRoot U 3"));
        mScreen->RefreshLists();
        open("A");
        mScreen->findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(0);
        auto *list = mScreen->findChild<DBListViewCTL *>(u"ColList"_s);
        mDesktop->expectBox(GetMessage("MsgInitFalse"));
        for (int row = 1; row <= list->ListItems().Count(); ++row) {
            list->setSelectedItem(list->ListItems().Item(row));
            emit list->DblClick();
        }
    }

    // A slow way to insert or to look for nodes takes seconds here.
    void largeNodesOpenAtOnce()
    {
        mCatalogue->exec(R"(
            with recursive n(i) as (select 1 union all select i+1 from n where i < 4000)
            insert into Artiesten select i, 'M' || i from n;
            with recursive n(i) as (select 1 union all select i+1 from n where i < 2000)
            insert into Tracks select i, 1, 'Track ' || i, null, null from n;)");
        show();
        QElapsedTimer watch;
        watch.start();
        QCOMPARE(open("M")->childCount(), 4000);
        QCOMPARE(open("A1")->childCount(), 2000);
        QVERIFY2(watch.elapsed() < 1000, qPrintable(QString::number(watch.elapsed())));
    }
};

QTEST_MAIN(tst_RecordTree)
#include "tst_RecordTree.moc"
