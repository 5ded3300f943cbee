#include "benchdata.h"

#include "bareload.h"
#include "catalogue/cataloguefile.h"

#include <QString>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <iterator>
#include <unistd.h>

namespace fs = std::filesystem;

namespace benchdata
{

namespace
{

bool gStressToo = false;

// To be counted up with each change of what the generators write.
const std::string generation = "1";

fs::path folder()
{
    const char *told = std::getenv("SONGCASE_BENCH_DATA");
    const fs::path folder = told ? fs::path(told) : fs::temp_directory_path() / "songcase-bench";
    fs::create_directories(folder);
    return folder;
}

// Names the generators and the schema: files of other ones are not taken.
std::string version()
{
    static const std::string version = [] {
        const fs::path empty = folder() / ("schema-" + std::to_string(getpid()));
        cataloguefile::create(QString::fromStdString(empty.string()));
        std::ifstream file(empty, std::ios::binary);
        const std::string bytes(std::istreambuf_iterator<char>(file), {});
        fs::remove(empty);
        return generation + '-' + std::to_string(std::hash<std::string>()(bytes));
    }();
    return version;
}

// Under another name until it is whole.
std::string made(const std::string &name, const std::function<void(const std::string &)> &make)
{
    const fs::path file = folder() / (version() + '-' + name);
    if (!fs::exists(file)) {
        const fs::path half = file.string() + ".half";
        fs::remove(half);
        make(half.string());
        fs::rename(half, file);
    }
    return file.string();
}

} // namespace

std::vector<Scale> scales()
{
    std::vector<Scale> scales{{"owner", ownerPlan}};
    if (gStressToo || std::getenv("SONGCASE_BENCH_STRESS"))
        scales.push_back({"stress", stressPlan});
    return scales;
}

void runStressToo()
{
    gStressToo = true;
}

std::string catalogue(const Scale &scale, double orphans)
{
    const std::string name = std::string(scale.name) + (orphans > 0 ? "-orphans.orv" : ".orv");
    return made(name, [&](const std::string &file) {
        CataloguePlan plan = scale.plan;
        plan.orphans = orphans;
        generateCatalogue(file, plan);
    });
}

std::string emptyCatalogue(bool nocase)
{
    return made(nocase ? "empty-nocase.orv" : "empty.orv", [=](const std::string &file) {
        if (nocase)
            createNocaseCatalogue(file);
        else
            cataloguefile::create(QString::fromStdString(file));
    });
}

std::string text(char format)
{
    return made(std::string("text-") + format + ".txt",
                [=](const std::string &file) { generateText(format, file, 100'000); });
}

std::string scratchCopy(const std::string &file)
{
    const fs::path copy = folder() / ("scratch-" + std::to_string(getpid()));
    fs::copy_file(file, copy, fs::copy_options::overwrite_existing);
    return copy.string();
}

} // namespace benchdata
