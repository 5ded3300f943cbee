#pragma once

#include <QByteArray>
#include <initializer_list>
#include <memory>
#include <vector>

namespace ADODB
{

class Connection;

/// The ids of the rows that the statements of a connection delete while this object lives, and the
/// question whether a table still names one of them. The answer comes from the rows themselves: a
/// delete finds out through an index that nothing points at a row, and an index can be damaged
/// without the engine taking notice. One of these at a time watches a connection.
class DeletedRows
{
public:
    explicit DeletedRows(Connection &connection);
    ~DeletedRows();
    DeletedRows(const DeletedRows &) = delete;
    DeletedRows &operator=(const DeletedRows &) = delete;

    /// A column that holds ids of another table.
    struct Pointer {
        const char *column;
        const char *to;
    };

    /// Reads the table from its first row to its last, unless nothing was deleted that it could
    /// name. Throws Error.
    bool stillNamedIn(const char *table, std::initializer_list<Pointer> pointers) const;

private:
    class Ids;
    struct Watch;

    bool anyIn(const QByteArray &query, const std::vector<const Ids *> &wanted) const;

    Connection &mConnection;
    std::unique_ptr<Watch> mWatch;
};

} // namespace ADODB
