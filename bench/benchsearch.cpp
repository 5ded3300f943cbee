#include "cases.h"
#include "collection/frmSearchArtistsTitles.h"
#include "names.h"
#include "platform/ado/connection.h"
#include "rawdatabase.h"
#include "services/globals.h"
#include "shell/startup.h"

#include <QApplication>
#include <QPushButton>

using namespace Qt::StringLiterals;

namespace
{

constexpr int titles = 100'000;

// Titles in memory, in a table that needs no collation, so that both kinds of LIKE run on the same.
void fill(RawDatabase &database, bool accented)
{
    database.exec("create table Titles(Titel text); begin");
    RawStatement insert(database, "insert into Titles values(?)");
    Names names(3);
    names.useOnly(accented);
    for (int i = 0; i < titles; ++i)
        insert.run(std::string_view(names.title()));
    database.exec("commit");
}

void like(benchmark::State &state, RawDatabase::Functions functions, bool accented,
          const std::string &pattern)
{
    RawDatabase database(":memory:", functions);
    fill(database, accented);
    RawStatement search(database, "select count(*) from Titles where Titel like ?");
    sqlite3_int64 found = 0;
    for (auto _ : state)
        benchmark::DoNotOptimize(found = search.number(std::string_view(pattern)));
    state.counters["found"] = double(found);
    state.SetItemsProcessed(state.iterations() * titles);
}

void registerPattern(const std::string &name, bool accented, const std::string &pattern)
{
    benchmark::RegisterBenchmark(("like/" + name).c_str(), like, RawDatabase::Ours, accented,
                                 pattern)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark(("SQLite's like/" + name).c_str(), like, RawDatabase::Plain,
                                 accented, pattern)
        ->Unit(benchmark::kMillisecond);
}

// All rows of an owner's catalogue, up to the paint.
void everythingOnTheScreen(benchmark::State &state)
{
    startup::openCatalogue(QString::fromStdString(benchdata::catalogue(benchdata::scales()[0])),
                           false);
    auto *search = new frmSearchArtistsTitles;
    search->Show();
    QApplication::processEvents();
    auto *button = search->findChild<QPushButton *>(u"cmdSearch"_s);
    for (auto _ : state) {
        button->click();
        QApplication::processEvents();
    }
    search->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    gConnection.reset();
}

} // namespace

void registerSearchCases()
{
    benchmark::RegisterBenchmark("search everything, on the screen", everythingOnTheScreen)
        ->Unit(benchmark::kMillisecond);
    registerPattern("ASCII titles", false, "%maan%");
    registerPattern("ASCII titles, none found", false, "%qqq%");
    registerPattern("accented titles", true, "%été%");
    registerPattern("accented titles, ASCII word", true, "%ar%");
}
