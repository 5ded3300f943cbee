#pragma once

#include <array>
#include <cstddef>
#include <string_view>
#include <vector>

/// A column that the catalogue takes over.
struct OldColumn {
    enum Kind { Number, Text };
    enum Missing { Never, Allowed, IsEmptyText }; // what NULL means there

    const char *name;
    Kind kind = Number;
    Missing missing = Never;
};

/// A table of an old catalogue, and what becomes of it.
struct OldTable {
    static constexpr std::size_t mostColumns = 6;

    const char *name;
    const char *count;  // statement for the old catalogue
    const char *found;  // what the log says behind the number
    const char *rows;   // statement for the old catalogue
    const char *insert; // statement for the new one, with a "?" for each column
    const char *done;   // what the log says behind the percentage
    std::vector<OldColumn> columns;
    bool ofMP3 = false; // which the first generation did not have
};

/// In the order in which they are counted and copied: what others point at comes first.
const std::array<OldTable, 6> &oldTables();
