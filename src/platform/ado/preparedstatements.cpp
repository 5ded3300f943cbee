#include "platform/ado/preparedstatements.h"

#include "platform/ado/ordertail.h"
#include "platform/ado/sqlfunctions.h"

#include <QString>
#include <algorithm>
#include <optional>
#include <sqlite3.h>

namespace ADODB
{

namespace
{

constexpr std::size_t preparedAtMost = 200;

int prepareOne(sqlite3 *db, std::string_view sql, PreparedStatement &prepared)
{
    sqlite3_stmt *s = nullptr;
    const int code =
        sqlite3_prepare_v3(db, sql.data(), int(sql.size()), SQLITE_PREPARE_PERSISTENT, &s, nullptr);
    prepared.statement.reset(s);
    return code == SQLITE_OK && !s ? SQLITE_ERROR : code;
}

// How rows can be sorted by a column of the result without the engine; nothing if they cannot.
std::optional<OrderColumn> orderBy(sqlite3 *db, sqlite3_stmt *s, int column)
{
    const char *table = sqlite3_column_table_name(s, column);
    const char *origin = sqlite3_column_origin_name(s, column);
    const char *collation = nullptr;
    if (!table || !origin)
        return {}; // an expression
    if (sqlite3_table_column_metadata(db, sqlite3_column_database_name(s, column), table, origin,
                                      nullptr, &collation, nullptr, nullptr, nullptr) != SQLITE_OK)
        return {};
    const bool bytes = sqlite3_stricmp(collation, "BINARY") == 0;
    if (!bytes && sqlite3_stricmp(collation, collationName) != 0)
        return {};
    return OrderColumn{column, bytes};
}

bool coversAll(const std::vector<int> &columns, int count)
{
    for (int column = 0; column < count; ++column) {
        if (std::find(columns.begin(), columns.end(), column) == columns.end())
            return false;
    }
    return true;
}

// Prepares the statement without its order, if its rows can be sorted here.
bool prepareUnordered(sqlite3 *db, std::string_view sql, PreparedStatement &prepared)
{
    const auto tail = orderTail(sql);
    if (tail.columns.empty() || prepareOne(db, sql.substr(0, tail.from), prepared) != SQLITE_OK)
        return false;
    sqlite3_stmt *s = prepared.statement.get();
    std::vector<OrderColumn> order;
    for (const int column : tail.columns) {
        const auto found = column < sqlite3_column_count(s) ? orderBy(db, s, column) : std::nullopt;
        if (!found)
            return false;
        order.push_back(*found);
    }
    constexpr std::string_view distinct = "select distinct ";
    if (sql.starts_with(distinct) && coversAll(tail.columns, sqlite3_column_count(s))) {
        const auto all = sql.substr(distinct.size(), tail.from - distinct.size());
        if (prepareOne(db, "select " + std::string(all), prepared) != SQLITE_OK)
            return false;
        prepared.repeats = Repeats::Dropped;
    }
    prepared.order = std::move(order);
    return true;
}

} // namespace

void PreparedStatement::Finalize::operator()(sqlite3_stmt *s) const
{
    sqlite3_finalize(s);
}

int PreparedStatement::firstStep()
{
    sqlite3_stmt *s = statement.get();
    const int code = sqlite3_step(s);
    const int times = sqlite3_stmt_status(s, SQLITE_STMTSTATUS_REPREPARE, 0);
    if (times != timesPrepared) {
        timesPrepared = times;
        fields = fieldsOf(s);
    }
    return code;
}

Running::~Running()
{
    sqlite3_reset(mStatement);
    sqlite3_clear_bindings(mStatement);
}

std::shared_ptr<const FieldList> fieldsOf(sqlite3_stmt *statement)
{
    auto fields = std::make_shared<FieldList>();
    for (int i = 0; i < sqlite3_column_count(statement); ++i)
        fields->push_back({QString::fromUtf8(sqlite3_column_name(statement, i)), adVarWChar, 0});
    return fields;
}

std::shared_ptr<PreparedStatement> PreparedStatements::prepare(sqlite3 *db, const std::string &sql,
                                                               int &code)
{
    code = SQLITE_OK;
    if (const auto it = mStatements.find(sql); it != mStatements.end())
        return it->second;
    if (mStatements.size() >= preparedAtMost)
        mStatements.clear();
    const auto prepared = std::make_shared<PreparedStatement>();
    if (!prepareUnordered(db, sql, *prepared))
        code = prepareOne(db, sql, *prepared);
    if (code != SQLITE_OK)
        return nullptr;
    prepared->fields = fieldsOf(prepared->statement.get());
    prepared->readOnly = sqlite3_stmt_readonly(prepared->statement.get());
    return mStatements.emplace(sql, prepared).first->second;
}

} // namespace ADODB
