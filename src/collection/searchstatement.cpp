#include "collection/searchstatement.h"

#include "catalogue/quoting.h"
#include "platform/text/textrules.h"

namespace
{

const auto selectTracks = QStringLiteral(" select art.naam  as artiest, "
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
                                         "and   trk.id         = vcd.track_id ");

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
    return QLatin1String(" and ") + QLatin1String(column) + QLatin1String(" like ") +
           pattern(text, mode);
}

// By design: the last year alone is that one year too, not all up to it.
QString years(const QString &first, const QString &last)
{
    if (!first.isEmpty() && !last.isEmpty())
        return QLatin1String(" and trk.hitjaar between ") + first + QLatin1String(" and ") + last;
    if (first.isEmpty() && last.isEmpty())
        return {};
    return QLatin1String(" and trk.hitjaar = ") + (first.isEmpty() ? last : first);
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
           years(key.firstYear, key.lastYear) + QLatin1String(" order by 1,2,5,3,4 ");
}
