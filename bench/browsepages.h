#pragma once

#include <QtGlobal>
#include <memory>
#include <vector>

namespace ADODB
{
class Rows;
}

/// The pages of the collection browser as they are after a load.
struct BrowsePages {
    std::shared_ptr<const ADODB::Rows> compilations, albums, collections;
    std::vector<qsizetype> compilationOrder, albumOrder, collectionOrder; // rows, as shown
    long long tracks = 0;
};

/// Reads and sorts all pages from gConnection, as the browser does at its load and at each refresh.
BrowsePages loadBrowsePages();

/// The rows in the order of a text column, ascending, equal ones as they stand.
std::vector<qsizetype> sortedBy(const ADODB::Rows &rows, int column);
