#pragma once

#include <QStringList>

namespace ADODB
{

class Connection;

/// The columns of a table as the engine takes them, in their order: name, type, collation, and what
/// makes it a key. Two tables for which this is the same take the same rows and give them alike.
/// Throws Error, also if there is no such table.
QStringList columnsOf(Connection &connection, const QByteArray &table);

} // namespace ADODB
