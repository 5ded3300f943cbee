#include "mp3/importascdrows.h"

#include "platform/ado/value.h"

using namespace Qt::StringLiterals;

namespace
{

// A part that names no total is the only disc.
QString partOfSet(const CollectionRow &row)
{
    const QString part = row[CollectionField::PartOfSet].trimmed();
    return part.contains(u'/') ? part : u"1/1"_s;
}

// How many characters stand behind the separator.
qsizetype behindSeparator(const QString &part)
{
    return part.size() - part.indexOf(u'/') - 1;
}

qint64 totalOf(const QString &part)
{
    return ADODB::Value(part.last(behindSeparator(part))).toLong();
}

DiscOfRows::Track trackOf(const CollectionRow &row)
{
    DiscOfRows::Track track{row[CollectionField::LeadArtist], row[CollectionField::Title],
                            partOfSet(row), row[CollectionField::TrackYear],
                            row[CollectionField::Genre]};
    if (track.artist.isEmpty())
        throw RowRefused{row.index, true};
    if (track.title.isEmpty())
        throw RowRefused{row.index, false};
    return track;
}

} // namespace

// By design: only rows that follow each other are compared, and the texts as they are written.
DiscOfRows discOf(const std::vector<CollectionRow> &rows, const QString &collectionTitle)
{
    DiscOfRows disc;
    QString album; // of the row before
    qint64 total = 0;
    bool albumsDiffer = false;
    for (const CollectionRow &row : rows) {
        const bool isFirst = disc.tracks.empty();
        const QString &own = row[CollectionField::Album];
        const QString &ofRow = own.isEmpty() ? collectionTitle : own;
        albumsDiffer |= !isFirst && ofRow != album;
        album = ofRow;
        const auto &track = disc.tracks.emplace_back(trackOf(row));
        disc.isAlbum &= isFirst || track.artist == disc.artist;
        disc.artist = track.artist;
        const qint64 totalOfRow = totalOf(track.partOfSet);
        disc.isSet &= isFirst || totalOfRow == total;
        total = totalOfRow;
    }
    disc.title = albumsDiffer ? collectionTitle : album;
    return disc;
}

// By design: as many characters are taken from the left as stand behind the separator. That is
// right where both numbers have the same width; "1/12" gives "1/", which is no number.
qint64 discNumber(const QString &partOfSet)
{
    return ADODB::Value(partOfSet.first(behindSeparator(partOfSet))).toLong();
}
