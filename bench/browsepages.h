#pragma once

#include "controls/list/sortedrows.h"

#include <memory>

/// A list of the collection browser: its rows, and their order on the screen.
struct BrowsePage {
    std::shared_ptr<const ADODB::Rows> rows;
    std::vector<std::uint32_t> order;
};

/// What a load of the browser brings in.
struct BrowsePages {
    BrowsePage compilations, albums, collections;
};

/// Reads and sorts all pages from gConnection, as the browser does when it is loaded and at each
/// refresh; what is left out is the drawing.
BrowsePages loadBrowsePages();
