#include "controls/sortedrows.h"

#include "platform/text/collation.h"

#include <QtEndian>

#include <algorithm>
#include <bit>
#include <charconv>
#include <cstring>
#include <optional>
#include <string>
#include <string_view>

namespace
{

using Row = std::uint32_t;

/// A row with what decides its place first: a value, or the next eight letters of its text as a
/// number, and what is left of the text behind them. The text is kept here because looking it up
/// in the rows is what costs most.
struct Entry {
    std::uint64_t key;
    const char *rest;
    std::uint32_t restSize : 31;
    std::uint32_t accented : 1; // letters with accents so far
    Row row;
};
using Entries = std::vector<Entry>;

struct ByKey {
    bool operator()(const Entry &a, const Entry &b) const
    {
        return a.key != b.key ? a.key < b.key : a.row < b.row;
    }
};

std::optional<qint64> wholeNumber(std::string_view s)
{
    const bool plus = s.size() > 1 && s[0] == '+' && s[1] != '-';
    qint64 v = 0;
    const auto [stop, failure] = std::from_chars(s.data() + plus, s.data() + s.size(), v);
    if (failure != std::errc() || stop != s.data() + s.size())
        return {};
    return v;
}

std::uint64_t sortableNumber(qint64 v)
{
    return std::uint64_t(v) ^ std::uint64_t(1) << 63;
}

/// The texts of a column in UTF-8. Those that the rows do not hold as such are made once.
class ColumnTexts
{
public:
    ColumnTexts(const ADODB::Rows &rows, int column, const WrittenTexts &written)
        : mRows(rows), mColumn(column)
    {
        for (auto it = written.begin(); it != written.end(); ++it)
            mMade.insert(Row(it.key()), it.value().toStdString());
    }

    Row count() const { return Row(mRows.rowCount()); }

    std::string_view operator[](Row row) const
    {
        if (!mMade.isEmpty()) {
            if (const auto made = mMade.constFind(row); made != mMade.constEnd())
                return *made;
        }
        return kind(row) == Kind::Text ? mRows.utf8(row, mColumn) : std::string_view();
    }

    /// Whether the cell holds a whole number, not a text of one.
    bool isInteger(Row row) const { return kind(row) == Kind::Integer && !mMade.contains(row); }
    qint64 integer(Row row) const { return mRows.integer(row, mColumn); }

    /// Numbers have texts only after this.
    void spellNumbers()
    {
        for (Row row = 0; row < count(); ++row) {
            const Kind k = kind(row);
            if ((k == Kind::Integer || k == Kind::Real) && !mMade.contains(row))
                mMade.insert(row, mRows.text(row, mColumn).toStdString());
        }
    }

private:
    using Kind = ADODB::Rows::Kind;
    Kind kind(Row row) const { return mRows.kind(row, mColumn); }

    const ADODB::Rows &mRows;
    int mColumn;
    QHash<Row, std::string> mMade;
};

/// Rows by their texts. Those with Latin letters alone are sorted eight letters at a time, the
/// others by sort keys, which take longer to make; then the two are merged.
class TextSort
{
public:
    explicit TextSort(const ColumnTexts &texts) : mTexts(texts) {}

    std::vector<Row> sorted() const
    {
        std::vector<Row> result;
        result.reserve(mTexts.count());
        Entries entries;
        entries.reserve(mTexts.count());
        for (Row row = 0; row < mTexts.count(); ++row) {
            if (const auto text = mTexts[row]; text.empty())
                result.push_back(row);
            else
                entries.push_back({0, text.data(), std::uint32_t(text.size()), 0, row});
        }
        sortRest(entries.data(), entries.data() + entries.size(), 0);
        for (const Entry &entry : entries)
            result.push_back(entry.row);
        return result;
    }

private:
    static constexpr int deepest = 64; // beyond so many times eight letters texts are compared

    /// False if the rest of the text has to be sorted by its sort key.
    bool takeKey(Entry &entry) const
    {
        std::size_t used = 0;
        const bool latin = mCollation.sortPrefix({entry.rest, entry.restSize}, entry.key, used);
        const auto letters = 8 - std::size_t(std::countr_zero(entry.key)) / 8;
        entry.accented |= used > letters;
        entry.rest += used;
        entry.restSize -= std::uint32_t(used);
        return latin;
    }

