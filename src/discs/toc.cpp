#include "discs/toc.h"

#include <algorithm>

namespace
{

constexpr int mostTracks = 99;
constexpr int mostFrames = 100 * 60 * framesPerSecond;
constexpr int millisecondsPerSecond = 1000;

} // namespace

bool TableOfContents::isValid() const
{
    if (tracks.empty() || first < 1 || first + int(tracks.size()) - 1 > mostTracks)
        return false;
    int before = 0;
    for (const TocTrack &track : tracks) {
        if (track.offset <= before)
            return false;
        before = track.offset;
    }
    return leadOut > before && leadOut <= mostFrames &&
           !std::ranges::all_of(tracks, &TocTrack::isData);
}

int TableOfContents::seconds() const
{
    return leadOut / framesPerSecond;
}

std::vector<int> TableOfContents::lengths() const
{
    std::vector<int> all;
    for (size_t i = 0; i < tracks.size(); ++i) {
        const int end = i + 1 < tracks.size() ? tracks[i + 1].offset : leadOut;
        all.push_back((end - tracks[i].offset) * millisecondsPerSecond / framesPerSecond);
    }
    return all;
}

int framesOfSound(qint64 milliseconds)
{
    constexpr int rounding = framesPerSecond / 2 + 1; // half a millisecond
    return int((milliseconds * framesPerSecond + millisecondsPerSecond - 1 - rounding) /
               millisecondsPerSecond);
}

std::optional<TableOfContents> tocOfLengths(const std::vector<int> &milliseconds)
{
    TableOfContents toc;
    toc.leadOut = firstFrame;
    for (const int length : milliseconds) {
        toc.tracks.push_back({toc.leadOut});
        toc.leadOut += framesOfSound(std::max(length, 0));
        if (toc.leadOut > mostFrames)
            return std::nullopt;
    }
    return toc.isValid() ? std::optional(toc) : std::nullopt;
}
