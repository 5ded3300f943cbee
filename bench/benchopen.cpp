#include "cases.h"
#include "platform/ado/connection.h"
#include "services/globals.h"
#include "shell/startup.h"

namespace
{

// With all that is looked at before a catalogue is worked with.
void open(benchmark::State &state, const std::string &catalogue)
{
    const QString file = QString::fromStdString(catalogue);
    for (auto _ : state) {
        startup::openCatalogue(file, false);
        state.PauseTiming();
        gConnection.reset();
        state.ResumeTiming();
    }
}

} // namespace

void registerOpenCases()
{
    for (const auto &scale : benchdata::scales())
        benchmark::RegisterBenchmark(caseName("open", scale).c_str(), open,
                                     benchdata::catalogue(scale))
            ->Unit(benchmark::kMillisecond);
}
