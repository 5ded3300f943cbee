#include "collection/foundtrack.h"

#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "platform/text/textrules.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace
{

const auto selectRecords = u"select cdt.id as ID from artiesten as art, tracks as trk,"
                           " cdtitels as cdt, compactdiscs as vcd where trk.artiest_id = art.id"
                           " and cdt.id = vcd.cdtitels_id and trk.id = vcd.track_id"_s;

QString isText(const char *column, const QString &text)
{
    const QLatin1String name(column);
    if (text.isEmpty())
        return " and ("_L1 + name + " is null or "_L1 + name + " = '')"_L1;
    return " and "_L1 + name + " = "_L1 + quoted(text);
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
    return " and "_L1 + QLatin1String(column) + " = "_L1 + number(text);
}

// The tracks of the disc before this one; their numbers may have gaps, and those without one come
// first.
QString countTracksBefore(qint64 id, const FoundTrack &track)
{
    return u"select count(*) as N from compactdiscs as vcd where vcd.cdtitels_id = "_s +
           QString::number(id) + isNumber("vcd.diskno", track.disc) +
           " and (vcd.trackno is null or vcd.trackno < "_L1 + number(track.track) + u')';
}

QString selectRecord(const FoundTrack &track)
{
    return selectRecords + isText("art.naam", track.artist) + isText("trk.titel", track.title) +
           isText("cdt.titel", track.cdTitle) + isNumber("vcd.diskno", track.disc) +
           isNumber("vcd.trackno", track.track) +
           isText("iif(cdt.cd_type='V','Compilation','Album')", track.type) + " order by cdt.id"_L1;
}

} // namespace

FoundRecord findRecord(const FoundTrack &track)
{
    auto records = gConnection->firstRows(selectRecord(track), 1);
    if (records.isEOF())
        return {};
    const qint64 id = records.Fields(u"ID").Value().toLong();
    const bool isCompilation = track.type == "Compilation"_L1;
    if (track.track.isEmpty())
        return {id, isCompilation, 1};
    auto before = gConnection->Execute(countTracksBefore(id, track));
    return {id, isCompilation, int(before.Fields(u"N").Value().toLong()) + 1};
}
