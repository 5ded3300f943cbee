#pragma once

#include <QString>
#include <optional>
#include <vector>

/// A track in a table of contents. Offsets are frames, 1/75 s, counted from the start of the disc:
/// block address + 150.
struct TocTrack {
    int offset = 0;
    bool isData = false;
    bool operator==(const TocTrack &) const = default;
};

/// The table of contents of an audio disc, data tracks included.
struct TableOfContents {
    std::vector<TocTrack> tracks; // 1 to 99 in a valid one
    int first = 1;                // number of the first track
    int leadOut = 0;              // frames, counted as the offsets

    /// Whether a disc can have it: 1 to 99 tracks, one of sound among them, offsets that rise, the
    /// lead-out behind them and at most 100 minutes from the start.
    bool isValid() const;

    /// Length of the disc in whole seconds, the first two included.
    int seconds() const;

    /// Playing time of each track in milliseconds.
    std::vector<int> lengths() const;

    bool operator==(const TableOfContents &) const = default;
};

constexpr int framesPerSecond = 75;
constexpr int firstFrame = 150; // the two seconds before block 0

/// The frames that a sound of this length in milliseconds takes: a started one counts, the rounding
/// of the last millisecond does not.
int framesOfSound(qint64 milliseconds);

/// The disc that files of these playing times (milliseconds) would make, one behind the other;
/// nothing where no disc can have it.
std::optional<TableOfContents> tocOfLengths(const std::vector<int> &milliseconds);
