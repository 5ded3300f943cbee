#include "names.h"

#include <unordered_set>

namespace
{

// The words of titles, frequent ones first. No two of them are equal when case is left out.
const std::vector<const char *> titleWords = {
    "Love",       "You",          "Me",        "The",         "Night",       "My",
    "Heart",      "Time",         "In",        "Maan",        "Don't",       "Of",
    "Blue",       "Day",          "Baby",      "Always",      "Liefde",      "A",
    "Rain",       "Home",         "Café",      "Away",        "Girl",        "World",
    "Dance",      "Summer",       "Sun",       "Één",         "Road",        "Dream",
    "Nacht",      "Fire",         "Never",     "Mañana",      "Rose",        "Sweet",
    "Morning",    "Dag",          "River",     "Amour",       "Été",         "Eyes",
    "Moon",       "Stay",         "Light",     "Zee",         "Golden",      "Mädchen",
    "Little",     "Good",         "Bye",       "Lonely",      "Sky",         "Hé",
    "Boy",        "Crazy",        "Corazón",   "Wind",        "Slow",        "Train",
    "Leven",      "Street",       "Noche",     "Angel",       "Runaway",     "Für",
    "Shadow",     "Ijs",          "Forever",   "Voilà",       "Silver",      "Jealous",
    "Nooit",      "Winter",       "Señora",    "Kiss",        "Tears",       "Ring",
    "Mother",     "Straatje",     "Déjà",      "Stone",       "Wild",        "Water",
    "Zomer",      "Blind",        "Belle",     "Übermorgen",  "Falling",     "Star",
    "Ocean",      "Vuur",         "Memory",    "Canción",     "Back",        "Radio",
    "Fever",      "Lied",         "Window",    "Sunday",      "Männer",      "Ticket",
    "City",       "Paradise",     "Huis",      "Garden",      "Touch",       "Sorry",
    "Niño",       "Thunder",      "Velvet",    "Bird",        "Ballad",      "Hoera",
    "Thing",      "Garçon",       "Mirror",    "Power",       "Bridge",      "Weer",
    "Secret",     "Holiday",      "Sœur",      "Harbour",     "Diamond",     "Regen",
    "Temptation", "Voor",         "Hunger",    "Jamás",       "Midnight",    "Doctor",
    "Highway",    "Stil",         "Feather",   "Lady",        "Île",         "Chain",
    "Rhythm",     "Toekomst",     "Candle",    "Whisper",     "Åland",       "Mercy",
    "Carnival",   "Fiets",        "Wonder",    "Tango",       "Castle",      "Frère",
    "Ginger",     "Hurricane",    "Vogel",     "Comet",       "Parade",      "Smørrebrød",
    "Puppet",     "Lantern",      "Tweede",    "Marble",      "Orange",      "Fiancé",
    "Pilot",      "Gipsy",        "Duif",      "Sparrow",     "Engine",      "Ángel",
    "Satellite",  "Tiger",        "Zolder",    "Magnet",      "Anchor",      "Jalapeño",
    "Empire",     "Ribbon",       "Kermis",    "Meadow",      "Saddle",      "Über",
    "Lemon",      "Postcard",     "Gracht",    "Copper",      "Signal",      "Piñata",
    "Traveller",  "Vertigo",      "Molen",     "Orchard",     "Whistle",     "Señorita",
    "Harlequin",  "Umbrella",     "Tulp",      "Avalanche",   "Cinema",      "Łódź",
    "Notebook",   "Cobalt",       "Schaatsen", "Jukebox",     "Alchemist",   "Fjäril",
    "Monsoon",    "Quarrel",      "Klompen",   "Pavilion",    "Tornado",     "Čaj",
    "Horizon",    "Yesteryear",   "Vlieger",   "Caravan",     "Quicksilver", "Ősz",
    "Labyrinth",  "Zeppelin",     "Dijk",      "Nightingale", "Rendezvous",  "Žena",
    "Obelisk",    "Kaleidoscope",
};

const std::vector<const char *> firstNames = {
    "John",  "Anna",   "Peter", "Maria",    "Jan",     "Lisa",   "Tom",       "Édith", "Kees",
    "Sarah", "Bob",    "Sofie", "André",    "Michael", "Joan",   "Willem",    "Zoë",   "Frank",
    "Carla", "José",   "Ruud",  "Nina",     "Björn",   "Eddy",   "Françoise", "Henk",  "Julia",
    "Marco", "Renée",  "Otis",  "Trijntje", "Günter",  "Dolly",  "Rob",       "Chloé", "Stan",
    "Ilse",  "Jürgen", "Betty", "Hugo",     "Mónica",  "Ray",    "Wim",       "Agnès", "Curtis",
    "Loïs",  "Gerard", "Søren", "Patsy",    "Dirk",    "Céline", "Angus",     "Femke", "Raúl",
    "Dinah", "Piet",   "Åse",   "Leroy",    "Saskia",  "Václav", "Mavis",     "Joost", "Zsófia",
};

const std::vector<const char *> lastNames = {
    "Smith",   "de Vries",  "Brown",    "Jansen",   "Williams", "Dubois",    "Jones",
    "Bakker",  "Müller",    "Davis",    "Visser",   "García",   "Miller",    "Smit",
    "Lefèvre", "Wilson",    "Meijer",   "Taylor",   "Schröder", "Mulder",    "Moore",
    "Piñeiro", "Bos",       "White",    "Vos",      "Nuñez",    "Harris",    "Peters",
    "Sjöberg", "Clark",     "Hendriks", "Bélanger", "Lewis",    "Dekker",    "Walker",
    "Brouwer", "Hall",      "D'Angelo", "Ibáñez",   "Young",    "Dijkstra",  "King",
    "Wright",  "Lindström", "Scott",    "Kok",      "O'Brien",  "Green",     "Jacobs",
    "Baker",   "Strauß",    "Haan",     "Adams",    "Nielsen",  "Vermeulen", "Hill",
    "Çelik",   "Campbell",  "Schouten", "Mitchell", "Novák",    "Roberts",   "Willems",
    "Carter",  "Hoekstra",  "Phillips", "Gauthier", "Evans",    "Koster",    "Kovács",
    "Turner",  "Prins",     "Parker",   "Blom",     "Edwards",  "Huisman",   "Østergaard",
    "Collins", "Peeters",   "Stewart",
};

const std::vector<const char *> bandNouns = {
    "Stars",    "Shadows",     "Brothers",   "Pirates",    "Dreamers",  "Machine", "Orchestra",
    "Sisters",  "Tigers",      "Project",    "Boys",       "Royals",    "Engines", "Fantômes",
    "Ramblers", "Queens",      "Motions",    "Experience", "Lovers",    "Wolves",  "Cadillacs",
    "Kapel",    "Gitanos",     "Sparks",     "Voices",     "Mariñeros", "Band",    "Foxes",
    "Hunters",  "Überflieger", "Connection", "Trio",
};

const std::vector<const char *> genreWords = {
    "Pop",        "Rock",           "Soul",   "Dance", "Blues",    "Jazz",        "Nederlandstalig",
    "Country",    "Disco",          "Reggae", "Metal", "Klassiek", "Chanson",     "Folk",
    "Hip Hop",    "Rhythm & Blues", "Punk",   "Latin", "Gospel",   "Rock & Roll", "Schlager",
    "Soundtrack", "New Wave",       "Música",
};

template <typename List> const char *anyOf(const List &list, Random &random)
{
    return list[std::size_t(random.between(0, int(list.size()) - 1))];
}

bool isAccented(const std::string &word)
{
    return std::any_of(word.begin(), word.end(), [](char c) { return c & 0x80; });
}

} // namespace

