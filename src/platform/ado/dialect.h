#pragma once

#include <QStringView>
#include <string>

namespace ADODB
{

/// A statement of the screens made fit for SQLite. Throws Error errSyntax.
///
/// What it mends: texts come to stand between single quotes, in NFC; the alias of a DELETE gets its
/// "as", left() is quoted, max(id+1) becomes max(id)+1 (which an index serves), of a SHAPE command
/// the statement in its braces is left, without repeats. Of a column LIKE a text it says that it
/// seldom holds, so that the engine begins a join with the table that is searched. What it refuses,
/// as the engine that the statements were written for did: a second statement, a comment, anything
/// behind the one row of VALUES, "||", parameters, numbers glued to words, commands that were not
/// in its language (PRAGMA, ATTACH, COMMIT).
std::string translated(QStringView statement);

} // namespace ADODB
