#include "controls/list/listmodel.h"

#include <QFont>

namespace
{

constexpr int sortedByOldTexts = -2;

bool asciiEqual(char a, char16_t b)
{
    const auto small = [](char16_t c) { return c >= 'A' && c <= 'Z' ? char16_t(c | 0x20) : c; };
    return small(char16_t(a)) == small(b);
}

bool sameCell(const ADODB::Rows &a, const ADODB::Rows &b, qsizetype row, int column)
{
    using Kind = ADODB::Rows::Kind;
    const Kind kind = a.kind(row, column);
    if (kind != b.kind(row, column))
        return false;
    if (kind == Kind::Text)
        return a.utf8(row, column) == b.utf8(row, column);
    return kind == Kind::Integer ? a.integer(row, column) == b.integer(row, column)
                                 : a.text(row, column) == b.text(row, column);
}

bool sameRows(const ADODB::Rows &a, const ADODB::Rows &b)
{
    if (a.columnCount() != b.columnCount() || a.rowCount() != b.rowCount())
        return false;
    for (qsizetype row = 0; row < a.rowCount(); ++row) {
        for (int column = 0; column < a.columnCount(); ++column) {
            if (!sameCell(a, b, row, column))
                return false;
        }
    }
    return true;
}

} // namespace

void ListModel::fill(std::shared_ptr<const ADODB::Rows> rows)
{
    beginResetModel();
    ++mFilling;
    keepOrderFor(rows.get());
    mRows = std::move(rows);
    mCaptions.clear();
    mAlignments.clear();
    mHidden.clear();
    if (mRows) {
        for (const ADODB::FieldInfo &field : mRows->fields())
            mCaptions.append(field.name);
    }
    mOrder = {};
    mRowOf = {};
    mSortedBy = -1;
    mWritten.clear();
    mMarks.clear();
    endResetModel();
}

QString ListModel::text(int record, int column) const
{
    if (const auto written = mWritten.constFind(column); written != mWritten.constEnd()) {
        if (const auto text = written->constFind(record); text != written->constEnd())
            return *text;
    }
    return mRows->text(record, column);
}

void ListModel::write(int record, int column, const QString &text)
{
    mWritten[column].insert(record, text);
    if (column == mSortedBy)
        mSortedBy = sortedByOldTexts;
    rowChanged(record);
}

void ListModel::setMarks(int record, const Marks &marks)
{
    mMarks.insert(record, marks);
    rowChanged(record);
}

bool ListModel::startsWith(int record, int column, const QString &start) const
{
    // Most cells are told apart by their first byte, without making a text of them.
    const char16_t first = start.front().unicode();
    if (mRows->kind(record, column) == ADODB::Rows::Kind::Text && !mWritten.contains(column)) {
        const auto bytes = mRows->utf8(record, column);
        if (bytes.empty() || (!(bytes[0] & 0x80) && !asciiEqual(bytes[0], first)))
            return false;
    }
    return text(record, column).startsWith(start, Qt::CaseInsensitive);
}

// Goes by records, since these lie in memory one behind the other: in the order of a sorted list a
// million rows would take a second.
int ListModel::findStart(int column, const QString &start, int fromRow) const
{
    const int rows = rowCount();
    int nearest = rows;
    for (int record = 0; record < rows && nearest > 0; ++record) {
        const int distance = (rowOf(record) - fromRow + rows) % rows;
        if (distance < nearest && startsWith(record, column, start))
            nearest = distance;
    }
    return nearest < rows ? (fromRow + nearest) % rows : -1;
}

void ListModel::sortBy(int column)
{
    if (hasOrderOf(column))
        return;
    setOrder(orderBy(column));
    mSortedBy = column;
}

std::vector<std::uint32_t> ListModel::orderBy(int column)
{
    if (column < 0)
        return {};
    const WrittenTexts written = mWritten.value(column);
    if (column == mLastSortedBy && written.isEmpty())
        return mLastOrder;
    return sortedRows(*mRows, column, written);
}

// Rows that are the same again need not be sorted again.
void ListModel::keepOrderFor(const ADODB::Rows *rows)
{
    const bool byOwnTexts = mSortedBy >= 0 && !mWritten.contains(mSortedBy);
    const bool same = byOwnTexts && rows && mRows && sameRows(*rows, *mRows);
    mLastSortedBy = same ? mSortedBy : -1;
    mLastOrder = same ? std::move(mOrder) : std::vector<std::uint32_t>();
}

