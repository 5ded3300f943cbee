#include "browsepages.h"

#include "collection/browserlists.h"

namespace
{

// All lists are sorted by their first column that shows.
BrowsePage page(const ADODB::RecordsetPtr &records)
{
    const auto rows = records->rows();
    return {rows, sortedRows(*rows, 1)};
}

} // namespace

BrowsePages loadBrowsePages()
{
    BrowsePages pages;
    pages.compilations = page(browserlists::compilations());
    pages.albums = page(browserlists::albums());
    pages.collections = page(browserlists::mp3Collections());
    return pages;
}
