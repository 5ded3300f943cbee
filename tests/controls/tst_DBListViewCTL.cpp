// Label: screen
#include "controls/DBListViewCTL.h"

#include <QAccessible>
#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QScrollBar>
#include <QSignalSpy>
#include <QTest>
#include <QTimer>

using namespace ADODB;

namespace
{

/// Rows of "a|b|c"; numbers in the first column are numbers.
RecordsetPtr recordset(const QStringList &fields, const QStringList &rows)
{
    auto rs = std::make_shared<Recordset>();
    for (const QString &field : fields)
        rs->appendField(field, adVarWChar);
    rs->Open();
    for (const QString &row : rows) {
        const QStringList cells = row.split(u'|');
        rs->AddNew();
        for (int i = 0; i < cells.size(); ++i)
            rs->Fields(i).setValue(i == 0 ? Value(cells[i].toInt()) : Value(cells[i]));
    }
    return rs;
}

RecordsetPtr discs()
{
    return recordset({QStringLiteral("Id"), QStringLiteral("Artiest"), QStringLiteral("Titel")},
                     {QStringLiteral("11|Queen|Jazz"), QStringLiteral("9|abba|Arrival"),
                      QStringLiteral("30|Édith Piaf|Milord"), QStringLiteral("4|ABBA|Waterloo"),
                      QStringLiteral("5|Edwin Starr|War")});
}

RecordsetPtr manyDiscs(int count)
{
    QStringList rows;
    for (int i = 1; i <= count; ++i)
        rows.append(QStringLiteral("%1|Artist %2|Title").arg(i).arg(i % 7));
    return recordset({QStringLiteral("Id"), QStringLiteral("Artiest"), QStringLiteral("Titel")},
                     rows);
}

/// The ids of the rows as shown; those of selected ones with a "*", the current one with a "<".
QString shown(DBListViewCTL &list)
{
    QStringList ids;
    for (int i = 1; i <= list.ListItems().Count(); ++i) {
        const ListItem item = list.ListItems().Item(i);
        ids.append(item.Text() + (item.Selected() ? QStringLiteral("*") : QString()) +
                   (item == list.SelectedItem() ? QStringLiteral("<") : QString()));
    }
    return ids.join(u' ');
}

/// A list on the screen with the focus.
struct ShownList : DBListViewCTL {
    explicit ShownList(RecordsetPtr rs = discs())
    {
        resize(400, 200);
        setRecordset(std::move(rs));
        Populate();
        ColumnHeaders().Item(1).setWidth(0);
        show();
        activateWindow();
        setFocus();
        if (!QTest::qWaitForWindowActive(this))
            QTest::qFail("The list did not become active", __FILE__, __LINE__);
    }
    void widen(int width) // so that it can scroll sideways
    {
        ColumnHeaders().Item(3).setWidth(width);
        updateGeometries();
    }
    QPoint centreOf(int index) const
    {
        const int row = index - 1;
        return {columnViewportPosition(1) + columnWidth(1) / 2,
                rowViewportPosition(row) + rowHeight(row) / 2};
    }
    QPoint boxOf(int index) const { return {columnViewportPosition(1) + 8, centreOf(index).y()}; }
    void click(int index, Qt::KeyboardModifiers modifiers = {})
    {
        QTest::mouseClick(viewport(), Qt::LeftButton, modifiers, centreOf(index));
    }
};

} // namespace

class tst_DBListViewCTL : public QObject
{
    Q_OBJECT

private slots:
    void showsTheRecordset();
    void populatesAnew();
    void showsAnEmptyRecordset();
    void keepsItsRows();
    void sorts_data();
    void sorts();
    void keepsSelectionOverSort();
    void writesFollowTheRecord();
    void itemsOfOldRowsAreNothing();
    void selectsRowByRow();
    void hidesColumns();
    void tellsKeys_data();
    void tellsKeys();
    void keyDownComesFirst();
    void disabledGetsNoKeys();
    void movesByKeys_data();
    void movesByKeys();
    void headerClickOnlyTells();
    void tellsClicks();
    void hitTestKnowsScrolling();
    void findsWhatIsTyped();
    void copiesSelectedRows();
    void checkBoxes();
    void dragsRows();
    void dragEndsWithoutDrop_data();
    void dragEndsWithoutDrop();
    void tellsFocus();
    void isReadableByAssistiveTools();
    void handlesManyRows();
};

