#include "fuzz/fuzz.h"

#include <algorithm>
#include <cstring>
#include <random>

namespace fuzz
{

namespace
{

std::vector<Target *> &registry()
{
    static std::vector<Target *> all;
    return all;
}

using Random = std::mt19937;

// Pieces on which readers of text and of numbers stumble.
const char *const pieces[] = {
    "'",    "''",   "\"",   ";",        "--",       "/*", "(",  ")",      ",",
    "|",    "%",    "_",    "\\",       "*",        "\n", "\r", "\r\n",   "\xEF\xBB\xBF",
    "\xC3", "\xA9", "\xFF", "\xCC\x81", "\xF0\x9F", "0",  "-1", "1e10",   "99999999999",
    "{",    "}",    "[",    "]",        ":",        "?",  " ",  "values", "order by 1",
    "\0"};

QByteArray anyPiece(Random &random)
{
    const char *piece = pieces[random() % std::size(pieces)];
    return *piece ? QByteArray(piece) : QByteArray(1, 0);
}

void changeOnce(QByteArray &s, const Target &target, Random &random)
{
    const auto place = [&] { return qsizetype(random() % std::size_t(s.size() + 1)); };
    const auto at = place(), length = qsizetype(random() % 8);
    switch (random() % 7) {
    case 0:
        s.insert(at, anyPiece(random));
        break;
    case 1:
        s.insert(at, char(random()));
        break;
    case 2:
        s.remove(at, length);
        break;
    case 3:
        s.replace(at, length, anyPiece(random));
        break;
    case 4: // a piece of its own, once more
        s.insert(at, s.mid(place(), qsizetype(random() % 40)));
        break;
    case 5: { // the end of another one
        const QByteArray &other = target.seeds[random() % target.seeds.size()];
        s = s.left(at) + other.mid(qsizetype(random() % std::size_t(other.size() + 1)));
        break;
    }
    default:
        if (at < s.size())
            s[at] = char(s[at] ^ (1 << random() % 8));
    }
}

} // namespace

Target::Target(const char *n, Seeds s, Function f) : name(n), makeSeeds(s), run(f)
{
    registry().push_back(this);
}

std::vector<Target *> targets()
{
    auto all = registry();
    for (Target *target : all)
        target->seeds = target->makeSeeds();
    std::sort(all.begin(), all.end(),
              [](const Target *a, const Target *b) { return std::strcmp(a->name, b->name) < 0; });
    return all;
}

QByteArray inputOf(const Target &target, unsigned number)
{
    QByteArray input = target.seeds[number % target.seeds.size()];
    if (number < target.seeds.size())
        return input; // the good ones first
    Random random(number);
    for (auto changes = 1 + random() % 6; changes > 0; --changes)
        changeOnce(input, target, random);
    return input;
}

} // namespace fuzz
