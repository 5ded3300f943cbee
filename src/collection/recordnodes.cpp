#include "collection/recordnodes.h"

#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace recordnodes
{

namespace
{

QString selectArtists(const QString &letter)
{
    return u" select art.id as ID, art.naam as Artiest from artiesten as art"
           " where art.naam like '"_s +
           letter + u"%' order by art.naam "_s;
}

const auto selectArtistsWithDigit =
    u" select art.id as ID, art.naam as Artiest from artiesten as art"
    " where iif(isnumeric(left(art.naam,1)),1,0)=1 order by art.naam "_s;

QString selectTracks(const QString &artistId)
{
    return u"select id as ID, Titel as Titel from Tracks where Artiest_ID = "_s + artistId +
           u" order by Titel"_s;
}

QString selectDiscs(const QString &trackId)
{
    return u"select cds.id as ID, cdt.Titel as Titel, cds.diskno as Diskno, "
           "cds.trackno as Trackno from CDtitels cdt, CompactDiscs cds "
           "where cdt.id = cds.cdtitels_id and cds.Track_ID = "_s +
           trackId + u" order by Titel"_s;
}

QString selectTitle(const QString &linkId)
{
    return u"SELECT cdt.cd_type as type, cdt.id as ID FROM CDtitels cdt, "
           "CompactDiscs cds WHERE cds.CDTitels_id = cdt.id AND cds.id = "_s +
           linkId;
}

ADODB::RecordsetPtr open(const QString &statement, ADODB::LockTypeEnum lock = ADODB::adLockReadOnly)
{
    auto rows = std::make_shared<ADODB::Recordset>();
    rows->Open(statement, *gConnection, ADODB::adOpenForwardOnly, lock);
    return rows;
}

} // namespace

ADODB::RecordsetPtr artists(const QString &letter)
{
    return open(selectArtists(letter));
}

ADODB::RecordsetPtr artistsWithDigit()
{
    return open(selectArtistsWithDigit);
}

ADODB::RecordsetPtr tracks(const QString &artistId)
{
    return open(selectTracks(artistId));
}

ADODB::RecordsetPtr discs(const QString &trackId)
{
    return open(selectDiscs(trackId));
}

Title titleOf(const QString &linkId)
{
    const auto row = open(selectTitle(linkId), ADODB::adLockOptimistic);
    if (row->isEOF())
        return {};
    const QString type = row->Fields(u"type").Value().toText();
    return {row->rows()->id(0, row->columnOf(u"ID")), type.compare(u"V", Qt::CaseInsensitive) == 0};
}

} // namespace recordnodes
