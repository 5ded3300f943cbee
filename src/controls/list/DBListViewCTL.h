#pragma once

#include "controls/list/listitems.h"
#include "platform/ado/recordset.h"

#include <QCursor>
#include <QElapsedTimer>
#include <QTableView>

class ListModel;
class RowDrag;

/// The list of all list screens: shows the rows of a recordset as Populate() finds them; what
/// happens to the recordset later does not show. Written cells, bold, colours and check marks
/// belong to the list and last until the next Populate(). Rows are sorted here and selected as
/// ranges; there is no object per row or cell.
///
/// It never acts on a key, a double click or a column click of its own accord beyond moving,
/// selecting and copying: it tells its screen. Positions are pixels of the viewport.
class DBListViewCTL : public QTableView
{
    Q_OBJECT

public:
    explicit DBListViewCTL(QWidget *parent = nullptr);
    ~DBListViewCTL() override;

    void setRecordset(ADODB::RecordsetPtr recordset);
    ADODB::RecordsetPtr Recordset() const { return mRecordset; }

    /// Shows the rows of the recordset as they are now, unsorted, all columns visible and headed by
    /// the names of the fields. The first row becomes current and selected. Throws Error
    /// if the recordset is closed, and then leaves the list as it was.
    void Populate();

    ::ListItems ListItems() { return ::ListItems(this); }
    ::ColumnHeaders ColumnHeaders() { return ::ColumnHeaders(this); }

    /// The current one. Where a person has put the cursor beside what is selected, it is the
    /// selected one nearest to it: what a person sees highlighted is what a command acts on.
    ListItem SelectedItem();
    void setSelectedItem(const ListItem &item);
    void setDropHighlight(const ListItem &item);
    ListItem HitTest(int x, int y);

    /// Sorted display: ascending by one column, rows with equal texts in the recordset's order. It
    /// ends with the next Populate(); the key stays.
    bool Sorted() const { return mSorted; }
    void setSorted(bool sorted);
    int SortKey() const { return mSortKey; } // from 0
    void setSortKey(int column);
    void sortBy(int column); // both, and the rows are sorted once

    bool CheckBoxes() const;
    void setCheckBoxes(bool on); // in the first visible column

    /// Whether a person may leave no row selected. Else the last one stays so, since the commands
    /// of most screens act on SelectedItem(), and that must be highlighted.
    void setMayBeUnselected(bool may) { mMayBeUnselected = may; }

    /// 1 begins to drag: from the press of a mouse button on, DragOver follows the pointer, and
    /// its release over the list is a DragDrop. 2 ends it; so does Esc, without a drop.
    void Drag(int action);
    void setDragIcon(const QCursor &cursor);

    void keyboardSearch(const QString &typed) override;
    void scrollTo(const QModelIndex &index, ScrollHint hint = EnsureVisible) override;

signals:
    void ItemClick(ListItem item); // and once more if the button, going up, selects other rows
    void SelectionCleared();       // a press beside the rows has left none selected
    void ItemCheck(ListItem item); // the user has changed a check mark
    void ColumnClick(int index);   // from 1; by mouse, or Ctrl+1 to 9 for those that show
    void DblClick();

    // keyCode as in keycodes.h; shift: 1 Shift, 2 Ctrl, 4 Alt; button: 1 left, 2 right, 4 middle.
    void KeyDown(int keyCode, int shift); // before the list acts on the key
    void KeyUp(int keyCode, int shift);
    void MouseDown(int button, int shift, int x, int y);
    void DragOver(QObject *source, int x, int y, int state); // 0 enters, 1 leaves, 2 over
    void DragDrop(QObject *source, int x, int y);
    void GotFocus();
    void LostFocus();

protected:
    QModelIndex moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) override;
    void currentChanged(const QModelIndex &current, const QModelIndex &previous) override;
    void selectionChanged(const QItemSelection &selected, const QItemSelection &old) override;
    void keyPressEvent(QKeyEvent *event) override;
    void keyReleaseEvent(QKeyEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void focusInEvent(QFocusEvent *event) override;
    void focusOutEvent(QFocusEvent *event) override;
    void hideEvent(QHideEvent *event) override;
    void changeEvent(QEvent *event) override;
    void paintEvent(QPaintEvent *event) override;

private:
    friend class ListItem;
    friend class ListItems;
    friend class ColumnHeader;
    friend class ColumnHeaders;

    void setUpHeaders();
    void fitRowHeight();
    ListItem itemAt(int row);
    int rowOf(const ListItem &item) const; // -1 for nothing
    QModelIndex shownIndex(int row) const; // a cell of the row in a visible column
    int selectedRowNear(int row) const;    // the row itself if none is selected
    void keepOneSelected();
    void makeCurrent(int row); // and selected alone
    void setRowSelected(int row, bool selected);
    int columnWidthOf(int column) const;
    void setColumnWidthOf(int column, int width);
    void columnsChanged();
    void applyOrder();
    std::vector<bool> selectedRecords() const;
    void selectRecords(const std::vector<bool> &selected, int current);
    void showSortMark();
    void copySelected() const;
    void appendLine(QString &text, int record) const;
    bool actOnKey(QKeyEvent *event);
    void clickShownColumn(int nth);
    void toggleCheck(const QModelIndex &index);
    bool onCheckBox(const QModelIndex &index, QPoint at) const;
    int searchFrom(int row, const QString &text) const;
    QRect rowRect(int row) const;

    ListModel *mModel;
    RowDrag *mDrag;
    ADODB::RecordsetPtr mRecordset;
    bool mSorted = false;
    int mSortKey = 0;
    bool mMayBeUnselected = false;
    bool mCheckPressed = false;
    bool mSelectionMoved = false; // since the button of the mouse went down
    ListItem mDropHighlight;
    QString mTyped;
    QElapsedTimer mTypedAt;
};