void tst_DBListViewCTL::showsTheRecordset()
{
    DBListViewCTL list;
    const auto rs = discs();
    list.setRecordset(rs);
    QCOMPARE(list.ListItems().Count(), 0); // only Populate shows it
    list.Populate();
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    QCOMPARE(list.ColumnHeaders().Count(), 3);
    QCOMPARE(list.ColumnHeaders().Item(2).Text(), QStringLiteral("Artiest"));
    QCOMPARE(list.ListItems().Item(3).SubItems(1), QStringLiteral("Édith Piaf"));
    QCOMPARE(list.ListItems().Item(3).Index(), 3);
    QVERIFY(!list.ListItems().Item(0) && !list.ListItems().Item(6));
    QCOMPARE(list.ListItems().Item(1).SubItems(3), QString());
    QCOMPARE(list.Recordset(), rs);
}

void tst_DBListViewCTL::populatesAnew()
{
    ShownList list;
    list.ColumnHeaders().Item(2).setText(QStringLiteral("Artist"));
    list.ColumnHeaders().Item(2).setWidth(300);
    list.ListItems().Item(2).setBold(true);
    list.ListItems().Item(2).setSubItems(1, QStringLiteral("changed"));
    list.setSelectedItem(list.ListItems().Item(4));
    list.setSortKey(2);
    list.setSorted(true);
    list.Populate();
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    QVERIFY(!list.Sorted());
    QVERIFY(list.ColumnHeaders().Item(1).Width() > 0);
    QCOMPARE(list.ColumnHeaders().Item(2).Width(), list.ColumnHeaders().Item(3).Width());
    QCOMPARE(list.ColumnHeaders().Item(2).Text(), QStringLiteral("Artiest"));
    QCOMPARE(list.ListItems().Item(2).SubItems(1), QStringLiteral("abba"));
    QVERIFY(!list.ListItems().Item(2).Bold());

    list.setRecordset(manyDiscs(300));
    list.Populate();
    list.setSelectedItem(list.ListItems().Item(299)); // before the list is painted
    list.grab();
    QVERIFY(list.viewport()->rect().contains(list.centreOf(299)));

    list.setRecordset(recordset({QStringLiteral("Dummy")}, {QStringLiteral("1")}));
    list.Populate();
    list.ColumnHeaders().Item(1).setWidth(0); // an empty look: no column shows
    QCOMPARE(shown(list), QStringLiteral("1*<"));
    QTest::keyClick(&list, Qt::Key_Down);
    QTest::keyClick(&list, Qt::Key_A);
    QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
    list.grab();
}

void tst_DBListViewCTL::showsAnEmptyRecordset()
{
    ShownList list;
    list.setRecordset(recordset({QStringLiteral("Id"), QStringLiteral("Titel")}, {}));
    list.Populate();
    QCOMPARE(list.ListItems().Count(), 0);
    QCOMPARE(list.ColumnHeaders().Count(), 2);
    QVERIFY(!list.SelectedItem());
    QVERIFY(!list.HitTest(5, 5));
    QCOMPARE(list.SelectedItem().Text(), QString());
    list.SelectedItem().setSelected(true);
    list.setSelectedItem({});
    list.setSorted(true);
    list.setSortKey(1);
    list.setSortKey(7);
    for (const auto key : {Qt::Key_Down, Qt::Key_End, Qt::Key_PageUp, Qt::Key_Space, Qt::Key_B})
        QTest::keyClick(&list, key);
    QTest::keyClick(&list, Qt::Key_A, Qt::ControlModifier);
    list.grab();
    QVERIFY(!list.SelectedItem());
}

void tst_DBListViewCTL::keepsItsRows()
{
    DBListViewCTL list;
    const auto rs = discs();
    list.setRecordset(rs);
    list.Populate();
    rs->MoveFirst();
    rs->Fields(u"Artiest").setValue(QStringLiteral("Changed"));
    rs->MoveLast();
    rs->Delete();
    QCOMPARE(list.ListItems().Item(1).SubItems(1), QStringLiteral("Queen"));
    list.setSorted(true);
    QCOMPARE(shown(list), QStringLiteral("4 5 9 11*< 30"));
    list.Populate();
    QCOMPARE(list.ListItems().Item(1).SubItems(1), QStringLiteral("Changed"));
    QCOMPARE(list.ListItems().Count(), 4);
    list.ListItems().Item(1).setSubItems(1, QStringLiteral("Written"));
    QCOMPARE(rs->rows()->text(0, 1), QStringLiteral("Changed"));
    rs->Close();
    QCOMPARE(list.ListItems().Item(1).SubItems(1), QStringLiteral("Written"));
    QVERIFY_EXCEPTION_THROWN(list.Populate(), ADODB::Error);
    QCOMPARE(list.ListItems().Count(), 4);
}

