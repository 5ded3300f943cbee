#pragma once

#include <QString>

namespace ADODB
{
class Connection;
}

/// The id for a new row: the answer of one of the statements that ask a table for its highest id
/// and add one, 1 for an empty table. Ids of rows deleted at the top of a table are given again:
/// nothing may keep an id across a delete. Throws Error.
qint64 nextId(const QString &statement, QLatin1String field); // on gConnection
qint64 nextId(const QString &statement, QLatin1String field, ADODB::Connection &connection);
