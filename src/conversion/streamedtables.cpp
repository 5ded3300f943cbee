#include "conversion/streamedtables.h"

#include "conversion/olderrors.h"
#include "platform/ado/recordset.h"
#include "platform/text/normalform.h"

#include <QLatin1String>
#include <algorithm>
#include <charconv>
#include <cmath>

using namespace Qt::StringLiterals;

namespace
{

constexpr int notWanted = -1;

bool sameName(std::string_view a, const char *b)
{
    return QLatin1String(a.data(), qsizetype(a.size()))
               .compare(QLatin1String(b), Qt::CaseInsensitive) == 0;
}

// The part before the sign; the rest stays.
std::string_view cutAt(std::string_view &rest, char sign)
{
    const auto at = std::min(rest.find(sign), rest.size());
    const auto part = rest.substr(0, at);
    rest.remove_prefix(std::min(at + 1, rest.size()));
    return part;
}

template <typename Number> std::optional<Number> numberIn(std::string_view digits)
{
    Number number = 0;
    const char *const end = digits.data() + digits.size();
    const auto read = std::from_chars(digits.data(), end, number);
    if (read.ec != std::errc() || read.ptr != end)
        return {};
    return number;
}

std::string unescaped(std::string_view cell)
{
    constexpr std::string_view letters("\\tnr"), signs("\\\t\n\r");
    std::string text;
    text.reserve(cell.size());
    for (std::size_t i = 0; i < cell.size(); ++i) {
        if (cell[i] != '\\') {
            text.push_back(cell[i]);
            continue;
        }
        const auto letter = ++i < cell.size() ? letters.find(cell[i]) : std::string_view::npos;
        if (letter == std::string_view::npos)
            throw oldDatabaseError("xOldDamaged");
        text.push_back(signs[letter]);
    }
    return text;
}

std::string join(const OldTable &table, const auto &part)
{
    std::string all;
    for (const OldColumn &column : table.columns)
        all += (all.empty() ? "" : ",") + part(column);
    return all;
}

// Texts have the program's own order, so that the statements that read them need none of theirs.
QByteArray creationOf(const OldTable &table)
{
    const auto declared = [](const OldColumn &column) {
        const char *type = column.kind == OldColumn::Text ? " text collate SONGCASE" : " numeric";
        return column.name + std::string(type);
    };
    return QByteArray("create table ") + table.name + '(' +
           QByteArray::fromStdString(join(table, declared)) + ')';
}

std::string insertInto(const OldTable &table)
{
    const auto place = [](const OldColumn &) { return std::string("?"); };
    return "insert into " + std::string(table.name) + " values (" + join(table, place) + ')';
}

} // namespace

StreamedTables::StreamedTables(ADODB::Connection &connection) : mConnection(connection)
{
    mTransaction.emplace(connection);
}

bool StreamedTables::has(const OldTable &table) const
{
    return std::find(mCame.begin(), mCame.end(), &table) != mCame.end();
}

void StreamedTables::take(std::string_view line)
{
    if (mEnded)
        throw oldDatabaseError("xOldDamaged");
    if (line.starts_with('=')) {
        takeRow(line.substr(1));
        return;
    }
    const auto word = cutAt(line, ' ');
    if (word == "table") {
        const auto name = cutAt(line, ' ');
        beginTable(name, line);
    } else if (word == "column") {
        addColumn(line);
    } else if (word == "end") {
        end();
    } else {
        throw oldDatabaseError("xOldDamaged");
    }
}

void StreamedTables::beginTable(std::string_view name, std::string_view rows)
{
    endTable();
    const auto &tables = oldTables();
    const auto table = std::find_if(tables.begin(), tables.end(),
                                    [&](const OldTable &t) { return name == t.name && !has(t); });
    const auto stated = numberIn<std::uint32_t>(rows);
    if (table == tables.end() || !stated)
        throw oldDatabaseError("xOldDamaged");
    mTable = &*table;
    mCame.push_back(mTable);
    mStated = *stated;
    mConnection.housekeeping(creationOf(*mTable).constData());
    mInsert = insertInto(*mTable);
    mCommand.emplace(mConnection, mInsert);
}

void StreamedTables::addColumn(std::string_view name)
{
    if (!mTable || mRows > 0)
        throw oldDatabaseError("xOldDamaged");
    const auto &columns = mTable->columns;
    const auto column = std::find_if(columns.begin(), columns.end(),
                                     [&](const OldColumn &c) { return sameName(name, c.name); });
    mPlaces.push_back(column == columns.end() ? notWanted : int(column - columns.begin()));
}

void StreamedTables::requireColumns() const
{
    for (std::size_t i = 0; i < mTable->columns.size(); ++i) {
        if (std::count(mPlaces.begin(), mPlaces.end(), int(i)) != 1)
            throw oldDatabaseError("xOldNoColumn", QLatin1String(mTable->name) + u'.' +
                                                       QLatin1String(mTable->columns[i].name));
    }
}

void StreamedTables::takeRow(std::string_view cells)
{
    if (!mTable || mRows >= mStated)
        throw oldDatabaseError("xOldDamaged");
    if (++mRows == 1)
        requireColumns();
    std::array<ADODB::Parameter, OldTable::mostColumns> values = {nullptr, nullptr, nullptr,
                                                                  nullptr, nullptr, nullptr};
    const auto separators = std::count(cells.begin(), cells.end(), '\t');
    if (std::size_t(separators) + 1 != mPlaces.size())
        throw oldDatabaseError("xOldDamaged");
    for (const int place : mPlaces) {
        const auto cell = cutAt(cells, '\t');
        if (place != notWanted)
            values[std::size_t(place)] = valueOf(cell, std::size_t(place));
    }
    mCommand->Execute(std::span(values).first(mTable->columns.size()));
}

ADODB::Parameter StreamedTables::valueOf(std::string_view cell, std::size_t place)
{
    if (cell == "\\N")
        return nullptr;
    if (cell.starts_with('\'')) {
        cell.remove_prefix(1);
        if (cell.find('\\') == std::string_view::npos)
            return cell;
        mTexts[place] = unescaped(cell);
        return std::string_view(mTexts[place]);
    }
    if (const auto whole = numberIn<qint64>(cell))
        return *whole;
    const auto fraction = numberIn<double>(cell);
    if (!fraction || !std::isfinite(*fraction))
        throw oldDatabaseError("xOldDamaged");
    return ADODB::Value(*fraction);
}

void StreamedTables::endTable()
{
    if (!mTable)
        return;
    requireColumns();
    if (mRows != mStated)
        throw oldDatabaseError("xOldDamaged");
    mCommand.reset();
    mTable = nullptr;
    mPlaces.clear();
    mRows = 0;
}

void StreamedTables::end()
{
    endTable();
    mTransaction->CommitTrans();
    mEnded = true;
}
