#include "bareload.h"
#include "catalogue/cataloguefile.h"

#include <QFile>
#include <cstdio>
#include <cstring>
#include <fstream>
#include <iterator>

// bare-load CATALOGUE A|B|C|D FILE [nocase] [PRAGMA=VALUE...]: the yardstick as a whole program. A
// catalogue that is not there is made, with SQLite's NOCASE if told so.
int main(int argc, char **argv)
try {
    if (argc < 4)
        return 2;
    const std::string catalogue = argv[1];
    const char format = *argv[2];
    const bool nocase = argc > 4 && std::strcmp(argv[4], "nocase") == 0;
    if (!QFile::exists(QString::fromStdString(catalogue))) {
        if (nocase)
            createNocaseCatalogue(catalogue);
        else
            cataloguefile::create(QString::fromStdString(catalogue));
    }
    std::ifstream file(argv[3], std::ios::binary);
    const std::string bytes(std::istreambuf_iterator<char>(file), {});
    RawDatabase database(catalogue);
    database.exec("pragma synchronous=full; pragma cache_size=-16000");
    for (int i = nocase ? 5 : 4; i < argc; ++i)
        database.exec(std::string("pragma ") + argv[i]);
    const auto counts =
        loadBare(database, parseBare(format, bytes), format == 'B' || format == 'D');
    std::printf("titles=%d links=%d artists=%d tracks=%d\n", counts.titles, counts.links,
                counts.artists, counts.tracks);
    return 0;
} catch (const std::exception &error) {
    std::fprintf(stderr, "%s\n", error.what());
    return 1;
}
