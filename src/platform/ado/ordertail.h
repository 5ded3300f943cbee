#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace ADODB
{

/// The "order by 1,2" at the end of a select statement, if it names columns of the result by their
/// numbers alone, all ascending. None of a select made of several: its order and its "distinct" are
/// not those of one.
struct OrderTail {
    std::size_t from = 0;     // where it begins in the statement
    std::vector<int> columns; // from 0; empty: the statement has no such end
};

OrderTail orderTail(std::string_view sql);

} // namespace ADODB