void ListModel::setOrder(std::vector<std::uint32_t> order)
{
    emit layoutAboutToBeChanged({}, VerticalSortHint);
    const QModelIndexList before = persistentIndexList();
    std::vector<int> records;
    for (const QModelIndex &index : before)
        records.push_back(recordAt(index.row()));
    mOrder = std::move(order);
    mRowOf.resize(mOrder.size());
    for (std::size_t row = 0; row < mOrder.size(); ++row)
        mRowOf[mOrder[row]] = std::uint32_t(row);
    QModelIndexList after;
    for (qsizetype i = 0; i < before.size(); ++i)
        after.append(index(rowOf(records[std::size_t(i)]), before[i].column()));
    changePersistentIndexList(before, after);
    emit layoutChanged({}, VerticalSortHint);
}

void ListModel::setAlignment(int column, Qt::Alignment side)
{
    mAlignments.insert(column, side);
    emit headerDataChanged(Qt::Horizontal, column, column);
    if (rowCount() > 0)
        emit dataChanged(index(0, column), index(rowCount() - 1, column));
}

void ListModel::setHidden(int column, bool hidden)
{
    if (hidden)
        mHidden.insert(column);
    else
        mHidden.remove(column);
}

QString ListModel::rowText(int record) const
{
    QStringList texts;
    for (int column = 0; column < columnCount(); ++column) {
        if (!mHidden.contains(column) && !text(record, column).isEmpty())
            texts.append(text(record, column));
    }
    return texts.join(u", ");
}

QVariant ListModel::alignment(int column) const
{
    const auto side = mAlignments.constFind(column);
    return side == mAlignments.constEnd() ? QVariant()
                                          : QVariant((*side | Qt::AlignVCenter).toInt());
}

void ListModel::setCheckColumn(int column)
{
    if (column == mCheckColumn)
        return;
    mCheckColumn = column;
    if (rowCount() > 0)
        emit dataChanged(index(0, 0), index(rowCount() - 1, columnCount() - 1),
                         {Qt::CheckStateRole});
}

void ListModel::rowChanged(int record)
{
    const int row = rowOf(record);
    emit dataChanged(index(row, 0), index(row, columnCount() - 1));
}

int ListModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() || !mRows ? 0 : int(mRows->rowCount());
}

int ListModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : int(mCaptions.size());
}

QVariant ListModel::data(const QModelIndex &index, int role) const
{
    if (!checkIndex(index, CheckIndexOption::IndexIsValid))
        return {};
    const int record = recordAt(index.row());
    switch (role) {
    case Qt::DisplayRole:
        return text(record, index.column());
    case Qt::TextAlignmentRole:
        return alignment(index.column());
    case Qt::AccessibleTextRole:
        return index.column() == mFirstShown ? QVariant(rowText(record)) : QVariant();
    case Qt::FontRole:
        if (marks(record).bold) {
            QFont font;
            font.setBold(true);
            return font;
        }
        return {};
    case Qt::ForegroundRole: {
        const QColor color = marks(record).color;
        return color.isValid() ? QVariant(color) : QVariant();
    }
    case Qt::CheckStateRole:
        if (index.column() == mCheckColumn)
            return marks(record).checked ? Qt::Checked : Qt::Unchecked;
        return {};
    default:
        return {};
    }
}

bool ListModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!index.isValid() || role != Qt::CheckStateRole || index.column() != mCheckColumn)
        return false;
    const int record = recordAt(index.row());
    Marks changed = marks(record);
    changed.checked = value.toInt() == Qt::Checked;
    setMarks(record, changed);
    emit checkToggled(record);
    return true;
}

QVariant ListModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole)
        return mCaptions.value(section);
    if (orientation == Qt::Horizontal && role == Qt::TextAlignmentRole)
        return alignment(section);
    return {};
}

bool ListModel::setHeaderData(int section, Qt::Orientation orientation, const QVariant &value,
                              int role)
{
    if (orientation != Qt::Horizontal || role != Qt::EditRole || section < 0 ||
        section >= mCaptions.size())
        return false;
    mCaptions[section] = value.toString();
    emit headerDataChanged(orientation, section, section);
    return true;
}

Qt::ItemFlags ListModel::flags(const QModelIndex &index) const
{
    if (!index.isValid())
        return {};
    const Qt::ItemFlags usual = Qt::ItemIsEnabled | Qt::ItemIsSelectable | Qt::ItemNeverHasChildren;
    return index.column() == mCheckColumn ? usual | Qt::ItemIsUserCheckable : usual;
}
