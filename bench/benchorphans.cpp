#include "cases.h"
#include "catalogue/cleanorphans.h"
#include "platform/ado/connection.h"
#include "rawdatabase.h"
#include "services/globals.h"
#include "shell/startup.h"

namespace
{

constexpr double orphanShare = 0.02;

void clean(benchmark::State &state, const std::string &catalogue)
{
    for (auto _ : state) {
        state.PauseTiming();
        startup::openCatalogue(QString::fromStdString(benchdata::scratchCopy(catalogue)), false);
        state.ResumeTiming();
        CleanOrphans();
        state.PauseTiming();
        gConnection.reset();
        state.ResumeTiming();
    }
}

// The same three deletes on the same file by SQLite's interface alone.
void cleanBare(benchmark::State &state, const std::string &catalogue)
{
    for (auto _ : state) {
        state.PauseTiming();
        RawDatabase database(benchdata::scratchCopy(catalogue));
        database.exec("pragma synchronous=full; pragma cache_size=-16000");
        state.ResumeTiming();
        database.exec("begin immediate;"
                      "delete from Tracks as trk where not exists"
                      " (select '1' from CompactDiscs where Track_ID=trk.ID);"
                      "delete from CDTitels as cdt where not exists"
                      " (select '1' from CompactDiscs where CDTitels_ID=cdt.ID);"
                      "delete from Artiesten as art where not exists"
                      " (select '1' from Tracks where Artiest_ID=art.ID)"
                      " and not exists (select '1' from CDTitels where Artiest_ID=art.ID);"
                      "commit");
    }
}

void registerBoth(const std::string &name, const std::string &catalogue)
{
    benchmark::RegisterBenchmark(("orphans/" + name).c_str(), clean, catalogue)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark(("bare orphans/" + name).c_str(), cleanBare, catalogue)
        ->Unit(benchmark::kMillisecond);
}

} // namespace

void registerOrphanCases()
{
    for (const auto &scale : benchdata::scales()) {
        registerBoth(scale.name, benchdata::catalogue(scale, orphanShare));
        registerBoth(std::string(scale.name) + ", none there", benchdata::catalogue(scale));
    }
}