void tst_DBListViewCTL::sorts_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<QString>("expected");
    QTest::newRow("numbers by value") << 0 << QStringLiteral("4 5 9 11*< 30");
    QTest::newRow("texts, equal ones in order") << 1 << QStringLiteral("9 4 30 5 11*<");
    QTest::newRow("other texts") << 2 << QStringLiteral("9 11*< 30 5 4");
    QTest::newRow("no such column") << 3 << QStringLiteral("11*< 9 30 4 5");
}

void tst_DBListViewCTL::sorts()
{
    QFETCH(int, key);
    QFETCH(QString, expected);
    ShownList list;
    list.setSortKey(2); // an earlier order must not show in the later one
    list.setSorted(true);
    list.setSortKey(key);
    QCOMPARE(shown(list), expected);
    QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), key < 3 ? key : -1);
    QCOMPARE(list.ListItems().Item(1).Index(), 1);
    list.setSorted(false);
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), -1);
}

void tst_DBListViewCTL::keepsSelectionOverSort()
{
    ShownList list;
    list.setSelectedItem(list.ListItems().Item(2));
    list.ListItems().Item(5).setSelected(true);
    list.ListItems().Item(4).setSelected(true);
    QCOMPARE(shown(list), QStringLiteral("11 9*< 30 4* 5*"));
    list.setSortKey(1);
    list.setSorted(true);
    QCOMPARE(shown(list), QStringLiteral("9*< 4* 30 5* 11"));
    QCOMPARE(list.selectionModel()->selection().size(), 2);
    // Going on from the current row by keys takes its new place.
    QTest::keyClick(&list, Qt::Key_Down);
    QCOMPARE(shown(list), QStringLiteral("9 4*< 30 5 11"));

    list.ListItems().Item(2).setSelected(false);
    list.setSortKey(0);
    QCOMPARE(shown(list), QStringLiteral("4< 5 9 11 30"));
}

void tst_DBListViewCTL::writesFollowTheRecord()
{
    ShownList list;
    const ListItem piaf = list.ListItems().Item(3);
    piaf.setSubItems(1, QStringLiteral("Zappa"));
    piaf.setBold(true);
    piaf.setForeColor(Qt::red);
    piaf.setChecked(true);
    list.setSorted(true);
    list.setSortKey(1);
    QCOMPARE(shown(list), QStringLiteral("9 4 5 11*< 30"));
    QCOMPARE(piaf.Index(), 5);
    const ListItem last = list.ListItems().Item(5);
    QCOMPARE(last.SubItems(1), QStringLiteral("Zappa"));
    QVERIFY(last.Bold() && last.Checked() && last.ForeColor() == QColor(Qt::red));
    QVERIFY(!list.ListItems().Item(3).Bold());
    const QModelIndex cell = list.model()->index(4, 1);
    QVERIFY(cell.data(Qt::FontRole).value<QFont>().bold());
    QCOMPARE(cell.data(Qt::ForegroundRole).value<QColor>(), QColor(Qt::red));

    // What is written does not move a row; sorting again does.
    last.setSubItems(1, QString());
    QCOMPARE(piaf.Index(), 5);
    list.setSortKey(1);
    QCOMPARE(piaf.Index(), 1);
}

void tst_DBListViewCTL::itemsOfOldRowsAreNothing()
{
    ShownList list;
    const ListItem old = list.ListItems().Item(2);
    list.setDropHighlight(old);
    list.Populate();
    QVERIFY(!old);
    old.setBold(true);
    old.setSelected(true);
    old.EnsureVisible();
    QCOMPARE(old.Text(), QString());
    QCOMPARE(old.Index(), 0);
    list.grab();
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    QVERIFY(!list.ListItems().Item(2).Bold());
    QVERIFY(!ListItem().Selected());
}

void tst_DBListViewCTL::selectsRowByRow()
{
    ShownList list(manyDiscs(300));
    // As screens do that restore a position: one row on, all others off.
    for (int i = 1; i <= 300; ++i)
        list.ListItems().Item(i).setSelected(i == 250);
    QCOMPARE(list.SelectedItem().Index(), 250);
    QCOMPARE(list.HitTest(5, 5).Index(), 1); // nothing has scrolled
    list.SelectedItem().EnsureVisible();
    QVERIFY(list.viewport()->rect().contains(list.centreOf(250)));

    for (const int i : {100, 102, 101, 99, 103})
        list.ListItems().Item(i).setSelected(true);
    QCOMPARE(list.SelectedItem().Index(), 250);
    QCOMPARE(list.selectionModel()->selection().size(), 2);
    list.ListItems().Item(101).setSelected(false);
    QVERIFY(list.ListItems().Item(100).Selected() && !list.ListItems().Item(101).Selected() &&
            list.ListItems().Item(102).Selected());
    list.setSelectedItem(list.ListItems().Item(7));
    QCOMPARE(list.selectionModel()->selectedRows().size(), 1);
}

