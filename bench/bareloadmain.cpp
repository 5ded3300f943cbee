#include "bareload.h"
#include "catalogue/cataloguefile.h"

#include <QFile>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>

// bare-load CATALOGUE A|B|C|D FILE [nocase] [nosync]: the yardstick as a whole program. A catalogue
// that is not there is made, with SQLite's NOCASE if told. "nosync" does not wait for the disk.
int main(int argc, char **argv)
try {
    if (argc < 4)
        return 2;
    const auto told = [&](const char *word) {
        for (int i = 4; i < argc; ++i) {
            if (std::strcmp(argv[i], word) == 0)
                return true;
        }
        return false;
    };
    const std::string catalogue = argv[1];
    if (!QFile::exists(QString::fromStdString(catalogue))) {
        if (told("nocase"))
            createNocaseCatalogue(catalogue);
        else
            cataloguefile::create(QString::fromStdString(catalogue));
    }
    std::ifstream file(argv[3], std::ios::binary);
    const std::string bytes(std::istreambuf_iterator<char>(file), {});
    RawDatabase database(catalogue);
    database.exec(told("nosync") ? "pragma synchronous=off" : "pragma synchronous=full");
    const char format = *argv[2];
    const auto counts =
        loadBare(database, parseBare(format, bytes), format == 'B' || format == 'D');
    std::printf("titles=%d links=%d artists=%d tracks=%d\n", counts.titles, counts.links,
                counts.artists, counts.tracks);
    return 0;
} catch (const std::exception &error) {
    std::fprintf(stderr, "%s\n", error.what());
    return 1;
}
