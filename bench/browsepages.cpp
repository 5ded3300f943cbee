#include "browsepages.h"

#include "platform/ado/recordset.h"
#include "platform/text/collation.h"
#include "shell/services/globals.h"

#include <QString>
#include <algorithm>

namespace
{

const auto selectCompilations =
    QStringLiteral(" select cdt.id as Id, cdt.titel as Titel from cdtitels as cdt where "
                   "cdt.cd_type='V' order by cdt.titel asc ");
const auto selectAlbums =
    QStringLiteral(" select cdt.id as Id, art.naam as Artiest, cdt.titel as Titel from cdtitels "
                   "as cdt, artiesten as art where cdt.cd_type='E' and cdt.artiest_id=art.id order "
                   "by cdt.titel asc ");
const auto selectCollections =
    QStringLiteral(" select mcs.id as Id, mcs.map as Map, mcs.album as Album from mp3collections "
                   "as mcs order by mcs.album asc ");
const auto countTracks = QStringLiteral("SELECT COUNT(*) AS AANTAL FROM TRACKS");

std::shared_ptr<const ADODB::Rows> read(const QString &statement)
{
    ADODB::Recordset records;
    records.Open(statement, *gConnection);
    return records.rows();
}

} // namespace

std::vector<qsizetype> sortedBy(const ADODB::Rows &rows, int column)
{
    struct Key {
        std::uint64_t prefix;
        bool exact;
        qsizetype row;
    };
    std::vector<Key> keys(std::size_t(rows.rowCount()));
    const auto &order = text::Collation::root();
    for (std::size_t i = 0; i < keys.size(); ++i) {
        keys[i].row = qsizetype(i);
        keys[i].exact = order.sortPrefix(rows.utf8(qsizetype(i), column), keys[i].prefix);
    }
    std::stable_sort(keys.begin(), keys.end(), [&](const Key &a, const Key &b) {
        if (a.exact && b.exact && a.prefix != b.prefix)
            return a.prefix < b.prefix;
        return order.compare(rows.utf8(a.row, column), rows.utf8(b.row, column)) < 0;
    });
    std::vector<qsizetype> sorted;
    for (const Key &key : keys)
        sorted.push_back(key.row);
    return sorted;
}

BrowsePages loadBrowsePages()
{
    BrowsePages pages;
    pages.compilations = read(selectCompilations);
    pages.compilationOrder = sortedBy(*pages.compilations, 1);
    pages.albums = read(selectAlbums);
    pages.albumOrder = sortedBy(*pages.albums, 1);
    pages.tracks = read(countTracks)->integer(0, 0);
    pages.collections = read(selectCollections);
    pages.collectionOrder = sortedBy(*pages.collections, 1);
    return pages;
}