void tst_DBListViewCTL::hidesColumns()
{
    ShownList list;
    QCOMPARE(list.ColumnHeaders().Item(1).Width(), 0);
    QVERIFY(list.isColumnHidden(0));
    QCOMPARE(list.ListItems().Item(1).Text(), QStringLiteral("11"));
    list.ColumnHeaders().Item(2).setWidth(7);
    QCOMPARE(list.ColumnHeaders().Item(2).Width(), 7);
    list.horizontalHeader()->resizeSection(1, 123); // as by the mouse
    QCOMPARE(list.ColumnHeaders().Item(2).Width(), 123);
    // Keys work though the cell that was the current one has gone.
    list.ColumnHeaders().Item(2).setWidth(0);
    QTest::keyClick(&list, Qt::Key_Down, Qt::ShiftModifier);
    QCOMPARE(shown(list), QStringLiteral("11* 9*< 30 4 5"));
    list.ColumnHeaders().Item(1).setWidth(50);
    QCOMPARE(list.ColumnHeaders().Item(1).Width(), 50);
    list.ColumnHeaders().Item(9).setWidth(50);
    QCOMPARE(list.ColumnHeaders().Item(9).Width(), 0);
}

void tst_DBListViewCTL::tellsKeys_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<Qt::KeyboardModifiers>("modifiers");
    QTest::addColumn<QVariantList>("told"); // key code and shift; empty: the key is not the list's
    QTest::addColumn<bool>("taken");        // by the list, from the screen
    const auto row = [](const char *name, int key, Qt::KeyboardModifiers modifiers,
                        const QVariantList &told,
                        bool taken) { QTest::newRow(name) << key << modifiers << told << taken; };
    row("Delete", Qt::Key_Delete, {}, {46, 0}, false);
    row("Insert", Qt::Key_Insert, {}, {45, 0}, false);
    row("Shift+Insert", Qt::Key_Insert, Qt::ShiftModifier, {}, false);
    row("Ctrl+Insert", Qt::Key_Insert, Qt::ControlModifier, {}, false);
    row("Enter", Qt::Key_Return, {}, {13, 0}, false);
    row("Enter of the number block", Qt::Key_Enter, Qt::KeypadModifier, {13, 0}, false);
    row("Esc", Qt::Key_Escape, {}, {27, 0}, false);
    row("F1", Qt::Key_F1, {}, {}, false);
    row("F8", Qt::Key_F8, {}, {}, false);
    row("Tab", Qt::Key_Tab, {}, {9, 0}, false);
    row("Down", Qt::Key_Down, {}, {40, 0}, true);
    row("Shift+Up", Qt::Key_Up, Qt::ShiftModifier, {38, 1}, true);
    row("Home", Qt::Key_Home, {}, {36, 0}, true);
    row("Ctrl+Alt+PgDn", Qt::Key_PageDown, Qt::ControlModifier | Qt::AltModifier, {34, 6}, true);
    row("letter", Qt::Key_Q, {}, {81, 0}, true);
    row("Ctrl+Z", Qt::Key_Z, Qt::ControlModifier, {90, 2}, false);
}

void tst_DBListViewCTL::tellsKeys()
{
    QFETCH(int, key);
    QFETCH(Qt::KeyboardModifiers, modifiers);
    QFETCH(QVariantList, told);
    QFETCH(bool, taken);
    ShownList list;
    list.setSelectedItem(list.ListItems().Item(2));
    QSignalSpy down(&list, &DBListViewCTL::KeyDown), up(&list, &DBListViewCTL::KeyUp);
    const bool letter = key == Qt::Key_Q;
    const QString text = letter                  ? QStringLiteral("q")
                         : key == Qt::Key_Delete ? QString(u'\x7f')
                         : key == Qt::Key_Escape ? QString(u'\x1b')
                                                 : QString();
    QKeyEvent press(QEvent::KeyPress, key, modifiers, text);
    if (key == Qt::Key_Tab) // goes to focus handling first, which has nowhere to go
        QVERIFY(!list.tabKeyNavigation());
    QApplication::sendEvent(&list, &press);
    QCOMPARE(press.isAccepted(), taken);
    QCOMPARE(down.value(0), told);
    QKeyEvent repeated(QEvent::KeyRelease, key, modifiers, text, true);
    QApplication::sendEvent(&list, &repeated);
    QCOMPARE(up.count(), 0);
    QKeyEvent release(QEvent::KeyRelease, key, modifiers, text);
    QApplication::sendEvent(&list, &release);
    QCOMPARE(up.value(0), told);
}

