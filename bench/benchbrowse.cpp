#include "browsepages.h"
#include "cases.h"
#include "collection/frmCDList.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "shell/startup.h"

#include <QApplication>
#include <QTabWidget>

using namespace Qt::StringLiterals;

namespace
{

void browse(benchmark::State &state, const benchdata::Scale &scale)
{
    startup::openCatalogue(QString::fromStdString(benchdata::catalogue(scale)), false);
    for (auto _ : state)
        benchmark::DoNotOptimize(loadBrowsePages().albums.order.data());
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

// What a save asks of the browser: a title of the page that shows has changed, up to the paint.
void refresh(benchmark::State &state, const benchdata::Scale &scale)
{
    const std::string copy = benchdata::scratchCopy(benchdata::catalogue(scale));
    startup::openCatalogue(QString::fromStdString(copy), false);
    gConnection->housekeeping("PRAGMA synchronous=OFF");
    auto *browser = new frmCDList;
    browser->Show();
    browser->findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(int(state.range(0)));
    QApplication::processEvents();
    int round = 0;
    for (auto _ : state) {
        state.PauseTiming();
        gConnection->Execute(u"update CDTitels set Titel = 'Title "_s + QString::number(++round) +
                             u"' where ID in (10, 11, 12, 13, 14, 15)"_s);
        state.ResumeTiming();
        browser->RefreshLists();
        QApplication::processEvents();
    }
    browser->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    gConnection.reset();
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
        benchmark::RegisterBenchmark(caseName("refresh the browser", scale).c_str(), refresh, scale)
            ->ArgName("page")
            ->DenseRange(0, 1)
            ->Unit(benchmark::kMillisecond);
        benchmark::RegisterBenchmark(caseName("sort albums", scale).c_str(), sortAlbums, scale)
            ->ArgName("column")
            ->DenseRange(1, 2)
            ->Unit(benchmark::kMillisecond);
    }
}
