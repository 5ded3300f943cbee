#pragma once

#include "platform/ado/rows.h"

#include <cstdint>
#include <vector>

namespace ADODB
{

/// A column to sort by, and by what its texts are: the program's order of texts, or their bytes.
struct OrderColumn {
    int column;
    bool byBytes = false;
};

enum class Repeats { Kept, Dropped };

/// The numbers of all rows in the order that "order by" these columns gives: NULLs, numbers, then
/// texts; rows that are alike in all of them stay as they are, or
/// all but the first of them are dropped.
std::vector<std::uint32_t> rowOrder(const Rows &rows, const std::vector<OrderColumn> &columns,
                                    Repeats repeats = Repeats::Kept);

} // namespace ADODB
