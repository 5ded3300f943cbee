#include "platform/ado/deletedrows.h"

#include "platform/ado/connection.h"

#include <algorithm>
#include <sqlite3.h>

namespace ADODB
{

/// Many ids, asked for once per row of a large table: a bit that several ids share answers nearly
/// all of the questions.
class DeletedRows::Ids
{
public:
    void add(sqlite3_int64 id)
    {
        mIds.push_back(id);
        mBits[place(id)] = true;
    }
    void sort() { std::sort(mIds.begin(), mIds.end()); }
    // The ids of one record lie close together: nearly all rows are out of the question at once.
    QByteArray range() const
    {
        return " between " + QByteArray::number(mIds.front()) + " and " +
               QByteArray::number(mIds.back());
    }
    bool contains(sqlite3_int64 id) const
    {
        return mBits[place(id)] && std::binary_search(mIds.begin(), mIds.end(), id);
    }

private:
    static constexpr std::size_t bits = 1 << 20;
    static std::size_t place(sqlite3_int64 id) { return std::size_t(id) % bits; }

    std::vector<sqlite3_int64> mIds;
    std::vector<bool> mBits = std::vector<bool>(bits);
};

struct DeletedRows::Watch {
    struct Table {
        QByteArray name;
        Ids ids;
    };
    std::vector<Table> tables;

    Table *find(const char *name)
    {
        const auto it = std::find_if(tables.begin(), tables.end(), [&](const Table &table) {
            return qstricmp(table.name.constData(), name) == 0;
        });
        return it == tables.end() ? nullptr : &*it;
    }

    static void onChange(void *watch, int what, const char *, const char *table, sqlite3_int64 id)
    {
        if (what != SQLITE_DELETE)
            return;
        auto *self = static_cast<Watch *>(watch);
        Table *known = self->find(table);
        if (!known)
            known = &self->tables.emplace_back(Table{table, {}});
        known->ids.add(id);
    }
};

DeletedRows::DeletedRows(Connection &connection)
    : mConnection(connection), mWatch(std::make_unique<Watch>())
{
    sqlite3_update_hook(connection.handle(), Watch::onChange, mWatch.get());
}

DeletedRows::~DeletedRows()
{
    if (sqlite3 *db = mConnection.handle())
        sqlite3_update_hook(db, nullptr, nullptr);
}

bool DeletedRows::stillNamedIn(const char *table, std::initializer_list<Pointer> pointers) const
{
    std::vector<const Ids *> wanted;
    QByteArray columns, where;
    for (const Pointer &pointer : pointers) {
        if (Watch::Table *target = mWatch->find(pointer.to)) {
            target->ids.sort();
            wanted.push_back(&target->ids);
            columns += (columns.isEmpty() ? "" : ",") + QByteArray(pointer.column);
            where +=
                (where.isEmpty() ? " where " : " or ") + (pointer.column + target->ids.range());
        }
    }
    return !wanted.empty() &&
           anyIn("select " + columns + " from " + table + " not indexed" + where, wanted);
}

bool DeletedRows::anyIn(const QByteArray &query, const std::vector<const Ids *> &wanted) const
{
    sqlite3_stmt *row = nullptr;
    mConnection.check(
        sqlite3_prepare_v2(mConnection.handle(), query.constData(), -1, &row, nullptr));
    const std::unique_ptr<sqlite3_stmt, int (*)(sqlite3_stmt *)> release(row, sqlite3_finalize);
    int code = sqlite3_step(row);
    for (; code == SQLITE_ROW; code = sqlite3_step(row)) {
        for (int i = 0; i < int(wanted.size()); ++i) {
            if (sqlite3_column_type(row, i) == SQLITE_INTEGER &&
                wanted[std::size_t(i)]->contains(sqlite3_column_int64(row, i)))
                return true;
        }
    }
    mConnection.check(code);
    return false;
}

} // namespace ADODB
