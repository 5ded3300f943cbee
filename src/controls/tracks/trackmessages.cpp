#include "controls/tracks/trackmessages.h"

#include "catalogue/hityear.h"
#include "services/messages.h"

#include <algorithm>

using namespace Qt::StringLiterals;

QString TrackMessages::message(const char *key) const
{
    return GetMessage(QLatin1String(key), mLanguage);
}

auto TrackMessages::refusalOf(const TrackToSave &track) const -> std::optional<Refusal>
{
    const bool noArtist = mWithArtist && track.texts[ArtistField].isEmpty();
    const bool noTitle = track.texts[TitleField].isEmpty();
    const QString &year = track.texts[YearField];
    if (!track.changed)
        return {};
    if (noArtist && noTitle)
        return Refusal{0, ArtistField, message("xNoTrackArtistAndTitle")};
    if (noArtist)
        return Refusal{0, ArtistField, message("xNoTrackArtist")};
    if (noTitle)
        return Refusal{0, TitleField, message("xNoTrackTitle")};
    if (!year.isEmpty() && year != track.was[YearField] && !isHitYear(year))
        return Refusal{0, YearField, message("MsgInvalidYear")};
    return {};
}

auto TrackMessages::refusal(const QList<TrackToSave> &tracks) const -> std::optional<Refusal>
{
    for (qsizetype i = 0; i < tracks.size(); ++i) {
        auto found = refusalOf(tracks[i]);
        if (!found)
            continue;
        found->track = i;
        found->text.prepend(message("Track") + u' ' + QString::number(i + 1) + ": "_L1);
        return found;
    }
    return {};
}

QString TrackMessages::kept(const QList<TrackToSave> &tracks,
                            const TrackStore::Outcome &outcome) const
{
    QStringList paragraphs{paragraph("xKeptValues", tracks, outcome.keptValues),
                           paragraph("xKeptArtists", tracks, outcome.keptArtists)};
    paragraphs.removeAll(QString());
    return paragraphs.join("\r\r"_L1);
}

// A box holds only so many lines.
QString TrackMessages::paragraph(const char *key, const QList<TrackToSave> &tracks,
                                 const QList<qsizetype> &which) const
{
    constexpr qsizetype listed = 20;
    if (which.isEmpty())
        return {};
    QString lines = message(key);
    for (const qsizetype i : which.first(std::min(which.size(), listed))) {
        lines += u'\r' + QString::number(i + 1) + ". "_L1;
        if (mWithArtist)
            lines += tracks[i].texts[ArtistField] + " - "_L1;
        lines += tracks[i].texts[TitleField];
    }
    if (which.size() > listed)
        lines += "\r... (+ "_L1 + QString::number(which.size() - listed) + u')';
    return lines;
}
