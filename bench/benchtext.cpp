#include "bareload.h"
#include "cases.h"
#include "chooseimport.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "shell/startup.h"
#include "textimport/catalogueload.h"
#include "textimport/filereading.h"

#include <fstream>
#include <iterator>

namespace
{

void readInto(char format)
{
    chooseImport(format, QString::fromStdString(benchdata::text(format)));
    FileReading().run();
}

void readText(benchmark::State &state, char format)
{
    startup::openCatalogue(QString::fromStdString(benchdata::emptyCatalogue()), false);
    for (auto _ : state)
        readInto(format);
    state.SetItemsProcessed(state.iterations() * gImportRecords->RecordCount());
    gConnection.reset();
}

// The load alone, into a fresh copy of a catalogue each time. The rows are read again for each,
// since they carry the ids that were free.
void loadText(benchmark::State &state, char format, const std::string &catalogue)
{
    for (auto _ : state) {
        state.PauseTiming();
        startup::openCatalogue(QString::fromStdString(benchdata::scratchCopy(catalogue)), false);
        readInto(format);
        CatalogueLoad load;
        load.ask = [](const QString &) { return vbYes; };
        state.ResumeTiming();
        load.run();
        state.PauseTiming();
        gConnection.reset();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * gImportRecords->RecordCount());
}

void loadBareText(benchmark::State &state, char format, const std::string &catalogue)
{
    std::ifstream file(benchdata::text(format), std::ios::binary);
    const std::string bytes(std::istreambuf_iterator<char>(file), {});
    const auto tracks = parseBare(format, bytes);
    for (auto _ : state) {
        state.PauseTiming();
        RawDatabase database(benchdata::scratchCopy(catalogue));
        database.exec("pragma synchronous=full; pragma cache_size=-16000");
        state.ResumeTiming();
        loadBare(database, tracks, format == 'B' || format == 'D');
    }
    state.SetItemsProcessed(state.iterations() * qsizetype(tracks.size()));
}

void registerLoads(const std::string &into, const std::string &catalogue, char format)
{
    const std::string what = std::string("/") + format + " into " + into;
    benchmark::RegisterBenchmark(("load" + what).c_str(), loadText, format, catalogue)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark(("bare load" + what).c_str(), loadBareText, format, catalogue)
        ->Unit(benchmark::kMillisecond);
}

} // namespace

void registerTextCases()
{
    for (const char format : {'A', 'B', 'C', 'D'}) {
        benchmark::RegisterBenchmark((std::string("read/") + format).c_str(), readText, format)
            ->Unit(benchmark::kMillisecond);
        registerLoads("empty", benchdata::emptyCatalogue(), format);
    }
    benchmark::RegisterBenchmark("bare load/A into empty, NOCASE", loadBareText, 'A',
                                 benchdata::emptyCatalogue(true))
        ->Unit(benchmark::kMillisecond);
    for (const auto &scale : benchdata::scales())
        registerLoads(scale.name, benchdata::catalogue(scale), 'A');
}
