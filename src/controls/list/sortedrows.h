#pragma once

#include "platform/ado/rows.h"

#include <QHash>
#include <cstdint>
#include <vector>

/// Texts of one column that stand in the place of the rows' own, by row.
using WrittenTexts = QHash<int, QString>;

/// The numbers of all rows, ascending by a column; rows with equal texts keep their order. Empty
/// cells and NULLs come first. If all others are whole numbers, or texts of such, their values
/// decide, otherwise all texts by the program's order of texts.
std::vector<std::uint32_t> sortedRows(const ADODB::Rows &rows, int column,
                                      const WrittenTexts &written = {});
