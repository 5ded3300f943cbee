#include "conversion/cataloguecopy.h"

#include "conversion/olderrors.h"
#include "platform/ado/command.h"
#include "platform/ado/recordset.h"

#include <numeric>

using namespace Qt::StringLiterals;

namespace
{

using Values = std::array<ADODB::Parameter, OldTable::mostColumns>;
using Kind = ADODB::Rows::Kind;

// The rows of a table with what is wanted of each column.
class Source
{
public:
    Source(const OldTable &table, const ADODB::Recordset &recordset)
        : mTable(table), mRows(recordset.rows())
    {
        for (const OldColumn &column : table.columns)
            mColumns.push_back(recordset.columnOf(QString::fromLatin1(column.name)));
    }

    qsizetype count() const { return mRows->rowCount(); }
    Values values(qsizetype row) const;

    /// "Tracks, ID 12", or, where it has none, "Tracks, #3".
    QString place(qsizetype row) const
    {
        const QString id = mRows->text(row, mColumns[0]);
        return QLatin1String(mTable.name) +
               (id.isEmpty() ? u", #"_s + QString::number(row + 1) : u", ID "_s + id);
    }

private:
    ADODB::Parameter value(qsizetype row, std::size_t i) const;
    ADODB::Parameter number(qsizetype row, int column) const;

    const OldTable &mTable;
    std::shared_ptr<const ADODB::Rows> mRows;
    std::vector<int> mColumns;
};

Values Source::values(qsizetype row) const
{
    Values all = {nullptr, nullptr, nullptr, nullptr, nullptr, nullptr};
    for (std::size_t i = 0; i < mColumns.size(); ++i)
        all[i] = value(row, i);
    return all;
}

ADODB::Parameter Source::value(qsizetype row, std::size_t i) const
{
    const OldColumn &column = mTable.columns[i];
    const int at = mColumns[i];
    const Kind kind = mRows->kind(row, at);
    if (kind == Kind::Null && column.missing == OldColumn::Allowed)
        return nullptr;
    if (kind == Kind::Null && column.missing == OldColumn::IsEmptyText)
        return std::string_view();
    const bool isNumber = column.kind == OldColumn::Number;
    try {
        if (kind != Kind::Null && isNumber)
            return number(row, at);
    } catch (const Error &) {
        throw oldDatabaseError("xOldValue", place(row) + u", "_s + QLatin1String(column.name));
    }
    if (kind != Kind::Text)
        throw oldDatabaseError("xOldValue", place(row) + u", "_s + QLatin1String(column.name));
    return mRows->utf8(row, at);
}

ADODB::Parameter Source::number(qsizetype row, int column) const
{
    if (mRows->kind(row, column) == Kind::Integer)
        return mRows->integer(row, column);
    return mRows->value(row, column).toLong();
}

} // namespace

CatalogueCopy::CatalogueCopy(ADODB::Connection &from, ADODB::Connection &to, bool withMP3)
    : mFrom(from), mTo(to), mWithMP3(withMP3)
{
}

bool CatalogueCopy::count()
{
    const auto &tables = oldTables();
    for (std::size_t i = 0; i < tables.size(); ++i) {
        if (!isWanted(tables[i]))
            continue;
        if (!mayGoOn())
            return false;
        auto answer = mFrom.Execute(QString::fromLatin1(tables[i].count));
        mCounts[i] = answer.Fields(u"Aantal").Value().toLong();
        counted(tables[i], mCounts[i]);
    }
    return true;
}

qint64 CatalogueCopy::total() const
{
    return std::accumulate(mCounts.begin(), mCounts.end(), qint64(0));
}

bool CatalogueCopy::copy()
{
    const auto &tables = oldTables();
    for (std::size_t i = 0; i < tables.size(); ++i) {
        if (mCounts[i] == 0)
            continue;
        if (!copyTable(tables[i], mCounts[i]))
            return false;
        tableCopied();
    }
    return true;
}

bool CatalogueCopy::copyTable(const OldTable &table, qint64 rows)
{
    const Source source(table, mFrom.Execute(QString::fromLatin1(table.rows)));
    ADODB::Command insert(mTo, table.insert);
    for (qsizetype row = 0; row < source.count(); ++row) {
        if (!mayGoOn())
            return false;
        const Values values = source.values(row);
        try {
            insert.Execute(std::span(values).first(table.columns.size()));
        } catch (const Error &error) {
            if (error.Number != errConstraint)
                throw;
            throw oldDatabaseError("xOldTwice", source.place(row));
        }
        copied(table, row, rows);
    }
    return true;
}
