#include "mp3/matchtags.h"

#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace
{

QString selectTracks(qint64 cdId, qint64 discNo)
{
    return " select art.naam as LeadArtist, "
           "      trk.titel as Title, "
           "      cds.trackno as TrackPosition, "
           "      cdt.titel as Album, "
           "      trk.genre as Genre, "
           "      trk.hitjaar as HitYear "
           " from   artiesten art, "
           "        tracks    trk,  "
           "        compactdiscs cds, "
           "        cdtitels cdt "
           " where  art.id = trk.artiest_id "
           " and    trk.id = cds.track_id "
           " and    cdt.id = cds.cdtitels_id "
           " and    cds.cdtitels_id = "_L1 +
           QString::number(cdId) + " and    cds.diskno = "_L1 + QString::number(discNo) +
           " order by 3"_L1;
}

QString selectTrack(qint64 cdId, qint64 discNo, qint64 trackNo)
{
    return " select art.naam as LeadArtist, trk.titel as Title, cds.trackno as TrackPosition, "
           "cdt.titel as Album, trk.genre as Genre, trk.hitjaar as HitYear from artiesten art, "
           "tracks trk, compactdiscs cds, cdtitels cdt where art.id = trk.artiest_id and trk.id = "
           "cds.track_id and cdt.id = cds.cdtitels_id and cds.cdtitels_id = "_L1 +
           QString::number(cdId) + " and cds.diskno = "_L1 + QString::number(discNo) +
           " and cds.trackno = "_L1 + QString::number(trackNo) + " order by 3"_L1;
}

QString selectMaxPart(qint64 cdId)
{
    return "select max(diskno) as MaxPart from compactdiscs where cdtitels_id = "_L1 +
           QString::number(cdId);
}

QString known(ADODB::Recordset &rows, QStringView field)
{
    const ADODB::Value value = rows.Fields(field).Value();
    return value.isNull() ? u"?"_s : value.toText();
}

// Of how many discs; "2/3".
QString partOfSet(qint64 cdId, qint64 discNo)
{
    ADODB::Recordset rows;
    rows.Open(selectMaxPart(cdId), *gConnection);
    return QString::number(discNo) + u'/' + rows.Fields(u"MaxPart").Value().toText();
}

CddbID3Tag tagOf(ADODB::Recordset &rows, const QString &part)
{
    CddbID3Tag tag;
    tag.setAlbum(known(rows, u"Album"));
    tag.setLeadArtist(known(rows, u"LeadArtist"));
    tag.setTitle(known(rows, u"Title"));
    tag.setTrackPosition(known(rows, u"TrackPosition"));
    tag.setPartOfSet(part);
    tag.setYear(known(rows, u"HitYear"));
    tag.setGenre(known(rows, u"Genre"));
    return tag;
}

} // namespace

std::vector<CddbID3Tag> tagsOfDisc(qint64 cdId, qint64 discNo)
{
    ADODB::Recordset rows;
    rows.Open(selectTracks(cdId, discNo), *gConnection);
    const QString part = partOfSet(cdId, discNo);
    std::vector<CddbID3Tag> tags;
    for (; !rows.isEOF(); rows.MoveNext())
        tags.push_back(tagOf(rows, part));
    return tags;
}

CddbID3Tag tagOfTrack(qint64 cdId, qint64 discNo, qint64 trackNo)
{
    ADODB::Recordset rows;
    rows.Open(selectTrack(cdId, discNo, trackNo), *gConnection);
    rows.MoveFirst();
    return tagOf(rows, partOfSet(cdId, discNo));
}