Names::Names(std::uint64_t seed)
    : random(seed),
      mWords(titleWords),
      mGenres(genreWords),
      mWordPlaces(mWords.size(), 4, 0.8),
      mGenrePlaces(mGenres.size(), 0, 1.0)
{
}

void Names::useOnly(bool accented)
{
    std::erase_if(mWords, [=](const char *word) { return isAccented(word) != accented; });
    mWordPlaces = Zipf(mWords.size(), 4, 0.8);
}

std::string Names::title()
{
    std::string title;
    for (int words = random.between(2, 5); words > 0; --words) {
        if (!title.empty())
            title += ' ';
        title += mWords[mWordPlaces.pick(random)];
    }
    return title;
}

std::string Names::artist()
{
    const std::string noun = anyOf(bandNouns, random);
    const std::string word = anyOf(titleWords, random);
    switch (random.between(0, 9)) {
    case 0:
    case 1:
        return "The " + word + ' ' + noun;
    case 2:
        return word + ' ' + anyOf(titleWords, random);
    case 3:
        return std::string(anyOf(firstNames, random)) + " & The " + noun;
    default:
        return std::string(anyOf(firstNames, random)) + ' ' + anyOf(lastNames, random);
    }
}

std::vector<std::string> Names::artists(std::size_t count)
{
    std::vector<std::string> artists;
    std::unordered_set<std::string> known;
    while (artists.size() < count) {
        std::string name = artist();
        for (int tries = 0; known.count(name); ++tries)
            name = tries < 2 ? artist() : name + ' ' + anyOf(lastNames, random);
        known.insert(name);
        artists.push_back(std::move(name));
    }
    return artists;
}
