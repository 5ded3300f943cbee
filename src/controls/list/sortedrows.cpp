#include "controls/list/sortedrows.h"

#include "platform/ado/textsort.h"

#include <algorithm>
#include <charconv>
#include <numeric>
#include <optional>
#include <string>
#include <string_view>

namespace
{

using Row = std::uint32_t;

using Entries = std::vector<ADODB::SortEntry>;

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
class ColumnTexts : public ADODB::RowTexts
{
public:
    ColumnTexts(const ADODB::Rows &rows, int column, const WrittenTexts &written)
        : mRows(rows), mColumn(column)
    {
        for (auto it = written.begin(); it != written.end(); ++it)
            mMade.insert(Row(it.key()), it.value().toStdString());
    }

    Row count() const { return Row(mRows.rowCount()); }

    std::string_view text(Row row) const override
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

/// The order by value; nothing if a text is no whole number.
std::optional<std::vector<Row>> byNumber(const ColumnTexts &texts)
{
    std::vector<Row> result;
    Entries numbers;
    for (Row row = 0; row < texts.count(); ++row) {
        if (texts.isInteger(row)) {
            numbers.push_back({sortableNumber(texts.integer(row)), nullptr, 0, 0, row});
        } else if (const auto text = texts.text(row); text.empty()) {
            result.push_back(row);
        } else if (const auto value = wholeNumber(text)) {
            numbers.push_back({sortableNumber(*value), nullptr, 0, 0, row});
        } else {
            return {};
        }
    }
    std::sort(numbers.begin(), numbers.end(), ADODB::ByKey());
    for (const auto &entry : numbers)
        result.push_back(entry.row);
    return result;
}

std::vector<Row> byText(const ColumnTexts &texts)
{
    std::vector<Row> result;
    result.reserve(texts.count());
    Entries entries;
    entries.reserve(texts.count());
    for (Row row = 0; row < texts.count(); ++row) {
        if (texts.text(row).empty())
            result.push_back(row);
        else
            entries.push_back({0, nullptr, 0, 0, row});
    }
    ADODB::TextSort(texts).sort(entries.data(), entries.data() + entries.size());
    for (const auto &entry : entries)
        result.push_back(entry.row);
    return result;
}

// A statement may have brought the rows in this order.
bool areSorted(const ColumnTexts &texts)
{
    const auto &collation = text::Collation::root();
    for (Row row = 1; row < texts.count(); ++row) {
        const auto before = texts.text(row - 1), text = texts.text(row);
        if (!before.empty() && (text.empty() || collation.compare(before, text) > 0))
            return false;
    }
    return true;
}

} // namespace

std::vector<std::uint32_t> sortedRows(const ADODB::Rows &rows, int column,
                                      const WrittenTexts &written)
{
    ColumnTexts texts(rows, column, written);
    if (auto order = byNumber(texts))
        return *std::move(order);
    texts.spellNumbers();
    if (!areSorted(texts))
        return byText(texts);
    std::vector<Row> asTheyAre(texts.count());
    std::iota(asTheyAre.begin(), asTheyAre.end(), 0);
    return asTheyAre;
}
