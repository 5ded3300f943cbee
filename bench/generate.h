#pragma once

#include <cstdint>
#include <string>

/// What a made-up catalogue is to hold. The same plan makes the same catalogue everywhere.
struct CataloguePlan {
    int discs = 3000;
    int tracksPerDisc = 15;   // the number of links is exactly discs times this
    double orphans = 0;       // further share of tracks, titles and artists nothing points at
    int mp3Collections = 150; // of twelve files each
    std::uint64_t seed = 1;
};

/// The two sizes that the program is held to: an owner's and one to stress it.
inline constexpr CataloguePlan ownerPlan;
inline constexpr CataloguePlan stressPlan{.discs = 100'000, .mp3Collections = 5000};

/// What a catalogue holds, orphans included.
struct CatalogueCounts {
    int discs = 0, titles = 0, links = 0, tracks = 0, artists = 0;
};

/// Writes a catalogue of compilations (three in ten), albums and box sets of both kinds; a quarter
/// of a compilation's tracks stand on another title too. The file must not be there yet. Throws
/// Error or std::runtime_error.
CatalogueCounts generateCatalogue(const std::string &file, const CataloguePlan &plan);

/// Writes a text file of discs with that many tracks in all, in UTF-8. Format 'A': compilations,
/// one field a row; 'B': albums, likewise; 'C' and 'D': the same with one track a row. Throws
/// std::runtime_error.
void generateText(char format, const std::string &file, int tracks, std::uint64_t seed = 2);
