#pragma once

#include "rawdatabase.h"

#include <string_view>
#include <vector>

// The least that a load of a text file into a catalogue can do: each row finds or creates its
// artist and track by prepared statements, in one transaction. The yardstick of the program's load.

/// A track as its file has it, pointing into the bytes of the file. Missing fields are empty.
struct BareTrack {
    std::string_view artist = {}, title = {}, genre = {}, year = {}, mainTitle = {};
    int disc = 1, number = 1;
    bool newTitle = false; // the first track of a CD
};

struct BareCounts {
    int titles = 0, links = 0, artists = 0, tracks = 0; // rows inserted
};

/// The tracks of a file of format 'A' to 'D'. The file is believed: no checks, nothing changed.
std::vector<BareTrack> parseBare(char format, std::string_view bytes);

/// Finds or creates everything, albums or compilations by the flag.
BareCounts loadBare(RawDatabase &database, const std::vector<BareTrack> &tracks, bool albums);

/// Makes an empty catalogue whose texts are compared by SQLite's own NOCASE (ASCII only) instead of
/// the program's collation; all else is the same.
void createNocaseCatalogue(const std::string &file);
