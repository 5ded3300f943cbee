#include "platform/ado/columns.h"

#include "platform/ado/connection.h"

#include <memory>
#include <sqlite3.h>

namespace ADODB
{

namespace
{

QString describe(sqlite3 *db, const QByteArray &table, const char *name)
{
    const char *type = nullptr, *collation = nullptr;
    int notNull = 0, key = 0, counts = 0;
    sqlite3_table_column_metadata(db, "main", table.constData(), name, &type, &collation, &notNull,
                                  &key, &counts);
    const QStringList parts = {QString::fromUtf8(name),  QLatin1String(type),
                               QLatin1String(collation), QString::number(notNull),
                               QString::number(key),     QString::number(counts)};
    return parts.join(u' ').toLower();
}

} // namespace

QStringList columnsOf(Connection &connection, const QByteArray &table)
{
    connection.requireOpen();
    sqlite3_stmt *all = nullptr;
    const QByteArray query = "select * from main." + table;
    connection.check(sqlite3_prepare_v2(connection.handle(), query.constData(), -1, &all, nullptr));
    const std::unique_ptr<sqlite3_stmt, int (*)(sqlite3_stmt *)> release(all, sqlite3_finalize);
    QStringList columns;
    for (int i = 0; i < sqlite3_column_count(all); ++i)
        columns.append(describe(connection.handle(), table, sqlite3_column_name(all, i)));
    return columns;
}

} // namespace ADODB