void tst_DBListViewCTL::keyDownComesFirst()
{
    ShownList list;
    QString before;
    connect(&list, &DBListViewCTL::KeyDown, &list, [&] { before = shown(list); });
    QTest::keyClick(&list, Qt::Key_End);
    QCOMPARE(before, QStringLiteral("11*< 9 30 4 5"));
    QCOMPARE(shown(list), QStringLiteral("11 9 30 4 5*<"));
    // A screen may fill or disable the list at a key; the list then leaves it.
    connect(&list, &DBListViewCTL::KeyDown, &list, [&] {
        list.Populate();
        list.setEnabled(false);
    });
    QTest::keyClick(&list, Qt::Key_Down);
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    // It may even close it.
    auto *own = new ShownList;
    connect(own, &DBListViewCTL::KeyDown, own, [own] { delete own; });
    QKeyEvent press(QEvent::KeyPress, Qt::Key_Return, {});
    QApplication::sendEvent(own, &press);
}

void tst_DBListViewCTL::disabledGetsNoKeys()
{
    ShownList list;
    QSignalSpy down(&list, &DBListViewCTL::KeyDown), clicks(&list, &DBListViewCTL::DblClick);
    list.setEnabled(false);
    QTest::keyClick(&list, Qt::Key_Delete);
    QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, list.centreOf(2));
    QCOMPARE(down.count() + clicks.count(), 0);
}

void tst_DBListViewCTL::movesByKeys_data()
{
    QTest::addColumn<int>("from");
    QTest::addColumn<int>("key");
    QTest::addColumn<Qt::KeyboardModifiers>("modifiers");
    QTest::addColumn<int>("current");
    QTest::addColumn<int>("selected");
    const auto row = [](const char *name, int from, int key, Qt::KeyboardModifiers modifiers,
                        int current, int selected) {
        QTest::newRow(name) << from << key << modifiers << current << selected;
    };
    row("Home", 50, Qt::Key_Home, {}, 1, 1);
    row("End", 50, Qt::Key_End, {}, 100, 1);
    row("Shift+End", 50, Qt::Key_End, Qt::ShiftModifier, 100, 51);
    row("Ctrl+Down moves without selecting", 50, Qt::Key_Down, Qt::ControlModifier, 51, 1);
    row("Up at the top", 1, Qt::Key_Up, {}, 1, 1);
    row("PgDn near the end", 99, Qt::Key_PageDown, {}, 100, 1);
    row("Right does not leave the row", 50, Qt::Key_Right, {}, 50, 1);
    row("Ctrl+A", 50, Qt::Key_A, Qt::ControlModifier, 50, 100);
}

void tst_DBListViewCTL::movesByKeys()
{
    QFETCH(int, from);
    QFETCH(int, key);
    QFETCH(Qt::KeyboardModifiers, modifiers);
    ShownList list(manyDiscs(100));
    list.widen(900);
    list.setSelectedItem(list.ListItems().Item(from));
    QTest::keyClick(&list, Qt::Key(key), modifiers);
    QTEST(list.SelectedItem().Index(), "current");
    QTEST(int(list.selectionModel()->selectedRows().size()), "selected");
    QCOMPARE(list.selectionModel()->selection().size(), 1);
    QVERIFY(list.viewport()->rect().contains(list.visualRect(list.currentIndex()).topLeft()) ||
            list.horizontalScrollBar()->value() > 0);
    QCOMPARE(list.horizontalScrollBar()->value() > 0, key == Qt::Key_Right);
    // A page is what the window shows.
    list.setSelectedItem(list.ListItems().Item(1));
    QTest::keyClick(&list, Qt::Key_PageDown);
    const int page = list.viewport()->height() / list.rowHeight(0);
    QVERIFY(qAbs(list.SelectedItem().Index() - page) <= 1);
}

void tst_DBListViewCTL::headerClickOnlyTells()
{
    ShownList list;
    QSignalSpy clicks(&list, &DBListViewCTL::ColumnClick);
    const auto clickHead = [&](int column) {
        QHeaderView *head = list.horizontalHeader();
        QTest::mouseClick(head->viewport(), Qt::LeftButton, {},
                          {head->sectionViewportPosition(column) + 20, head->height() / 2});
    };
    clickHead(2);
    QCOMPARE(clicks.value(0), QVariantList{3});
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
    QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), -1);
    connect(&list, &DBListViewCTL::ColumnClick, &list, [&](int index) {
        list.setSorted(true);
        list.setSortKey(index - 1);
    });
    for (int i = 0; i < 2; ++i) { // ascending each time
        clickHead(1);
        QCOMPARE(shown(list), QStringLiteral("9 4 30 5 11*<"));
        QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), 1);
        QCOMPARE(list.horizontalHeader()->sortIndicatorOrder(), Qt::AscendingOrder);
    }
    QTest::keyClick(&list, Qt::Key_2, Qt::ControlModifier); // the second column that shows
    QCOMPARE(clicks.last(), QVariantList{3});
}

