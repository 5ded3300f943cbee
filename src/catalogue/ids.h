#pragma once

#include <QtGlobal>

namespace ADODB
{
class Connection;
}

/// The tables whose ids the program gives.
enum class Table { Artiesten, Tracks, CDTitels, CompactDiscs };

/// The id for a new row: the highest of the table and one more, 1 for an empty table. Ids of rows
/// deleted at the top of a table are given again: nothing may keep an id across a delete. Throws
/// Error.
qint64 nextId(Table table); // on gConnection
qint64 nextId(Table table, ADODB::Connection &connection);
