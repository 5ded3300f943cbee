// Label: screen
#include "collection/frmCDList.h"
#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "collection/recordtree.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QElapsedTimer>
#include <QTabWidget>
#include <QTest>

/// The record tree in the browser, level by level, down to the editor of a disc.
class tst_RecordTree : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void closedNodesHoldAPlaceholder_data();
    void closedNodesHoldAPlaceholder();
    void artistsUnderTheirRoots_data();
    void artistsUnderTheirRoots();
    void fromArtistToDisc();
    void aNodeIsFilledOnce();
    void aRootWithoutArtistsCannotBeOpened();
    void aDiscOpensItsEditor();
    void onlyDiscsOpenEditors();
    void aReloadClosesTheTree();
    void largeNodesOpenAtOnce();

private:
    void fill();
    void show();
    QTreeWidgetItem *open(const char *key);
    static QStringList below(const QTreeWidgetItem *node, bool keys = false);
    template <typename Editor> QList<Editor *> editors() const;
    void click(const QString &key);

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    QPointer<frmCDList> mScreen;
    RecordTree *mTree = nullptr;
};

void tst_RecordTree::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
}

void tst_RecordTree::cleanup()
{
    const auto forms = Form::openForms();
    for (Form *form : forms)
        form->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

// Track 1 stands on compilation 1 and album 2, and twice on disc 2 of the album.
void tst_RecordTree::fill()
{
    mCatalogue->exec(QStringLiteral(R"(
        insert into Artiesten values (1,'Zed'),(2,'Édith'),(3,'eddy'),(4,'10cc'),(5,'''Til'),(12,'Emma');
        insert into Tracks values (1,12,'Same',null,null),(2,12,'another',null,null),(3,1,'Z',null,null),
            (4,2,'E',null,null),(5,3,'e',null,null),(6,4,'10',null,null),(7,5,'t',null,null);
        insert into CDTitels values (1,'Best of 1990',null,'v',null,null),(2,'Album',12,'E',null,null);
        insert into CompactDiscs values (1,1,1,3,1,null),(2,2,2,1,1,null),(3,2,2,5,1,null),(4,2,1,1,2,null),
            (5,1,1,1,3,null),(6,1,1,2,4,null),(7,1,1,4,5,null),(8,1,1,5,6,null),(9,1,1,6,7,null);)"));
}

void tst_RecordTree::show()
{
    mScreen = new frmCDList;
    mScreen->Show();
    mScreen->findChild<QTabWidget *>(QStringLiteral("CDTab"))->setCurrentIndex(2);
    mTree = mScreen->findChild<RecordTree *>(QStringLiteral("Platenbak"));
    mScreen->activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(mScreen));
}

QTreeWidgetItem *tst_RecordTree::open(const char *key)
{
    QTreeWidgetItem *node = mTree->node(QLatin1String(key));
    if (node)
        node->setExpanded(true);
    else
        QTest::qFail(key, __FILE__, __LINE__);
    return node;
}

QStringList tst_RecordTree::below(const QTreeWidgetItem *node, bool keys)
{
    QStringList found;
    for (int i = 0; i < node->childCount(); ++i)
        found.append(keys ? RecordTree::keyOf(node->child(i)) : node->child(i)->text(0));
    return found;
}

template <typename Editor> QList<Editor *> tst_RecordTree::editors() const
{
    QList<Editor *> found;
    for (Form *form : Form::openForms()) {
        if (auto *editor = qobject_cast<Editor *>(form))
            found.append(editor);
    }
    return found;
}

void tst_RecordTree::click(const QString &key)
{
    QTreeWidgetItem *node = mTree->node(key);
    mTree->scrollToItem(node);
    QTest::mouseClick(mTree->viewport(), Qt::LeftButton, {}, mTree->visualItemRect(node).center());
}

void tst_RecordTree::closedNodesHoldAPlaceholder_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("other");
    QTest::newRow("English") << languageEnglish << QStringLiteral("Other");
    QTest::newRow("Dutch") << languageDutch << QStringLiteral("Overige");
}

void tst_RecordTree::closedNodesHoldAPlaceholder()
{
    QFETCH(int, language);
    QFETCH(QString, other);
    gLanguage = language;
    fill();
    show();
    QCOMPARE(mTree->topLevelItemCount(), 27);
    QCOMPARE(below(mTree->topLevelItem(4), true), texts("dummyArtistE"));
    QCOMPARE(below(mTree->topLevelItem(4)), texts("dummyE"));
    QCOMPARE(below(mTree->node(other), true), QStringList(QStringLiteral("dummyArtist") + other));
    open("E");
    QCOMPARE(below(mTree->node(QStringLiteral("A12")), true), texts("dummyTA12"));
    QCOMPARE(below(mTree->node(QStringLiteral("A12"))), texts("dummyTrack"));
    open("A12");
    QCOMPARE(below(mTree->node(QStringLiteral("T1")), true), texts("dummyCT1"));
    QCOMPARE(below(mTree->node(QStringLiteral("T1"))), texts("dummyCD"));
}

void tst_RecordTree::artistsUnderTheirRoots_data()
{
    QTest::addColumn<QByteArray>("root");
    QTest::addColumn<QStringList>("artists");
    QTest::newRow("either case, not accents") << QByteArray("E") << texts("eddy", "Emma");
    QTest::newRow("digits") << QByteArray("Other") << texts("10cc");
    QTest::newRow("not signs") << QByteArray("T") << QStringList();
}

void tst_RecordTree::artistsUnderTheirRoots()
{
    QFETCH(QByteArray, root);
    fill();
    show();
    QTEST(below(open(root.constData())), "artists");
}

void tst_RecordTree::fromArtistToDisc()
{
    fill();
    show();
    open("E");
    QCOMPARE(below(open("A12")), texts("another", "Same"));
    QCOMPARE(below(open("T1")), texts("Album (Track 1 of disc 2)", "Album (Track 5 of disc 2)",
                                      "Best of 1990 (Track 3 of disc 1)"));
    QCOMPARE(mTree->node(QStringLiteral("C1"))->childCount(), 0);
}

void tst_RecordTree::aNodeIsFilledOnce()
{
    fill();
    show();
    QTreeWidgetItem *root = open("E");
    mCatalogue->exec(QStringLiteral("insert into Artiesten values (20,'Eve')"));
    root->setExpanded(false);
    root->setExpanded(true);
    QCOMPARE(below(root), texts("eddy", "Emma"));
}

void tst_RecordTree::aRootWithoutArtistsCannotBeOpened()
{
    fill();
    show();
    QTreeWidgetItem *root = open("Q");
    QCOMPARE(root->childCount(), 0);
    QTest::keyClick(mTree, Qt::Key_Right);
}

void tst_RecordTree::aDiscOpensItsEditor()
{
    fill();
    show();
    open("E");
    open("A12");
    open("T1");
    click(QStringLiteral("C3"));
    QCOMPARE(editors<frmCDRootE>().size(), 1);
    QCOMPARE(editors<frmCDRootE>().first()->CdId, 2);
    click(QStringLiteral("C2"));
    QCOMPARE(editors<frmCDRootE>().size(), 1);
    mTree->setCurrentItem(mTree->node(QStringLiteral("C1")));
    QTest::keyClick(mTree, Qt::Key_Return);
    QCOMPARE(editors<frmCDRoot>().size(), 1);
    QCOMPARE(editors<frmCDRoot>().first()->CdId, 1);
    QCOMPARE(editors<frmCDRoot>().first()->Mode, QStringLiteral("U"));
}

void tst_RecordTree::onlyDiscsOpenEditors()
{
    fill();
    show();
    click(QStringLiteral("C"));
    open("E");
    click(QStringLiteral("A12"));
    open("A12");
    click(QStringLiteral("T1"));
    emit mTree->NodeClick(QStringLiteral("C12x"));
    emit mTree->NodeClick(QStringLiteral("C99")); // gone meanwhile
    QVERIFY(editors<CdEditor>().isEmpty());
}

void tst_RecordTree::aReloadClosesTheTree()
{
    fill();
    show();
    open("E");
    open("A12");
    mScreen->RefreshLists();
    QCOMPARE(mTree->topLevelItemCount(), 27);
    QVERIFY(!mTree->node(QStringLiteral("A12")));
    QVERIFY(!mTree->node(QStringLiteral("E"))->isExpanded());
    QCOMPARE(below(open("E")), texts("eddy", "Emma"));
}

// A slow way to insert or to look for nodes takes seconds here.
void tst_RecordTree::largeNodesOpenAtOnce()
{
    mCatalogue->exec(QStringLiteral(R"(
        with recursive n(i) as (select 1 union all select i+1 from n where i < 4000)
        insert into Artiesten select i, 'M' || i from n;
        with recursive n(i) as (select 1 union all select i+1 from n where i < 2000)
        insert into Tracks select i, 1, 'Track ' || i, null, null from n;)"));
    show();
    QElapsedTimer watch;
    watch.start();
    QCOMPARE(open("M")->childCount(), 4000);
    QCOMPARE(open("A1")->childCount(), 2000);
    QVERIFY2(watch.elapsed() < 1000, qPrintable(QString::number(watch.elapsed())));
}

QTEST_MAIN(tst_RecordTree)
#include "tst_RecordTree.moc"
