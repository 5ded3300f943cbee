#include "controls/list/DBListViewCTL.h"

#include "controls/list/listmodel.h"
#include "controls/list/rowdelegate.h"
#include "controls/list/rowdrag.h"
#include "controls/list/rowselection.h"

#include <QAccessible>
#include <QApplication>
#include <QClipboard>
#include <QHeaderView>
#include <QPainter>
#include <QScrollBar>
#include <QStyleOption>

#include <algorithm>

namespace
{

constexpr int defaultColumnWidth = 96;
constexpr int dropShade = 80; // of 255, over the row
constexpr std::size_t mostRanges = 12000;

qsizetype rowsIn(const QItemSelection &selection)
{
    qsizetype rows = 0;
    for (const QItemSelectionRange &range : selection)
        rows += range.height();
    return rows;
}

} // namespace

DBListViewCTL::DBListViewCTL(QWidget *parent)
    : QTableView(parent), mModel(new ListModel(this)), mDrag(new RowDrag(this))
{
    setModel(mModel);
    auto *rows = new RowSelection(mModel, this);
    delete selectionModel();
    setSelectionModel(rows);
    connect(rows, &RowSelection::dropped, viewport(), qOverload<>(&QWidget::update));
    setItemDelegate(new RowDelegate(this));
    setSelectionBehavior(SelectRows);
    setSelectionMode(ExtendedSelection);
    setEditTriggers(NoEditTriggers);
    setTabKeyNavigation(false);
    setShowGrid(false);
    setWordWrap(false);
    setHorizontalScrollMode(ScrollPerPixel);
    setUpHeaders();
    fitRowHeight();
    connect(mModel, &ListModel::checkToggled, this,
            [this](int record) { emit ItemCheck(itemAt(mModel->rowOf(record))); });
}

DBListViewCTL::~DBListViewCTL() = default;

void DBListViewCTL::setUpHeaders()
{
    verticalHeader()->hide();
    verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    verticalHeader()->setMinimumSectionSize(1);

    QHeaderView *head = horizontalHeader();
    head->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    head->setDefaultSectionSize(defaultColumnWidth);
    head->setMinimumSectionSize(1);
    head->setHighlightSections(false);
    head->setSectionsClickable(true);
    head->setSortIndicatorShown(true);
    showSortMark();
    // To draw their sections as selected the headers would ask for each row whether it is.
    for (QHeaderView *header : {head, verticalHeader()})
        header->setSelectionModel(new QItemSelectionModel(mModel, header));
    // A table selects a whole column otherwise.
    disconnect(head, &QHeaderView::sectionPressed, this, nullptr);
    disconnect(head, &QHeaderView::sectionEntered, this, nullptr);
    connect(head, &QHeaderView::sectionClicked, this, [this](int column) {
        showSortMark(); // the header has moved it on its own
        emit ColumnClick(column + 1);
    });
}

void DBListViewCTL::fitRowHeight()
{
    const int text = fontMetrics().height();
    const int box =
        CheckBoxes() ? style()->pixelMetric(QStyle::PM_IndicatorHeight, nullptr, this) : 0;
    verticalHeader()->setDefaultSectionSize(std::max(text, box) + 4);
}

void DBListViewCTL::setRecordset(ADODB::RecordsetPtr recordset)
{
    mRecordset = std::move(recordset);
}

void DBListViewCTL::Populate()
{
    auto rows = mRecordset ? mRecordset->rows() : nullptr;
    mSorted = false;
    mTyped.clear();
    // A head that is hidden while its model is reset can get no width afterwards.
    for (int column = 0; column < mModel->columnCount(); ++column)
        setColumnHidden(column, false);
    mModel->fill(std::move(rows));
    for (int column = 0; column < mModel->columnCount(); ++column) {
        setColumnHidden(column, false);
        setColumnWidth(column, defaultColumnWidth);
    }
    columnsChanged();
    showSortMark();
    makeCurrent(0);
}

