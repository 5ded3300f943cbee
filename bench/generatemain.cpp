#include "generate.h"

#include <cstdio>
#include <cstring>
#include <exception>
#include <map>
#include <stdexcept>

namespace
{

const char usage[] =
    "songcase-generate catalogue FILE [--discs N] [--tracks-per-disc N] [--orphans SHARE]\n"
    "                                 [--mp3-collections N] [--seed N]\n"
    "songcase-generate text A|B|C|D FILE [--tracks N] [--seed N]\n";

using Options = std::map<std::string, std::string>;

Options optionsFrom(int argc, char **argv, int first)
{
    Options options;
    for (int i = first; i < argc; i += 2) {
        if (i + 1 >= argc || std::strncmp(argv[i], "--", 2) != 0)
            throw std::invalid_argument(argv[i]);
        options[argv[i] + 2] = argv[i + 1];
    }
    return options;
}

// Takes the option out, so that those that nobody knows are left over.
double take(Options &options, const char *name, double otherwise)
{
    const auto found = options.extract(name);
    return found ? std::stod(found.mapped()) : otherwise;
}

void allTaken(const Options &options)
{
    if (!options.empty())
        throw std::invalid_argument("--" + options.begin()->first);
}

void catalogue(const char *file, Options options)
{
    CataloguePlan plan;
    plan.discs = int(take(options, "discs", plan.discs));
    plan.tracksPerDisc = int(take(options, "tracks-per-disc", plan.tracksPerDisc));
    plan.orphans = take(options, "orphans", 0);
    plan.mp3Collections = int(take(options, "mp3-collections", plan.discs / 20));
    plan.seed = std::uint64_t(take(options, "seed", 1));
    allTaken(options);
    const auto counts = generateCatalogue(file, plan);
    std::printf("discs=%d titles=%d links=%d tracks=%d artists=%d\n", counts.discs, counts.titles,
                counts.links, counts.tracks, counts.artists);
}

void text(char format, const char *file, Options options)
{
    const int tracks = int(take(options, "tracks", 100'000));
    const auto seed = std::uint64_t(take(options, "seed", 2));
    allTaken(options);
    generateText(format, file, tracks, seed);
}

} // namespace

int main(int argc, char **argv)
try {
    const std::string what = argc > 2 ? argv[1] : "";
    if (what == "catalogue")
        catalogue(argv[2], optionsFrom(argc, argv, 3));
    else if (what == "text" && argc > 3 && std::strlen(argv[2]) == 1 &&
             std::strchr("ABCD", *argv[2]))
        text(*argv[2], argv[3], optionsFrom(argc, argv, 4));
    else
        throw std::invalid_argument("usage");
    return 0;
} catch (const std::invalid_argument &wrong) {
    std::fprintf(stderr, "%s\n%s", wrong.what(), usage);
    return 2;
} catch (const std::exception &error) {
    std::fprintf(stderr, "%s\n", error.what());
    return 1;
}
