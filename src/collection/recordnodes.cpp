#include "collection/recordnodes.h"

#include "shell/services/globals.h"

namespace recordnodes
{

namespace
{

QString selectArtists(const QString &letter)
{
    return QStringLiteral(" select art.id as ID, art.naam as Artiest from artiesten as art"
                          " where art.naam like '") +
           letter + QStringLiteral("%' order by art.naam ");
}

const auto selectArtistsWithDigit =
    QStringLiteral(" select art.id as ID, art.naam as Artiest from artiesten as art"
                   " where iif(isnumeric(left(art.naam,1)),1,0)=1 order by art.naam ");

QString selectTracks(const QString &artistId)
{
    return QStringLiteral("select id as ID, Titel as Titel from Tracks where Artiest_ID = ") +
           artistId + QStringLiteral(" order by Titel");
}

QString selectDiscs(const QString &trackId)
{
    return QStringLiteral("select cds.id as ID, cdt.Titel as Titel, cds.diskno as Diskno, "
                          "cds.trackno as Trackno from CDtitels cdt, CompactDiscs cds "
                          "where cdt.id = cds.cdtitels_id and cds.Track_ID = ") +
           trackId + QStringLiteral(" order by Titel");
}

QString selectTitle(const QString &linkId)
{
    return QStringLiteral("SELECT cdt.cd_type as type, cdt.id as ID FROM CDtitels cdt, "
                          "CompactDiscs cds WHERE cds.CDTitels_id = cdt.id AND cds.id = ") +
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
    return {row->Fields(u"ID").Value().toLong(), type.compare(u"V", Qt::CaseInsensitive) == 0};
}

} // namespace recordnodes