ListItem DBListViewCTL::itemAt(int row)
{
    if (row < 0 || row >= mModel->rowCount())
        return {};
    return {this, mModel->recordAt(row), mModel->filling()};
}

int DBListViewCTL::rowOf(const ListItem &item) const
{
    return item && item.mList == this ? mModel->rowOf(item.mRecord) : -1;
}

QModelIndex DBListViewCTL::shownIndex(int row) const
{
    int column = 0;
    while (column < mModel->columnCount() && isColumnHidden(column))
        ++column;
    return mModel->index(row, column < mModel->columnCount() ? column : 0);
}

ListItem DBListViewCTL::SelectedItem()
{
    return itemAt(selectedRowNear(currentIndex().row()));
}

int DBListViewCTL::selectedRowNear(int row) const
{
    int nearest = row, distance = mModel->rowCount() + 1;
    for (const QItemSelectionRange &range : selectionModel()->selection()) {
        const int candidate = std::clamp(row, range.top(), range.bottom());
        if (std::abs(candidate - row) < distance) {
            nearest = candidate;
            distance = std::abs(candidate - row);
        }
    }
    return nearest;
}

// No click and no key of a person leaves such a list without a highlighted row.
void DBListViewCTL::keepOneSelected()
{
    if (!mMayBeUnselected && currentIndex().isValid() && !selectionModel()->hasSelection())
        selectionModel()->select(currentIndex(),
                                 QItemSelectionModel::Select | QItemSelectionModel::Rows);
}

void DBListViewCTL::setSelectedItem(const ListItem &item)
{
    makeCurrent(rowOf(item));
}

void DBListViewCTL::makeCurrent(int row)
{
    const QModelIndex index = shownIndex(row);
    if (!index.isValid()) {
        selectionModel()->clear();
        return;
    }
    selectionModel()->setCurrentIndex(index, QItemSelectionModel::ClearAndSelect |
                                                 QItemSelectionModel::Rows);
    scrollTo(index);
}

// Rows beside selected ones widen their range, so that a screen that selects many rows one by one
// makes few ranges.
void DBListViewCTL::setRowSelected(int row, bool selected)
{
    const auto command = selected ? QItemSelectionModel::Select : QItemSelectionModel::Deselect;
    int top = row, bottom = row;
    const bool currentIsSelected = selectionModel()->isSelected(currentIndex());
    if (selected) {
        for (const QItemSelectionRange &range : selectionModel()->selection()) {
            if (range.bottom() == row - 1)
                top = range.top();
            if (range.top() == row + 1)
                bottom = range.bottom();
        }
    }
    const QItemSelection rows(mModel->index(top, 0), mModel->index(bottom, 0));
    selectionModel()->select(rows, command | QItemSelectionModel::Rows);
    if (selected && !currentIsSelected) {
        setAutoScroll(false);
        selectionModel()->setCurrentIndex(shownIndex(row), QItemSelectionModel::NoUpdate);
        setAutoScroll(true);
    }
}

void DBListViewCTL::setDropHighlight(const ListItem &item)
{
    mDropHighlight = item;
    viewport()->update();
}

ListItem DBListViewCTL::HitTest(int x, int y)
{
    const QPoint at(x, y);
    return viewport()->rect().contains(at) ? itemAt(indexAt(at).row()) : ListItem();
}

void DBListViewCTL::setSorted(bool sorted)
{
    mSorted = sorted;
    applyOrder();
}

void DBListViewCTL::setSortKey(int column)
{
    mSortKey = column;
    applyOrder();
}

void DBListViewCTL::sortBy(int column)
{
    mSortKey = column;
    setSorted(true);
}

