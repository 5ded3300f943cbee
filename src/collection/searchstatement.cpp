#include "collection/searchstatement.h"

#include "catalogue/quoting.h"
#include "platform/text/textrules.h"

using namespace Qt::StringLiterals;

namespace
{

const auto selectTracks = u" select art.naam  as artiest, "
                          "trk.titel as titel, "
                          "vcd.diskno as disk, "
                          "vcd.trackno as track, "
                          "cdt.titel  as verzamelcd, "
                          "trk.genre   as genre, "
                          "trk.hitjaar as hitjaar, "
                          "iif(cdt.cd_type='V','Compilation','Album') as type "
                          "from artiesten    as art, "
                          "tracks       as trk, "
                          "cdtitels     as cdt, "
                          "compactdiscs as vcd "
                          "where trk.artiest_id = art.id "
                          "and   cdt.id         = vcd.cdtitels_id "
                          "and   trk.id         = vcd.track_id "_s;

QString pattern(const QString &text, SearchKey::Mode mode)
{
    const bool openStart = mode == SearchKey::PartWord || mode == SearchKey::EndWord;
    const bool openEnd = mode == SearchKey::PartWord || mode == SearchKey::BeginWord;
    return QLatin1String(openStart ? "'%" : "'") + doubled(text) +
           QLatin1String(openEnd ? "%'" : "'");
}

QString like(const char *column, const QString &text, SearchKey::Mode mode)
{
    if (text.isEmpty())
        return {};
    return " and "_L1 + QLatin1String(column) + " like "_L1 + pattern(text, mode);
}

// By design: the last year alone is that one year too, not all up to it.
QString years(const QString &first, const QString &last)
{
    if (!first.isEmpty() && !last.isEmpty())
        return " and trk.hitjaar between "_L1 + first + " and "_L1 + last;
    if (first.isEmpty() && last.isEmpty())
        return {};
    return " and trk.hitjaar = "_L1 + (first.isEmpty() ? last : first);
}

} // namespace

bool isSearchYear(const QString &text)
{
    return text.size() == 4 && text::isNumeric(text) && text.trimmed().toDouble() >= 1900;
}

QString searchStatement(const SearchKey &key)
{
    return selectTracks + like("art.naam", key.artist, key.mode) +
           like("trk.titel", key.title, key.mode) + like("trk.genre", key.genre, key.mode) +
           years(key.firstYear, key.lastYear) + " order by 1,2,5,3,4 "_L1;
}
