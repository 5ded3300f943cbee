#include "browsepages.h"
#include "catalogue/cataloguefile.h"
#include "catalogue/cleanorphans.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/ado/recordset.h"
#include "workcommands.h"

namespace
{

void open(const QString &file)
{
    measured("open", [&] {
        openForWork(file);
        return std::string();
    });
}

} // namespace

void newCatalogue(const QStringList &arguments)
{
    measured("new", [&] {
        cataloguefile::create(arguments[0]);
        return std::string();
    });
}

void browse(const QStringList &arguments)
{
    open(arguments[0]);
    measured("browse", [] {
        const BrowsePages pages = loadBrowsePages();
        return count("compilations", pages.compilations.rows->rowCount()) +
               count("albums", pages.albums.rows->rowCount()) +
               count("collections", pages.collections.rows->rowCount());
    });
}

void removeOrphans(const QStringList &arguments)
{
    open(arguments[0]);
    measured("orphans", [] {
        CleanOrphans();
        return std::string();
    });
}
