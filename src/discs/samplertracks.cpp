#include "discs/samplertracks.h"

#include "discs/candidates.h"

#include <QSet>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

std::vector<SplitTitle> splitAll(const std::vector<TrackRecord> &tracks, const QString &sign)
{
    std::vector<SplitTitle> all;
    for (const TrackRecord &track : tracks) {
        const SplitTitle split = splitTitle(track.title, sign);
        const bool isBoth = !split.artist.isEmpty() && !split.title.isEmpty();
        all.push_back(isBoth ? split : SplitTitle{{}, track.title, false});
    }
    return all;
}

qsizetype artistsIn(const std::vector<SplitTitle> &titles)
{
    QSet<QString> artists;
    for (const SplitTitle &title : titles) {
        if (title.isSplit)
            artists.insert(title.artist.toCaseFolded());
    }
    return artists.size();
}

// Nearly all titles have an artist in front, and most artists another one: the movements of a work
// have one text in front too.
bool lookLikeSampler(const std::vector<SplitTitle> &titles)
{
    constexpr qsizetype fewest = 3;
    const auto count = qsizetype(titles.size());
    const auto split = std::ranges::count_if(titles, &SplitTitle::isSplit);
    return count >= fewest && split * 10 >= count * 9 && artistsIn(titles) * 2 > count;
}

void takeArtists(DiscRecord &disc, const std::vector<SplitTitle> &titles)
{
    for (size_t i = 0; i < titles.size(); ++i) {
        disc.tracks[i].title = titles[i].title;
        disc.tracks[i].artist.name = titles[i].artist;
    }
}

} // namespace

SplitTitle splitTitle(const QString &text, const QString &sign)
{
    const auto at = text.indexOf(sign);
    if (at < 0)
        return {{}, text.trimmed(), false};
    return {text.left(at).trimmed(), text.mid(at + sign.size()).trimmed(), true};
}

void findCompilation(DiscRecord &disc)
{
    const bool isVarious = isVariousArtists(disc.artist.name);
    auto titles = splitAll(disc.tracks, u" / "_s);
    disc.isCompilation = isVarious || lookLikeSampler(titles);
    if (!disc.isCompilation) {
        for (TrackRecord &track : disc.tracks)
            track.artist = disc.artist;
        return;
    }
    if (std::ranges::none_of(titles, &SplitTitle::isSplit)) {
        auto byHyphen = splitAll(disc.tracks, u" - "_s);
        if (byHyphen.size() > 1 && std::ranges::all_of(byHyphen, &SplitTitle::isSplit))
            titles = std::move(byHyphen);
    }
    takeArtists(disc, titles);
}
