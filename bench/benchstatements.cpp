#include "cases.h"
#include "platform/ado/dialect.h"
#include "platform/ado/recordset.h"
#include "rawdatabase.h"
#include "services/globals.h"
#include "shell/startup.h"

using namespace Qt::StringLiterals;

namespace
{

const auto findArtist = u"Select ID, Naam From Artiesten where Naam = '%1'"_s;

const char *const typical[] = {
    "Select ID, Naam From Artiesten where Naam = 'O''Brien & The Foxes'",
    "select max(id+1) as ID from tracks",
    "Insert into Tracks(ID,Artiest_ID,Titel,Genre,Hitjaar) values (4711,12,'Café De "
    "Maan','Pop',1985)",
    "delete from tracks trk where not exists (select '1' from CompactDiscs where Track_ID=trk.ID)",
};

// The catalogue's busiest kind of statement, as the program sends it: a look-up of a name. In a
// transaction, or both would measure the locks of the file.
void find(benchmark::State &state)
{
    startup::openCatalogue(
        QString::fromStdString(benchdata::catalogue(benchdata::scales().front())), false);
    const QString statement = QString(findArtist).replace("%1"_L1, "Nobody At All"_L1);
    const ADODB::Transaction transaction(*gConnection);
    for (auto _ : state) {
        ADODB::Recordset answer;
        answer.Open(statement, *gConnection);
        benchmark::DoNotOptimize(answer.RecordCount());
    }
    gConnection.reset();
}

void findPrepared(benchmark::State &state)
{
    RawDatabase database(benchdata::catalogue(benchdata::scales().front()));
    database.exec("begin immediate");
    RawStatement search(database, "select ID, Naam from Artiesten where Naam = ?");
    for (auto _ : state)
        benchmark::DoNotOptimize(search.number(std::string_view("Nobody At All")));
}

void translate(benchmark::State &state)
{
    const QString statement = QString::fromUtf8(typical[state.range(0)]);
    state.SetLabel(statement.left(30).toStdString());
    for (auto _ : state)
        benchmark::DoNotOptimize(ADODB::translated(statement));
    state.SetBytesProcessed(state.iterations() * statement.size());
}

} // namespace

void registerStatementCases()
{
    benchmark::RegisterBenchmark("statement/sent as text", find);
    benchmark::RegisterBenchmark("statement/prepared by hand", findPrepared);
    benchmark::RegisterBenchmark("translate", translate)
        ->DenseRange(0, int(std::size(typical)) - 1);
}
