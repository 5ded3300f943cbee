#pragma once

#include "helpers/jetheader.h"

#include <string>
#include <vector>

/// The parts of songcase-jet, the small program that reads databases of the older program with
/// libmdb: a process of its own with limits, since the library crashes on damaged files, or never
/// comes to an end. It opens the file for reading only.
///
/// It prints lines: for each of the wanted tables that is there "table NAME ROWS" with the number
/// of rows that the file states, a "column NAME" for each column that holds texts or numbers, and a
/// line "=CELL<TAB>CELL..." for each row; "end" behind all of them. A cell is NULL ("\N"), a
/// number, or a text in UTF-8 behind a quote, with "\\", "\t", "\n" and "\r" for what would break a
/// line. Names of tables are compared without regard to case and printed as they were wanted.
namespace jet
{

Result printTables(const std::string &file, const std::vector<std::string> &wanted);

} // namespace jet
