#pragma once

#include "platform/ado/rows.h"

#include <cstdint>
#include <vector>

namespace ADODB
{

enum class Repeats { Kept, Dropped };

/// The numbers of all rows in the order that "order by" these columns gives: NULLs, numbers, then
/// texts in the program's order of texts; rows that are alike in all of them stay as they are, or
/// all but the first of them are dropped.
std::vector<std::uint32_t> rowOrder(const Rows &rows, const std::vector<int> &columns,
                                    Repeats repeats = Repeats::Kept);

} // namespace ADODB
