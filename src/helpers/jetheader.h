#pragma once

#include <cstddef>
#include <string>

namespace jet
{

/// What becomes of a file; the exit code of songcase-jet.
enum class Result : int {
    Read = 0,
    Usage = 2,
    NotOpened = 3,
    NotAFile = 4, // a folder, a device
    NotADatabase = 5,
    NewerFormat = 6, // of the generations behind Jet 4
    Protected = 7,   // by a password, or encrypted
    CutOff = 8,
    Damaged = 9,
    OwnFormat = 10, // a catalogue that needs no reading by others
    TooLong = 11,   // a text beyond what a catalogue takes
};

/// What the first page of a database says of it.
struct Header {
    int generation = 4; // of Jet: 3 or 4
    std::size_t pageSize = 4096;
    int codePage = 1252;   // of the texts of Jet 3
    std::size_t pages = 0; // whole ones, in the file
};

/// Looks at a file before the library does, which takes much for a database. No file is waited for.
Result readHeader(const std::string &file, Header &header);

} // namespace jet