    bool before(const Entry &a, const Entry &b) const
    {
        const auto x = mTexts[a.row], y = mTexts[b.row];
        const int order = x == y ? 0 : mCollation.compare(x, y);
        return order != 0 ? order < 0 : a.row < b.row;
    }

    /// Sorts entries whose texts have been alike up to their rests.
    void sortRest(Entry *from, Entry *to, int depth) const
    {
        Entries others;
        Entry *end = from;
        for (Entry *entry = from; entry < to; ++entry) {
            if (takeKey(*entry))
                *end++ = *entry;
            else
                others.push_back(*entry);
        }
        sortLatin(from, end, depth);
        if (!others.empty()) {
            sortBySortKeys(others);
            mergeIn(from, end, others);
        }
    }

    void sortLatin(Entry *from, Entry *to, int depth) const
    {
        if (!std::is_sorted(from, to, ByKey()))
            std::sort(from, to, ByKey());
        while (from < to) {
            Entry *end = from + 1;
            while (end < to && end->key == from->key)
                ++end;
            if (end - from > 1)
                sortRun(from, end, depth);
            from = end;
        }
    }

    /// Sorts entries with the same key.
    void sortRun(Entry *from, Entry *to, int depth) const
    {
        const bool ended = (from->key & 0xFF) == 0;
        if (!ended && depth < deepest)
            sortRest(from, to, depth + 1);
        else if (!ended || std::any_of(from, to, [](const Entry &e) { return e.accented; }))
            sortAsTexts(from, to);
    }

    void sortAsTexts(Entry *from, Entry *to) const
    {
        const auto less = [this](const Entry &a, const Entry &b) { return before(a, b); };
        if (!std::is_sorted(from, to, less)) // mostly they are all the same
            std::sort(from, to, less);
    }

    void sortBySortKeys(Entries &entries) const
    {
        std::string keys;
        for (Entry &entry : entries) {
            entry.key = keys.size();
            mCollation.appendSortKey(mTexts[entry.row], keys);
        }
        for (Entry &entry : entries) {
            entry.rest = keys.data() + entry.key;
            char start[sizeof entry.key] = {};
            std::memcpy(start, entry.rest, strnlen(entry.rest, sizeof start));
            entry.key = qFromBigEndian<quint64>(start);
        }
        std::sort(entries.begin(), entries.end(), [](const Entry &a, const Entry &b) {
            if (a.key != b.key)
                return a.key < b.key;
            const int order = std::strcmp(a.rest, b.rest);
            return order != 0 ? order < 0 : a.row < b.row;
        });
    }

    /// Merges the others, which fit behind the end, into [from, end), from the last one on. Looks
    /// for the place of each in growing steps: there are mostly few of them.
    void mergeIn(Entry *from, Entry *end, const Entries &others) const
    {
        const auto less = [this](const Entry &a, const Entry &b) { return before(a, b); };
        Entry *to = end + others.size();
        for (auto other = others.rbegin(); other != others.rend(); ++other) {
            std::ptrdiff_t step = 1;
            while (step <= end - from && less(*other, end[-step]))
                step *= 2;
            Entry *place =
                std::upper_bound(std::max(from, end - step), end - step / 2, *other, less);
            to = std::move_backward(place, end, to);
            *--to = *other;
            end = place;
        }
    }

    const ColumnTexts &mTexts;
    const text::Collation &mCollation = text::Collation::root();
};

/// The order by value; nothing if a text is no whole number.
std::optional<std::vector<Row>> byNumber(const ColumnTexts &texts)
{
    std::vector<Row> result;
    Entries numbers;
    for (Row row = 0; row < texts.count(); ++row) {
        if (texts.isInteger(row)) {
            numbers.push_back({sortableNumber(texts.integer(row)), nullptr, 0, 0, row});
        } else if (const auto text = texts[row]; text.empty()) {
            result.push_back(row);
        } else if (const auto value = wholeNumber(text)) {
            numbers.push_back({sortableNumber(*value), nullptr, 0, 0, row});
        } else {
            return {};
        }
    }
    std::sort(numbers.begin(), numbers.end(), ByKey());
    for (const Entry &entry : numbers)
        result.push_back(entry.row);
    return result;
}

} // namespace

std::vector<std::uint32_t> sortedRows(const ADODB::Rows &rows, int column,
                                      const WrittenTexts &written)
{
    ColumnTexts texts(rows, column, written);
    if (auto order = byNumber(texts))
        return *std::move(order);
    texts.spellNumbers();
    return TextSort(texts).sorted();
}