void tst_DBListViewCTL::tellsClicks()
{
    ShownList list;
    QStringList told;
    connect(&list, &DBListViewCTL::MouseDown, &list, [&](int button, int shift, int x, int y) {
        told.append(
            QStringLiteral("down %1 %2 %3").arg(button).arg(shift).arg(list.HitTest(x, y).Text()));
    });
    connect(&list, &DBListViewCTL::ItemClick, &list, [&](const ListItem &item) {
        told.append(QStringLiteral("item ") + item.Text() + QStringLiteral(" of ") + shown(list));
    });
    connect(&list, &DBListViewCTL::DblClick, &list, [&] { told.append(QStringLiteral("double")); });
    list.click(3);
    list.click(5, Qt::ControlModifier);
    QTest::mouseClick(list.viewport(), Qt::RightButton, {}, list.centreOf(1));
    QCOMPARE(told, (QStringList{
                       QStringLiteral("down 1 0 30"), QStringLiteral("item 30 of 11 9 30*< 4 5"),
                       QStringLiteral("down 1 2 5"), QStringLiteral("item 5 of 11 9 30* 4 5*<"),
                       QStringLiteral("down 2 0 11"), QStringLiteral("item 11 of 11*< 9 30 4 5")}));
    told.clear();
    const QPoint below(50, list.viewport()->height() - 3);
    QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, below);
    QVERIFY(!told.contains(QStringLiteral("double")));
    QCOMPARE(told.filter(QStringLiteral("item")), QStringList());
    QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, list.centreOf(2));
    QCOMPARE(told.last(), QStringLiteral("double"));
    QCOMPARE(list.SelectedItem().Text(), QStringLiteral("9"));
}

void tst_DBListViewCTL::hitTestKnowsScrolling()
{
    ShownList list(manyDiscs(200));
    list.widen(900);
    QCOMPARE(list.HitTest(20, list.rowHeight(0) / 2).Index(), 1);
    list.ListItems().Item(150).EnsureVisible();
    list.horizontalScrollBar()->setValue(200);
    const QPoint at(20, list.centreOf(150).y());
    QCOMPARE(list.HitTest(at.x(), at.y()).Index(), 150);
    QVERIFY(!list.HitTest(20, -5));
    QVERIFY(!list.HitTest(20, list.viewport()->height() + 5));
    QVERIFY(!list.HitTest(list.viewport()->width() + 5, at.y()));
    // Coming back to a row leaves the list where it is sideways.
    list.ListItems().Item(1).EnsureVisible();
    QCOMPARE(list.HitTest(20, list.rowHeight(0) / 2).Index(), 1);
    QCOMPARE(list.horizontalScrollBar()->value(), 200);
}

void tst_DBListViewCTL::findsWhatIsTyped()
{
    ShownList list;
    const auto type = [&](const QString &text) -> QString {
        list.setSelectedItem(list.ListItems().Item(2));
        list.setSelectedItem(list.ListItems().Item(1)); // a move begins a new word
        for (const QChar c : text)
            list.keyboardSearch(QString(c));
        return list.SelectedItem().Text() + u' ' + QString::number(list.SelectedItem().Index());
    };
    QApplication::setKeyboardInputInterval(60000);
    QCOMPARE(type(QStringLiteral("e")), QStringLiteral("5 5")); // the column of the artists
    QCOMPARE(type(QStringLiteral("É")), QStringLiteral("30 3"));
    QCOMPARE(type(QStringLiteral("éDITH p")), QStringLiteral("30 3"));
    QCOMPARE(type(QStringLiteral("A")), QStringLiteral("9 2"));
    QCOMPARE(type(QStringLiteral("ab")), QStringLiteral("9 2"));
    QCOMPARE(type(QStringLiteral("aaa")), QStringLiteral("9 2")); // round and back
    QCOMPARE(type(QStringLiteral("aa")), QStringLiteral("4 4"));
    QCOMPARE(type(QStringLiteral("x")), QStringLiteral("11 1"));
    list.ListItems().Item(4).setSubItems(1, QStringLiteral("x-ray"));
    QCOMPARE(type(QStringLiteral("x")), QStringLiteral("4 4"));
    list.setSortKey(2);
    list.setSorted(true);
    QCOMPARE(type(QStringLiteral("wat")), QStringLiteral("4 5")); // the sorted column
    QCOMPARE(type(QStringLiteral(" ")), QStringLiteral("9 1"));
}

