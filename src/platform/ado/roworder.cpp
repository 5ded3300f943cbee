#include "platform/ado/roworder.h"

#include "platform/ado/textsort.h"

#include <algorithm>

namespace ADODB
{

namespace
{

class ColumnTexts : public RowTexts
{
public:
    ColumnTexts(const Rows &rows, int column) : mRows(rows), mColumn(column) {}
    std::string_view text(std::uint32_t row) const override { return mRows.utf8(row, mColumn); }

private:
    const Rows &mRows;
    int mColumn;
};

/// Sorts by one column after the other: those behind the first only where rows are alike so far.
class RowOrder
{
public:
    RowOrder(const Rows &rows, const std::vector<OrderColumn> &columns, Repeats repeats)
        : mRows(rows), mColumns(columns), mRepeats(repeats)
    {
    }

    std::vector<std::uint32_t> sorted() const
    {
        std::vector<SortEntry> entries(std::size_t(mRows.rowCount()));
        for (std::size_t row = 0; row < entries.size(); ++row)
            entries[row].row = std::uint32_t(row);
        sort(entries.data(), entries.data() + entries.size(), 0);
        std::vector<std::uint32_t> order;
        order.reserve(entries.size());
        for (const SortEntry &entry : entries) {
            if (entry.row != dropped)
                order.push_back(entry.row);
        }
        return order;
    }

private:
    using Entry = SortEntry;
    using Kind = Rows::Kind;
    static constexpr std::uint32_t dropped = 0xFFFFFFFF;

    void finish(Entry *from, Entry *to) const
    {
        std::sort(from, to, [](const Entry &a, const Entry &b) { return a.row < b.row; });
        if (mRepeats == Repeats::Dropped)
            std::for_each(from + 1, to, [](Entry &e) { e.row = dropped; });
    }

    void sort(Entry *from, Entry *to, std::size_t level) const
    {
        if (to - from < 2)
            return;
        if (level == mColumns.size()) {
            finish(from, to);
            return;
        }
        const int column = mColumns[level].column;
        const auto kind = [&](const Entry &e) { return mRows.kind(e.row, column); };
        Entry *numbers =
            std::partition(from, to, [&](const Entry &e) { return kind(e) == Kind::Null; });
        Entry *texts =
            std::partition(numbers, to, [&](const Entry &e) { return kind(e) != Kind::Text; });
        sort(from, numbers, level + 1);
        sortNumbers(numbers, texts, level);
        sortTexts(texts, to, level);
    }

    // Wide enough for all whole numbers of 64 bits.
    long double number(std::uint32_t row, int column) const
    {
        if (mRows.kind(row, column) == Kind::Integer)
            return static_cast<long double>(mRows.integer(row, column));
        return static_cast<long double>(std::get<double>(mRows.value(row, column).variant()));
    }

    void sortNumbers(Entry *from, Entry *to, std::size_t level) const
    {
        const int column = mColumns[level].column;
        std::sort(from, to, [&](const Entry &a, const Entry &b) {
            return number(a.row, column) < number(b.row, column);
        });
        sortRuns(from, to, level, [&](const Entry &a, const Entry &b) {
            return number(a.row, column) == number(b.row, column);
        });
    }

    void sortTexts(Entry *from, Entry *to, std::size_t level) const
    {
        const ColumnTexts texts(mRows, mColumns[level].column);
        if (mColumns[level].byBytes) {
            sortBytes(from, to, level, texts);
            return;
        }
        TextSort(texts).sort(from, to);
        sortRuns(from, to, level, [&](const Entry &a, const Entry &b) {
            const auto x = texts.text(a.row), y = texts.text(b.row);
            return x == y || text::Collation::root().compare(x, y) == 0;
        });
    }

    void sortBytes(Entry *from, Entry *to, std::size_t level, const ColumnTexts &texts) const
    {
        std::sort(from, to, [&](const Entry &a, const Entry &b) {
            return texts.text(a.row) < texts.text(b.row);
        });
        sortRuns(from, to, level, [&](const Entry &a, const Entry &b) {
            return texts.text(a.row) == texts.text(b.row);
        });
    }

    template <typename Alike>
    void sortRuns(Entry *from, Entry *to, std::size_t level, const Alike &alike) const
    {
        while (from < to) {
            Entry *end = from + 1;
            while (end < to && alike(*from, *end))
                ++end;
            sort(from, end, level + 1);
            from = end;
        }
    }

    const Rows &mRows;
    const std::vector<OrderColumn> &mColumns;
    Repeats mRepeats;
};

} // namespace

std::vector<std::uint32_t> rowOrder(const Rows &rows, const std::vector<OrderColumn> &columns,
                                    Repeats repeats)
{
    return RowOrder(rows, columns, repeats).sorted();
}

} // namespace ADODB
