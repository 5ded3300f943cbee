#pragma once

struct sqlite3;

namespace ADODB
{

/// Name of the collation that the text columns of a catalogue are declared with.
inline constexpr char collationName[] = "SONGCASE";

/// Gives a database handle our collation and functions: LIKE, isnumeric(x), left(x, n). Gives a
/// result code of SQLite. Needs SQLite and ICU only: a loadable extension is made from the same
/// source.
int registerFunctions(sqlite3 *db);

} // namespace ADODB
