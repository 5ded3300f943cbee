#include "controls/sortedrows.h"

#include "platform/text/collation.h"

#include <algorithm>
#include <charconv>
#include <optional>
#include <string>
#include <string_view>

namespace
{

using Row = std::uint32_t;

/// A row with what decides its place first: a value, or the start of its text as a number.
struct Entry {
    std::uint64_t key;
    Row row;
    std::uint32_t used; // bytes of the text that the keys so far stand for
};
using Entries = std::vector<Entry>;

bool byKey(const Entry &a, const Entry &b)
{
    return a.key != b.key ? a.key < b.key : a.row < b.row;
}

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
/// others by the start of their sort keys; only rows that are alike so far are compared as texts.
class TextSort
{
public:
    explicit TextSort(const ColumnTexts &texts) : mTexts(texts) {}

    std::vector<Row> sorted()
    {
        std::vector<Row> result;
        result.reserve(mTexts.count());
        Entries latin, others;
        latin.reserve(mTexts.count());
        for (Row row = 0; row < mTexts.count(); ++row) {
            if (Entry entry{0, row, 0}; mTexts[row].empty())
                result.push_back(row);
            else if (nextKey(entry))
                latin.push_back(entry);
            else
                others.push_back({mCollation.sortKeyStart(mTexts[row]), row, 0});
        }
        sortLatin(latin.data(), latin.data() + latin.size(), 0);
        sortOthers(others);
        merge(latin, others, result);
        return result;
    }

private:
    static constexpr int deepest = 64; // runs of texts alike for longer are compared as they are

    bool nextKey(Entry &entry) const
    {
        const auto rest = mTexts[entry.row].substr(entry.used);
        std::size_t used = 0;
        const bool latin = mCollation.sortPrefix(rest, entry.key, used);
        entry.used += std::uint32_t(used);
        return latin;
    }

    bool before(Row a, Row b) const
    {
        const auto x = mTexts[a], y = mTexts[b];
        const int order = x == y ? 0 : mCollation.compare(x, y);
        return order != 0 ? order < 0 : a < b;
    }

    void sortAsTexts(Entry *from, Entry *to) const
    {
        std::sort(from, to,
                  [this](const Entry &a, const Entry &b) { return before(a.row, b.row); });
    }

    /// Calls a function for each run of two or more entries with one key.
    template <typename Function> static void forRuns(Entry *from, Entry *to, Function function)
    {
        while (from < to) {
            Entry *end = from + 1;
            while (end < to && end->key == from->key)
                ++end;
            if (end - from > 1)
                function(from, end);
            from = end;
        }
    }

    void sortLatin(Entry *from, Entry *to, int depth) const
    {
        std::sort(from, to, byKey);
        forRuns(from, to, [&](Entry *a, Entry *b) { refine(a, b, depth + 1); });
    }

    void refine(Entry *from, Entry *to, int depth) const
    {
        const auto first = mTexts[from->row];
        if (std::all_of(from + 1, to, [&](const Entry &e) { return mTexts[e.row] == first; }))
            return; // sorted by row already
        const bool ended = (from->key & 0xFF) == 0;
        if (!ended && depth < deepest &&
            std::all_of(from, to, [this](Entry &entry) { return nextKey(entry); }))
            sortLatin(from, to, depth);
        else
            sortAsTexts(from, to);
    }

    void sortOthers(Entries &others) const
    {
        std::sort(others.begin(), others.end(), byKey);
        forRuns(others.data(), others.data() + others.size(),
                [this](Entry *from, Entry *to) { sortAsTexts(from, to); });
    }

    /// Looks for the place of each of the others in growing steps: there are mostly few of them.
    void merge(const Entries &latin, const Entries &others, std::vector<Row> &result) const
    {
        const auto less = [this](const Entry &a, const Entry &b) { return before(a.row, b.row); };
        auto at = latin.begin();
        const auto takeTo = [&](Entries::const_iterator end) {
            for (; at != end; ++at)
                result.push_back(at->row);
        };
        for (const Entry &other : others) {
            std::ptrdiff_t step = 1;
            while (step < latin.end() - at && less(at[step], other))
                step *= 2;
            takeTo(std::lower_bound(at, at + std::min(step, latin.end() - at), other, less));
            result.push_back(other.row);
        }
        takeTo(latin.end());
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
            numbers.push_back({sortableNumber(texts.integer(row)), row, 0});
        } else if (const auto text = texts[row]; text.empty()) {
            result.push_back(row);
        } else if (const auto value = wholeNumber(text)) {
            numbers.push_back({sortableNumber(*value), row, 0});
        } else {
            return {};
        }
    }
    std::sort(numbers.begin(), numbers.end(), byKey);
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