void DBListViewCTL::applyOrder()
{
    const bool possible = mSortKey >= 0 && mSortKey < mModel->columnCount();
    const int column = mSorted && possible ? mSortKey : -1;
    if (!mModel->hasOrderOf(column)) {
        const ListItem current = itemAt(currentIndex().row());
        const QModelIndex cell = currentIndex();
        const std::vector<bool> selected = selectedRecords();
        selectionModel()->reset();
        mModel->sortBy(column);
        selectRecords(selected, rowOf(current));
        if (current)
            selectionModel()->setCurrentIndex(mModel->index(rowOf(current), cell.column()),
                                              QItemSelectionModel::NoUpdate);
        viewport()->update();
    }
    showSortMark();
}

// One bit for each record; none at all if no row is selected.
std::vector<bool> DBListViewCTL::selectedRecords() const
{
    std::vector<bool> selected;
    for (const QItemSelectionRange &range : selectionModel()->selection()) {
        selected.resize(std::size_t(mModel->rowCount()));
        for (int row = range.top(); row <= range.bottom(); ++row)
            selected[std::size_t(mModel->recordAt(row))] = true;
    }
    return selected;
}

void DBListViewCTL::selectRecords(const std::vector<bool> &selected, int current)
{
    const auto isSelected = [&](int row) { return selected[std::size_t(mModel->recordAt(row))]; };
    const int rows = int(selected.size());
    std::vector<std::pair<int, int>> ranges; // first row, row behind the last
    for (int row = 0; row < rows; ++row) {
        if (!isSelected(row))
            continue;
        if (!ranges.empty() && ranges.back().second == row)
            ++ranges.back().second;
        else
            ranges.emplace_back(row, row + 1);
    }
    // By design: a selection in more pieces would hold the list up for seconds at each paint.
    if (ranges.size() > mostRanges) {
        ranges.clear();
        if (current >= 0)
            ranges.emplace_back(current, current + 1);
    }
    QItemSelection selection;
    for (const auto &[top, end] : ranges)
        selection.append(
            {mModel->index(top, 0), mModel->index(end - 1, mModel->columnCount() - 1)});
    selectionModel()->select(selection, QItemSelectionModel::Select);
}

void DBListViewCTL::showSortMark()
{
    const bool shown = mSorted && mSortKey < mModel->columnCount();
    horizontalHeader()->setSortIndicator(shown ? mSortKey : -1, Qt::AscendingOrder);
}

int DBListViewCTL::columnWidthOf(int column) const
{
    return isColumnHidden(column) ? 0 : columnWidth(column);
}

void DBListViewCTL::setColumnWidthOf(int column, int width)
{
    setColumnHidden(column, width <= 0);
    mModel->setHidden(column, width <= 0);
    if (width > 0)
        setColumnWidth(column, width);
    columnsChanged();
}

// The current cell and the check boxes are always in the first column that shows.
void DBListViewCTL::columnsChanged()
{
    const int first = shownIndex(0).isValid() ? shownIndex(0).column() : 0;
    if (CheckBoxes())
        mModel->setCheckColumn(first);
    const QModelIndex current = currentIndex();
    mModel->setFirstShown(first);
    if (current.isValid() && current.column() != first)
        selectionModel()->setCurrentIndex(shownIndex(current.row()), QItemSelectionModel::NoUpdate);
}

bool DBListViewCTL::CheckBoxes() const
{
    return mModel->checkColumn() >= 0;
}

void DBListViewCTL::setCheckBoxes(bool on)
{
    mModel->setCheckColumn(on ? 0 : -1);
    columnsChanged();
    fitRowHeight();
}

void DBListViewCTL::Drag(int action)
{
    if (action == 1)
        mDrag->begin();
    else
        mDrag->end();
}

void DBListViewCTL::setDragIcon(const QCursor &cursor)
{
    mDrag->setCursor(cursor);
}

// Sideways the list stays where the user has put it.
void DBListViewCTL::scrollTo(const QModelIndex &index, ScrollHint hint)
{
    executeDelayedItemsLayout(); // rows that have come since the last paint can be scrolled to
    const int left = horizontalScrollBar()->value();
    QTableView::scrollTo(shownIndex(index.row()), hint);
    horizontalScrollBar()->setValue(left);
}

