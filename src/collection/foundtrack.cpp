#include "collection/foundtrack.h"

#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "platform/text/textrules.h"
#include "shell/services/globals.h"

namespace
{

const auto selectRecords =
    QStringLiteral("select cdt.id as ID from artiesten as art, tracks as trk,"
                   " cdtitels as cdt, compactdiscs as vcd where trk.artiest_id = art.id"
                   " and cdt.id = vcd.cdtitels_id and trk.id = vcd.track_id");

QString isText(const char *column, const QString &text)
{
    const QLatin1String name(column);
    if (text.isEmpty())
        return QLatin1String(" and (") + name + QLatin1String(" is null or ") + name +
               QLatin1String(" = '')");
    return QLatin1String(" and ") + name + QLatin1String(" = ") + quoted(text);
}

// A number, or what an older catalogue may have in its place.
QString number(const QString &text)
{
    return text::isNumeric(text) ? numberOrNull(text) : quoted(text);
}

QString isNumber(const char *column, const QString &text)
{
    if (text.isEmpty())
        return isText(column, text);
    return QLatin1String(" and ") + QLatin1String(column) + QLatin1String(" = ") + number(text);
}

// The tracks of the disc before this one; their numbers may have gaps, and those without one come
// first.
QString countTracksBefore(qint64 id, const FoundTrack &track)
{
    return QStringLiteral(
               "select count(*) as N from compactdiscs as vcd where vcd.cdtitels_id = ") +
           QString::number(id) + isNumber("vcd.diskno", track.disc) +
           QLatin1String(" and (vcd.trackno is null or vcd.trackno < ") + number(track.track) +
           QLatin1Char(')');
}

QString selectRecord(const FoundTrack &track)
{
    return selectRecords + isText("art.naam", track.artist) + isText("trk.titel", track.title) +
           isText("cdt.titel", track.cdTitle) + isNumber("vcd.diskno", track.disc) +
           isNumber("vcd.trackno", track.track) +
           isText("iif(cdt.cd_type='V','Compilation','Album')", track.type) +
           QLatin1String(" order by cdt.id");
}

} // namespace

FoundRecord findRecord(const FoundTrack &track)
{
    auto records = gConnection->firstRows(selectRecord(track), 1);
    if (records.isEOF())
        return {};
    const qint64 id = records.Fields(u"ID").Value().toLong();
    const bool isCompilation = track.type == QLatin1String("Compilation");
    if (track.track.isEmpty())
        return {id, isCompilation, 1};
    auto before = gConnection->Execute(countTracksBefore(id, track));
    return {id, isCompilation, int(before.Fields(u"N").Value().toLong()) + 1};
}