void tst_DBListViewCTL::copiesSelectedRows()
{
    ShownList list;
    list.ListItems().Item(4).setSubItems(2, QStringLiteral("Water\tloo"));
    list.setSortKey(1);
    list.setSorted(true);
    list.setSelectedItem(list.ListItems().Item(5));
    list.ListItems().Item(2).setSelected(true);
    QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
    QCOMPARE(QApplication::clipboard()->text(),
             QStringLiteral("ABBA\tWater loo\nQueen\tJazz\n")); // as shown, no hidden column
    list.selectionModel()->clearSelection();
    QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
    QVERIFY(QApplication::clipboard()->text().startsWith(QStringLiteral("ABBA")));
}

void tst_DBListViewCTL::checkBoxes()
{
    ShownList list;
    QSignalSpy checks(&list, &DBListViewCTL::ItemCheck), clicks(&list, &DBListViewCTL::ItemClick);
    list.setCheckBoxes(true);
    QVERIFY(list.model()->index(0, 1).data(Qt::CheckStateRole).isValid()); // the first that shows
    QVERIFY(!list.model()->index(0, 0).data(Qt::CheckStateRole).isValid());
    QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, list.boxOf(3));
    QVERIFY(list.ListItems().Item(3).Checked());
    QCOMPARE(checks.count(), 1);
    QCOMPARE(checks[0][0].value<ListItem>().Text(), QStringLiteral("30"));
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5")); // the selection is not touched
    QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, list.boxOf(3));
    QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, list.boxOf(3));
    QCOMPARE(checks.count(), 3); // each press counts
    QCOMPARE(clicks.count(), 0);
    list.click(2);
    QVERIFY(!list.ListItems().Item(2).Checked()); // beside the box
    QTest::keyClick(&list, Qt::Key_Space);
    QVERIFY(list.ListItems().Item(2).Checked());
    QCOMPARE(checks.count(), 4);
    list.ListItems().Item(2).setChecked(false);
    QCOMPARE(checks.count(), 4); // the screen itself
    list.Populate();
    QVERIFY(list.CheckBoxes());
    QVERIFY(list.model()->index(0, 0).data(Qt::CheckStateRole).isValid());
}

void tst_DBListViewCTL::dragsRows()
{
    ShownList list;
    QStringList told;
    connect(&list, &DBListViewCTL::MouseDown, &list, [&](int button) {
        if (button == 2)
            list.Drag(1);
    });
    connect(&list, &DBListViewCTL::DragOver, &list, [&](QObject *source, int x, int y, int state) {
        list.setDropHighlight(list.HitTest(x, y));
        told.append(QStringLiteral("over %1 %2").arg(list.HitTest(x, y).Text()).arg(state));
        QCOMPARE(source, &list);
    });
    connect(&list, &DBListViewCTL::DragDrop, &list, [&](QObject *, int x, int y) {
        list.Drag(2);
        told.append(QStringLiteral("drop ") + list.HitTest(x, y).Text());
    });
    QTest::mousePress(list.viewport(), Qt::RightButton, {}, list.centreOf(2));
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5")); // the screen's alone
    QTest::mouseMove(list.viewport(), list.centreOf(3));
    QTest::mouseMove(list.viewport(), list.centreOf(4));
    const QImage marked = list.grab().toImage();
    list.setDropHighlight({});
    QVERIFY(list.grab().toImage() != marked);
    QTest::mouseMove(list.viewport(), {-40, 20});
    QTest::mouseMove(list.viewport(), list.centreOf(5));
    QTest::mouseRelease(list.viewport(), Qt::RightButton, {}, list.centreOf(5));
    QCOMPARE(told, (QStringList{QStringLiteral("over 30 0"), QStringLiteral("over 4 2"),
                                QStringLiteral("over  1"), QStringLiteral("over 5 0"),
                                QStringLiteral("drop 5")}));
    told.clear();
    list.click(1); // all over: an ordinary click
    QCOMPARE(told, QStringList());
    QCOMPARE(shown(list), QStringLiteral("11*< 9 30 4 5"));
}

void tst_DBListViewCTL::dragEndsWithoutDrop_data()
{
    QTest::addColumn<QString>("how");
    for (const char *how : {"outside", "Esc", "hidden", "ended"})
        QTest::newRow(how) << QString::fromLatin1(how);
}