QModelIndex DBListViewCTL::moveCursor(CursorAction action, Qt::KeyboardModifiers)
{
    const QModelIndex current = currentIndex();
    const int last = mModel->rowCount() - 1;
    if (!current.isValid())
        return shownIndex(0);
    const int page = std::max(1, viewport()->height() / rowHeight(0) - 1);
    const auto to = [&](int row) { return current.siblingAtRow(std::clamp(row, 0, last)); };
    switch (action) {
    case MoveUp:
    case MovePrevious:
        return to(current.row() - 1);
    case MoveDown:
    case MoveNext:
        return to(current.row() + 1);
    case MovePageUp:
        return to(current.row() - page);
    case MovePageDown:
        return to(current.row() + page);
    case MoveHome:
        return to(0);
    case MoveEnd:
        return to(last);
    default:
        return current;
    }
}

// A table would list every selected cell for assistive tools.
void DBListViewCTL::selectionChanged(const QItemSelection &selected, const QItemSelection &old)
{
    constexpr qsizetype many = 1000;
    mSelectionMoved = true;
    if (!QAccessible::isActive() || rowsIn(selected) + rowsIn(old) < many) {
        QTableView::selectionChanged(selected, old);
        return;
    }
    QAbstractItemView::selectionChanged(selected, old); // NOLINT: the table's own is what costs
    QAccessibleEvent event(this, QAccessible::SelectionWithin);
    QAccessible::updateAccessibility(&event);
}

void DBListViewCTL::copySelected() const
{
    std::vector<std::pair<int, int>> ranges;
    for (const QItemSelectionRange &range : selectionModel()->selection())
        ranges.emplace_back(range.top(), range.bottom());
    std::sort(ranges.begin(), ranges.end());
    QString text;
    for (const auto &[top, bottom] : ranges) {
        for (int row = top; row <= bottom; ++row)
            appendLine(text, mModel->recordAt(row));
    }
    if (!text.isEmpty())
        QApplication::clipboard()->setText(text);
}

void DBListViewCTL::appendLine(QString &text, int record) const
{
    bool first = true;
    for (int column = 0; column < mModel->columnCount(); ++column) {
        if (isColumnHidden(column))
            continue;
        if (!first)
            text += u'\t';
        first = false;
        QString cell = mModel->text(record, column);
        for (const QChar separator : {u'\t', u'\n', u'\r'})
            cell.replace(separator, u' ');
        text += cell;
    }
    text += u'\n';
}

void DBListViewCTL::changeEvent(QEvent *event)
{
    QTableView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange)
        fitRowHeight();
}

void DBListViewCTL::paintEvent(QPaintEvent *event)
{
    QTableView::paintEvent(event);
    QPainter painter(viewport());
    if (const int row = rowOf(mDropHighlight); row >= 0) {
        QColor shade = palette().color(QPalette::Highlight);
        painter.setPen(shade);
        shade.setAlpha(dropShade);
        painter.setBrush(shade);
        painter.drawRect(rowRect(row).adjusted(0, 0, -1, -1));
    }
    // The frame is filled in some styles: a drag would have two rows that look marked.
    if (hasFocus() && currentIndex().isValid() && !mDrag->running()) {
        QStyleOptionFocusRect option;
        option.initFrom(this);
        option.rect = rowRect(currentIndex().row());
        option.state |= QStyle::State_KeyboardFocusChange;
        option.backgroundColor = palette().color(QPalette::Base);
        style()->drawPrimitive(QStyle::PE_FrameFocusRect, &option, &painter, this);
    }
}

QRect DBListViewCTL::rowRect(int row) const
{
    const int width = std::max(horizontalHeader()->length() - horizontalHeader()->offset(), 0);
    return {0, rowViewportPosition(row), std::min(width, viewport()->width()), rowHeight(row)};
}
