#include "consoledesktop.h"
#include "measure.h"
#include "platform/ado/connection.h"
#include "platform/error/error.h"
#include "services/globals.h"
#include "workcommands.h"

#include <QApplication>
#include <algorithm>
#include <cstdio>
#include <memory>

namespace
{

struct Command {
    const char *name;
    const char *arguments;
    void (*run)(const QStringList &arguments);
};

constexpr Command commands[] = {
    {"new", "CATALOGUE", newCatalogue},
    {"browse", "CATALOGUE", browse},
    {"read", "A|B|C|D FILE", readText},
    {"load", "CATALOGUE A|B|C|D FILE", loadText},
    {"orphans", "CATALOGUE", removeOrphans},
    {"search", "CATALOGUE part|full|begin|end artist|title|genre|year|three WORD", search},
    {"export", "CATALOGUE FILE", exportAll},
    {"lookup", "TOC cddb+ADDRESS|musicbrainz+ADDRESS", lookUpDisc},
    {"importdisc", "CATALOGUE FILE", importDisc},
    {"tags", "FOLDER", readTags},
    {"collection", "CATALOGUE ID", openCollection},
    {"renamefiles", "CATALOGUE ID", renameCollection},
    {"savetag", "FILE FIELD VALUE", saveTag},
    {"addcollection", "CATALOGUE FOLDER TITLE", addCollection},
    {"convert", "CATALOGUE OLDFILE", convertOld},
};

int usage()
{
    for (const Command &command : commands)
        std::fprintf(stderr, "songcase-work %s %s\n", command.name, command.arguments);
    return 2;
}

const Command *find(const QStringList &words)
{
    for (const Command &command : commands) {
        const auto wanted = QString::fromLatin1(command.arguments).split(u' ').size();
        if (words.value(1) == QLatin1String(command.name) && words.size() == wanted + 2)
            return &command;
    }
    return nullptr;
}

// A command that is the long work of a screen needs one to be there, if out of sight.
std::unique_ptr<QCoreApplication> makeApplication(int &argc, char **argv)
{
    constexpr const char *ofScreens[] = {"lookup", "convert", "tags", "collection", "renamefiles"};
    const bool needsScreen =
        argc > 1 && std::any_of(std::begin(ofScreens), std::end(ofScreens),
                                [&](const char *name) { return qstrcmp(argv[1], name) == 0; });
    if (!needsScreen)
        return std::make_unique<QCoreApplication>(argc, argv);
    qputenv("QT_QPA_PLATFORM", "offscreen");
    return std::make_unique<QApplication>(argc, argv);
}

} // namespace

// songcase-work COMMAND ...: what the screens do, without a screen, for timing from outside. Ends
// with 1 if anything would have shown an error box.
int main(int argc, char **argv)
{
    const auto application = makeApplication(argc, argv);
    const QStringList words = QCoreApplication::arguments();
    const Command *command = find(words);
    if (!command)
        return usage();
    ConsoleDesktop desktop;
    try {
        command->run(words.sliced(2));
        gConnection.reset();
    } catch (const std::exception &error) {
        std::fprintf(stderr, "%s\n", error.what());
        return 1;
    }
    if (desktop.questions)
        std::printf("questions=%d, all answered with yes\n", desktop.questions);
    std::printf("peak_kib=%ld\n", peakMemory());
    return desktop.failed ? 1 : 0;
}
