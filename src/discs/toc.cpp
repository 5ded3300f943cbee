#include "discs/toc.h"

#include <cmath>

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

// Whole frames are those of the disc, and the rounding of milliseconds goes. Other lengths, as
// those of most MP3 files, are true but for a part of a frame: rounded one by one they would add up
// to another disc.
std::optional<TableOfContents> tocOfLengths(const std::vector<int> &milliseconds)
{
    constexpr double rounding = 0.08; // frames, a millisecond
    TableOfContents toc;
    double at = firstFrame;
    for (const int length : milliseconds) {
        toc.tracks.push_back({int(std::lround(at))});
        const double frames = std::max(length, 0) * framesPerSecond / double(millisecondsPerSecond);
        const double whole = std::round(frames);
        at += std::abs(frames - whole) < rounding ? whole : frames;
        if (at > mostFrames)
            return std::nullopt;
    }
    toc.leadOut = int(std::lround(at));
    return toc.isValid() ? std::optional(toc) : std::nullopt;
}