void tst_DBListViewCTL::dragEndsWithoutDrop()
{
    QFETCH(QString, how);
    ShownList list(manyDiscs(100));
    QSignalSpy drops(&list, &DBListViewCTL::DragDrop), overs(&list, &DBListViewCTL::DragOver);
    QTest::mousePress(list.viewport(), Qt::RightButton, {}, list.centreOf(2));
    list.Drag(1);
    // Near the lower edge the list scrolls, and the pointer is over another row.
    const QPoint edge(20, list.viewport()->height() - 2);
    QTest::mouseMove(list.viewport(), edge);
    auto *timer = list.findChild<QTimer *>(QStringLiteral("DragScroll"));
    const int before = list.verticalScrollBar()->value();
    QTimerEvent tick(timer->timerId());
    QApplication::sendEvent(timer, &tick);
    QCOMPARE(list.verticalScrollBar()->value(), before + 1);
    QCOMPARE(overs.count(), 2);
    QPoint at = edge;
    if (how == QLatin1String("outside"))
        at = {-20, 20};
    else if (how == QLatin1String("Esc"))
        QTest::keyClick(&list, Qt::Key_Escape);
    else if (how == QLatin1String("hidden"))
        list.hide();
    else
        list.Drag(2);
    QTest::mouseRelease(list.viewport(), Qt::RightButton, {}, at);
    QCOMPARE(drops.count(), 0);
    QVERIFY(!timer->isActive());
}

void tst_DBListViewCTL::tellsFocus()
{
    QWidget window;
    DBListViewCTL list(&window);
    QWidget other(&window);
    other.setFocusPolicy(Qt::StrongFocus);
    QSignalSpy got(&list, &DBListViewCTL::GotFocus), lost(&list, &DBListViewCTL::LostFocus);
    window.show();
    window.activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(&window));
    other.setFocus();
    got.clear();
    lost.clear();
    list.setFocus();
    QCOMPARE(got.count(), 1);
    QCOMPARE(lost.count(), 0);
    other.setFocus();
    QCOMPARE(lost.count(), 1);
}

void tst_DBListViewCTL::isReadableByAssistiveTools()
{
    ShownList list;
    list.setAccessibleName(QStringLiteral("Albums"));
    list.ColumnHeaders().Item(2).setText(QStringLiteral("Artist"));
    QAccessibleInterface *face = QAccessible::queryAccessibleInterface(&list);
    QCOMPARE(face->text(QAccessible::Name), QStringLiteral("Albums"));
    QAccessibleTableInterface *table = face->tableInterface();
    QVERIFY(table);
    QCOMPARE(table->rowCount(), 5);
    QCOMPARE(table->columnDescription(1), QStringLiteral("Artist"));
    QCOMPARE(table->cellAt(2, 1)->text(QAccessible::Name), QStringLiteral("Édith Piaf"));
    QVERIFY(table->isRowSelected(0));
}

void tst_DBListViewCTL::handlesManyRows()
{
    QAccessible::setActive(true); // nor may assistive tools ask for each cell
    constexpr int count = 200000;
    ShownList list(manyDiscs(count));
    QTest::keyClick(&list, Qt::Key_A, Qt::ControlModifier);
    list.setSortKey(1);
    list.setSorted(true);
    QCOMPARE(list.selectionModel()->selection().size(), 1);
    QVERIFY(list.ListItems().Item(count).Selected());
    // Every seventh: more pieces than can be painted. The current row stays.
    list.setSelectedItem(list.ListItems().Item(1));
    list.selectionModel()->select(
        {list.model()->index(0, 0), list.model()->index(count / 7 - 1, 2)},
        QItemSelectionModel::Select);
    const QString id = list.SelectedItem().Text();
    list.setSortKey(0);
    QCOMPARE(list.SelectedItem().Text(), id);
    QVERIFY(list.SelectedItem().Selected());
    QCOMPARE(list.selectionModel()->selection().size(), 1);
    // Fewer stay, and go at once.
    list.setSortKey(1);
    list.selectionModel()->select({list.model()->index(0, 0), list.model()->index(9999, 2)},
                                  QItemSelectionModel::ClearAndSelect);
    list.setSortKey(0);
    QCOMPARE(list.selectionModel()->selection().size(), 10000);
    QElapsedTimer time;
    time.start();
    QTest::keyClick(&list, Qt::Key_A, Qt::ControlModifier);
    list.click(1);
    QVERIFY(time.elapsed() < 2000);
    QCOMPARE(list.selectionModel()->selection().size(), 1);
    QAccessible::setActive(false);
}

QTEST_MAIN(tst_DBListViewCTL)
#include "tst_DBListViewCTL.moc"
