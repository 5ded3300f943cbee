#include "browsepages.h"
#include "cases.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "shell/startup.h"

namespace
{

void browse(benchmark::State &state, const benchdata::Scale &scale)
{
    startup::openCatalogue(QString::fromStdString(benchdata::catalogue(scale)), false);
    for (auto _ : state)
        benchmark::DoNotOptimize(loadBrowsePages().tracks);
    gConnection.reset();
}

void openAndCheck(benchmark::State &state, const benchdata::Scale &scale)
{
    const auto file = QString::fromStdString(benchdata::catalogue(scale));
    for (auto _ : state) {
        startup::openCatalogue(file, false);
        gConnection.reset();
    }
}

// A click on a column of the albums: 1 the artist, 2 the title.
void sortAlbums(benchmark::State &state, const benchdata::Scale &scale)
{
    startup::openCatalogue(QString::fromStdString(benchdata::catalogue(scale)), false);
    const BrowsePages pages = loadBrowsePages();
    for (auto _ : state)
        benchmark::DoNotOptimize(sortedRows(*pages.albums.rows, int(state.range(0))).data());
    state.SetItemsProcessed(state.iterations() * pages.albums.rows->rowCount());
    gConnection.reset();
}

} // namespace

void registerBrowseCases()
{
    for (const auto &scale : benchdata::scales()) {
        benchmark::RegisterBenchmark(caseName("open", scale).c_str(), openAndCheck, scale)
            ->Unit(benchmark::kMillisecond);
        benchmark::RegisterBenchmark(caseName("browse", scale).c_str(), browse, scale)
            ->Unit(benchmark::kMillisecond);
        benchmark::RegisterBenchmark(caseName("sort albums", scale).c_str(), sortAlbums, scale)
            ->ArgName("column")
            ->DenseRange(1, 2)
            ->Unit(benchmark::kMillisecond);
    }
}
