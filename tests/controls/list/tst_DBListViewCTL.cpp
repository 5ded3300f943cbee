// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "support/datarows.h"

#include <QAccessible>
#include <QApplication>
#include <QHeaderView>
#include <QHelpEvent>
#include <QScrollBar>
#include <QSignalSpy>
#include <QTimer>
#include <QToolTip>

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
    return recordset(texts("Id", "Artiest", "Titel"),
                     texts("11|Queen|Jazz", "9|abba|Arrival", "30|Édith Piaf|Milord",
                           "4|ABBA|Waterloo", "5|Edwin Starr|War"));
}

RecordsetPtr manyDiscs(int count)
{
    QStringList rows;
    for (int i = 1; i <= count; ++i)
        rows.append(u"%1|Artist %2|Title"_s.arg(i).arg(i % 7));
    return recordset(texts("Id", "Artiest", "Titel"), rows);
}

/// The ids of the rows as shown; those of selected ones with a "*", the current one with a "<".
QString shown(DBListViewCTL &list)
{
    QStringList ids;
    for (int i = 1; i <= list.ListItems().Count(); ++i) {
        const ListItem item = list.ListItems().Item(i);
        ids.append(item.Text() + (item.Selected() ? u"*"_s : QString()) +
                   (item == list.SelectedItem() ? u"<"_s : QString()));
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
    void populatesAnew()
    {
        ShownList list;
        list.ListItems().Item(2).setBold(true);
        list.setSelectedItem(list.ListItems().Item(4));
        list.setSortKey(2);
        list.setSorted(true);
        list.Populate();
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s);
        QVERIFY(!list.Sorted() && !list.ListItems().Item(2).Bold());
        QVERIFY(!list.ListItems().Item(0) && !list.ListItems().Item(6));
        QVERIFY(list.ColumnHeaders().Item(1).Width() > 0);

        list.setRecordset(manyDiscs(300));
        list.Populate();
        list.setSelectedItem(list.ListItems().Item(299)); // before the list is painted
        list.grab();
        QVERIFY(list.viewport()->rect().contains(list.centreOf(299)));
    }

    // No row, or no column that shows: nothing may ask for what is not there.
    void showsAnEmptyRecordset()
    {
        for (const QStringList &rows : {QStringList(), texts("1")}) {
            ShownList list;
            list.setRecordset(recordset({u"Dummy"_s}, rows));
            list.Populate();
            list.ColumnHeaders().Item(1).setWidth(0);
            QCOMPARE(shown(list), rows.isEmpty() ? QString() : u"1*<"_s);
            list.setSorted(true);
            list.setSortKey(7);
            for (const auto key :
                 {Qt::Key_Down, Qt::Key_PageUp, Qt::Key_Space, Qt::Key_A, Qt::Key_C}) {
                QTest::keyClick(&list, key);
                QTest::keyClick(&list, key, Qt::ControlModifier);
            }
            list.grab();
            QCOMPARE(bool(list.SelectedItem()), !rows.isEmpty());
        }
    }

    void keepsItsRows()
    {
        DBListViewCTL list;
        const auto rs = discs();
        list.setRecordset(rs);
        list.Populate();
        rs->MoveLast();
        rs->Delete();
        list.ListItems().Item(2).setSubItems(1, u"Written"_s);
        QCOMPARE(list.ListItems().Count(), 5);
        list.Populate();
        QCOMPARE(list.ListItems().Count(), 4);
        QCOMPARE(list.ListItems().Item(2).SubItems(1), u"abba"_s);
        rs->Close();
        QVERIFY_EXCEPTION_THROWN(list.Populate(), Error);
        QCOMPARE(list.ListItems().Count(), 4);
    }

    void sortsAndKeepsTheSelection()
    {
        ShownList list;
        list.setSelectedItem(list.ListItems().Item(2));
        list.ListItems().Item(5).setSelected(true);
        list.ListItems().Item(4).setSelected(true);
        list.setSortKey(2); // an earlier order must not show in the later one
        list.setSorted(true);
        list.setSortKey(1);
        QCOMPARE(shown(list), u"9*< 4* 30 5* 11"_s);
        QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), 1);
        QCOMPARE(list.selectionModel()->selection().size(), 2);
        // Going on from the current row by keys takes its new place.
        QTest::keyClick(&list, Qt::Key_Down);
        QCOMPARE(shown(list), u"9 4*< 30 5 11"_s);
        list.ListItems().Item(2).setSelected(false);
        list.setSortKey(0);
        QCOMPARE(shown(list), u"4< 5 9 11 30"_s);
        list.setSortKey(3); // no such column
        QCOMPARE(shown(list), u"11 9 30 4< 5"_s);
        list.setSorted(false);
        QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), -1);
    }

    // The order of the rows is kept if they come again; what was written over them is not.
    void sortsRowsThatComeAgain()
    {
        ShownList list;
        QSignalSpy ordered(list.model(), &QAbstractItemModel::layoutChanged);
        list.sortBy(1);
        list.sortBy(1);
        QCOMPARE(ordered.size(), 1); // sorted once
        for (const QString &written : {QString(), u"Zappa"_s, QString()}) {
            if (!written.isEmpty())
                list.ListItems().Item(1).setSubItems(1, written);
            list.Populate();
            QVERIFY(!list.Sorted());
            list.sortBy(1);
            QCOMPARE(shown(list), u"9 4 30 5 11*<"_s);
        }
        list.setRecordset(recordset(texts("Id", "Artiest"), texts("11|Zappa", "9|Eno", "30|Abba")));
        list.Populate();
        list.sortBy(1);
        QCOMPARE(shown(list), u"30 9 11*<"_s);
    }

    void writesFollowTheRecord()
    {
        ShownList list;
        const ListItem piaf = list.ListItems().Item(3);
        piaf.setSubItems(1, u"Zappa"_s);
        piaf.setForeColor(Qt::red);
        piaf.setChecked(true);
        list.setSorted(true);
        list.setSortKey(1);
        QCOMPARE(shown(list), u"9 4 5 11*< 30"_s);
        const ListItem last = list.ListItems().Item(5);
        QVERIFY(piaf.Index() == 5 && last.SubItems(1) == u"Zappa" && last.Checked());
        const QModelIndex cell = list.model()->index(4, 1);
        QCOMPARE(cell.data(Qt::ForegroundRole).value<QColor>(), QColor(Qt::red));
        last.setSubItems(1, QString());
        QCOMPARE(piaf.Index(), 5); // sorting again moves it, writing does not
        list.setSortKey(1);
        QCOMPARE(piaf.Index(), 1);
    }

    void itemsOfOldRowsAreNothing()
    {
        ShownList list;
        const ListItem old = list.ListItems().Item(2);
        list.setDropHighlight(old);
        list.Populate();
        old.setBold(true);
        old.setSelected(true);
        old.EnsureVisible();
        QVERIFY(!old && old.Index() == 0 && old.Text().isEmpty());
        list.grab();
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s);
        QVERIFY(!list.ListItems().Item(2).Bold());
    }

    void tellsKeys_data()
    {
        // told: key code and shift; empty: the key is not the list's
        // taken: by the list, from the screen
        const DataRows<QString, QVariantList, bool> row("keys", "told", "taken");
        row("Del", {46, 0}, false);
        row("Ins", {45, 0}, false);
        row("Ctrl+Ins", {}, false);
        row("Num+Enter", {13, 0}, false);
        row("Esc", {27, 0}, false);
        row("F8", {}, false);
        row("Tab", {9, 0}, false);
        row("Shift+Up", {38, 1}, true);
        row("Ctrl+Alt+PgDown", {34, 6}, true);
        row("Q", {81, 0}, true);
        row("Ctrl+Z", {90, 2}, false);
    }

    void tellsKeys()
    {
        QFETCH(QString, keys);
        QFETCH(QVariantList, told);
        ShownList list;
        list.setSelectedItem(list.ListItems().Item(2));
        QSignalSpy down(&list, &DBListViewCTL::KeyDown), up(&list, &DBListViewCTL::KeyUp);
        const QKeyCombination key = QKeySequence(keys)[0];
        const QString text = keys == u"Q" ? u"q"_s : keys == u"Del" ? u"\x7f"_s : QString();
        const auto send = [&](QEvent::Type type, bool repeated = false) {
            QKeyEvent event(type, key.key(), key.keyboardModifiers(), text, repeated);
            QApplication::sendEvent(&list, &event);
            return event.isAccepted();
        };
        QTEST(send(QEvent::KeyPress), "taken");
        QCOMPARE(down.value(0), told);
        send(QEvent::KeyRelease, true);
        QCOMPARE(up.count(), 0);
        send(QEvent::KeyRelease);
        QCOMPARE(up.value(0), told);
    }

    // A screen may fill, disable or close the list at a key; the list then leaves it.
    void keyDownComesFirst()
    {
        ShownList list;
        QString before;
        connect(&list, &DBListViewCTL::KeyDown, &list, [&] { before = shown(list); });
        QTest::keyClick(&list, Qt::Key_End);
        QCOMPARE(before, u"11*< 9 30 4 5"_s);
        QCOMPARE(shown(list), u"11 9 30 4 5*<"_s);
        connect(&list, &DBListViewCTL::KeyDown, &list, [&] {
            list.Populate();
            list.setEnabled(false);
        });
        QTest::keyClick(&list, Qt::Key_Down);
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s);
        auto *own = new ShownList;
        connect(own, &DBListViewCTL::KeyDown, own, [own] { delete own; });
        QKeyEvent press(QEvent::KeyPress, Qt::Key_Return, {});
        QApplication::sendEvent(own, &press);
    }

    void headerClickOnlyTells()
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
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s);
        QCOMPARE(list.horizontalHeader()->sortIndicatorSection(), -1);
        list.setSorted(true);
        connect(&list, &DBListViewCTL::ColumnClick, &list, [&](int n) { list.setSortKey(n - 1); });
        clickHead(1);
        clickHead(1); // ascending each time
        QCOMPARE(shown(list), u"9 4 30 5 11*<"_s);
        QCOMPARE(list.horizontalHeader()->sortIndicatorOrder(), Qt::AscendingOrder);
        QTest::keyClick(&list, Qt::Key_2, Qt::ControlModifier); // the second column that shows
        QCOMPARE(clicks.last(), QVariantList{3});
    }

    void whatIsHighlightedIsTheSelectedItem()
    {
        ShownList list;
        list.click(3);
        list.click(3, Qt::ControlModifier); // the only one stays
        QTest::keyClick(&list, Qt::Key_Space, Qt::ControlModifier);
        QCOMPARE(shown(list), u"11 9 30*< 4 5"_s);
        list.click(5, Qt::ControlModifier);
        list.click(5, Qt::ControlModifier); // the cursor is there, the highlight is not
        QCOMPARE(shown(list), u"11 9 30*< 4 5"_s);
        QTest::keyClick(&list, Qt::Key_Up, Qt::ControlModifier);
        QCOMPARE(list.currentIndex().row(), 3);
        QCOMPARE(shown(list), u"11 9 30*< 4 5"_s);
        const QPoint below(50, list.viewport()->height() - 3);
        QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, below);
        QCOMPARE(shown(list), u"11 9 30 4*< 5"_s);
    }

    void tellsClicks()
    {
        ShownList list;
        QStringList told;
        connect(&list, &DBListViewCTL::MouseDown, &list, [&](int button, int shift, int x, int y) {
            told.append(u"down %1 %2 %3"_s.arg(button).arg(shift).arg(list.HitTest(x, y).Text()));
        });
        connect(&list, &DBListViewCTL::ItemClick, &list, [&](const ListItem &item) {
            told.append(u"item "_s + item.Text() + u" of "_s + shown(list));
        });
        connect(&list, &DBListViewCTL::DblClick, &list, [&] { told.append(u"double"_s); });
        list.click(3);
        list.click(5, Qt::ControlModifier);
        QTest::mouseClick(list.viewport(), Qt::RightButton, {}, list.centreOf(1));
        QCOMPARE(told,
                 texts("down 1 0 30", "item 30 of 11 9 30*< 4 5", "down 1 2 5",
                       "item 5 of 11 9 30* 4 5*<", "down 2 0 11", "item 11 of 11*< 9 30 4 5"));
        list.click(4, Qt::ControlModifier);
        list.click(1); // one of two: the other goes when the button does
        QCOMPARE(told.last(), u"item 11 of 11*< 9 30 4 5"_s);
        told.clear();
        const QPoint below(50, list.viewport()->height() - 3);
        QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, below);
        QVERIFY(told.filter(u"item"_s).isEmpty() && !told.contains(u"double"));
        QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, list.centreOf(2));
        QCOMPARE(told.last(), u"double"_s);
        QCOMPARE(list.SelectedItem().Text(), u"9"_s);
    }

    void findsWhatIsTyped_data()
    {
        // sorted: on the title, which is then looked at in place of the artist
        const DataRows<QString, bool, QString> row("typed", "sorted", "found");
        row("e", false, "5");
        row("É", false, "30");
        row("éDITH p", false, "30");
        row("ab", false, "9");
        row("aa", false, "9"); // round and back
        row("x", false, "4");
        row("y", false, "11");
        row("wat", true, "4");
        row(" ", true, "9");
    }

    void findsWhatIsTyped()
    {
        QFETCH(QString, typed);
        QFETCH(bool, sorted);
        ShownList list;
        list.ListItems().Item(4).setSubItems(1, u"x-ray"_s);
        list.setSortKey(2);
        list.setSorted(sorted);
        list.setSelectedItem(list.ListItems().Item(2));
        list.setSelectedItem(list.ListItems().Item(1)); // a move begins a new word
        QApplication::setKeyboardInputInterval(60000);
        for (const QChar c : typed)
            list.keyboardSearch(QString(c));
        QTEST(list.SelectedItem().Text(), "found");
    }

    void checkBoxes()
    {
        ShownList list;
        QSignalSpy checks(&list, &DBListViewCTL::ItemCheck),
            clicks(&list, &DBListViewCTL::ItemClick);
        list.setCheckBoxes(true);
        QVERIFY(
            list.model()->index(0, 1).data(Qt::CheckStateRole).isValid()); // the first that shows
        QVERIFY(!list.model()->index(0, 0).data(Qt::CheckStateRole).isValid());
        QTest::mouseClick(list.viewport(), Qt::LeftButton, {}, list.boxOf(3));
        QVERIFY(list.ListItems().Item(3).Checked());
        QCOMPARE(checks.value(0).value(0).value<ListItem>().Text(), u"30"_s);
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s); // the selection is not touched
        QTest::mouseDClick(list.viewport(), Qt::LeftButton, {}, list.boxOf(3));
        QCOMPARE(checks.count(), 2); // each press counts
        QCOMPARE(clicks.count(), 0);
        list.click(2); // beside the box
        QVERIFY(!list.ListItems().Item(2).Checked());
        QTest::keyClick(&list, Qt::Key_Space);
        QVERIFY(list.ListItems().Item(2).Checked());
        list.ListItems().Item(2).setChecked(false);
        QCOMPARE(checks.count(), 3); // not for the screen itself
    }

    void dragsRows()
    {
        ShownList list;
        QStringList told;
        connect(&list, &DBListViewCTL::MouseDown, &list, [&](int button) {
            if (button == 2)
                list.Drag(1);
        });
        connect(&list, &DBListViewCTL::DragOver, &list, [&](QObject *, int x, int y, int state) {
            list.setDropHighlight(list.HitTest(x, y));
            told.append(u"over %1 %2"_s.arg(list.HitTest(x, y).Text()).arg(state));
        });
        connect(&list, &DBListViewCTL::DragDrop, &list, [&](QObject *, int x, int y) {
            list.Drag(2);
            told.append(u"drop "_s + list.HitTest(x, y).Text());
        });
        QTest::mousePress(list.viewport(), Qt::RightButton, {}, list.centreOf(2));
        QCOMPARE(shown(list), u"11*< 9 30 4 5"_s); // the screen's alone
        for (const QPoint at : {list.centreOf(3), list.centreOf(4), {-40, 20}, list.centreOf(5)})
            QTest::mouseMove(list.viewport(), at);
        QTest::mouseRelease(list.viewport(), Qt::RightButton, {}, list.centreOf(5));
        QCOMPARE(told, texts("over 30 0", "over 4 2", "over  1", "over 5 0", "drop 5"));
        list.click(3); // all over: an ordinary click
        QCOMPARE(shown(list), u"11 9 30*< 4 5"_s);
    }

    void aDragMarksTheDropRowAlone()
    {
        ShownList list;
        list.selectionModel()->clearSelection();
        const auto picture = [&] { return list.viewport()->grab().toImage(); };
        const QImage withCursor = picture();
        list.clearFocus();
        const QImage plain = picture();
        list.setFocus();
        QVERIFY(picture() == withCursor && withCursor != plain);
        list.Drag(1);
        QVERIFY(picture() == plain);
        list.Drag(2);
        QVERIFY(picture() == withCursor);
    }

    void dragEndsWithoutDrop()
    {
        for (const bool byEsc : {false, true}) {
            ShownList list(manyDiscs(100));
            QSignalSpy drops(&list, &DBListViewCTL::DragDrop),
                overs(&list, &DBListViewCTL::DragOver);
            QTest::mousePress(list.viewport(), Qt::RightButton, {}, list.centreOf(2));
            list.Drag(1);
            // Near the lower edge the list scrolls, and the pointer is over another row.
            const QPoint edge(20, list.viewport()->height() - 2);
            QTest::mouseMove(list.viewport(), edge);
            auto *timer = list.findChild<QTimer *>(u"DragScroll"_s);
            const int before = list.verticalScrollBar()->value();
            QTimerEvent tick(timer->timerId());
            QApplication::sendEvent(timer, &tick);
            QCOMPARE(list.verticalScrollBar()->value(), before + 1);
            QCOMPARE(overs.count(), 2);
            if (byEsc)
                QTest::keyClick(&list, Qt::Key_Escape);
            QTest::mouseRelease(list.viewport(), Qt::RightButton, {},
                                byEsc ? edge : QPoint(-20, 20));
            QCOMPARE(drops.count(), 0);
            QVERIFY(!timer->isActive());
        }
    }

    void aTextThatIsCutIsToldWhole()
    {
        ShownList list;
        list.ListItems().Item(1).setSubItems(1, u"<b>Long & Bold</b>"_s);
        for (const int width : {300, 20}) {
            list.ColumnHeaders().Item(2).setWidth(width);
            const QPoint at = list.centreOf(1);
            QHelpEvent event(QEvent::ToolTip, at, list.viewport()->mapToGlobal(at));
            QApplication::sendEvent(list.viewport(), &event);
            QCOMPARE(QToolTip::text().contains(u"&lt;b&gt;Long &amp; Bold"_s), width == 20);
        }
    }

    void aTextOfTwoLinesStandsInOne()
    {
        ShownList list;
        const QModelIndex cell = list.model()->index(0, 1);
        list.ListItems().Item(1).setSubItems(1, u"first second"_s);
        const QSize size = list.sizeHintForIndex(cell);
        list.ListItems().Item(1).setSubItems(1, u"first\nsecond"_s);
        QCOMPARE(list.sizeHintForIndex(cell), size);
    }

    void handlesManyRows()
    {
        QAccessible::setActive(true); // nor may assistive tools ask for each cell
        constexpr int count = 200000;
        ShownList list(manyDiscs(count));
        const auto select = [&](int rows, QItemSelectionModel::SelectionFlags how) {
            list.selectionModel()->select(
                {list.model()->index(0, 0), list.model()->index(rows - 1, 2)}, how);
        };
        list.setSorted(true);
        list.setSortKey(1);
        // Every seventh of the next order: more pieces than can be painted. The current row stays.
        list.setSelectedItem(list.ListItems().Item(1));
        select(count / 7, QItemSelectionModel::Select);
        const QString id = list.SelectedItem().Text();
        list.setSortKey(0);
        QVERIFY(list.SelectedItem().Text() == id && list.SelectedItem().Selected());
        // Fewer stay, and go at once.
        list.setSortKey(1);
        select(10000, QItemSelectionModel::ClearAndSelect);
        list.setSortKey(0);
        QCOMPARE(list.selectionModel()->selection().size(), 10000);
        QElapsedTimer time;
        time.start();
        QTest::keyClick(&list, Qt::Key_A, Qt::ControlModifier);
        QVERIFY(list.ListItems().Item(count).Selected());
        list.click(1);
        QVERIFY(time.elapsed() < 2000);
        QCOMPARE(list.selectionModel()->selection().size(), 1);
        QAccessible::setActive(false);
    }
};

QTEST_MAIN(tst_DBListViewCTL)
#include "tst_DBListViewCTL.moc"
