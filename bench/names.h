#pragma once

#include "random.h"

#include <string>
#include <vector>

/// Made-up names of artists and titles, in UTF-8 and proper case, composed of word lists of our
/// own: short words often, rare ones seldom, about one name in six with an accented letter.
class Names
{
public:
    explicit Names(std::uint64_t seed);

    /// That many different names of artists, the first ones meant for the busiest.
    std::vector<std::string> artists(std::size_t count);

    /// Two to five words.
    std::string title();

    std::string genre() { return mGenres[mGenrePlaces.pick(random)]; }
    int year() { return 1955 + random.between(0, 45) + random.between(0, 20); }

    /// Only words with accented letters, or only plain ones, from here on.
    void useOnly(bool accented);

    Random random;

private:
    std::string artist();

    std::vector<const char *> mWords, mGenres;
    Zipf mWordPlaces, mGenrePlaces;
};
