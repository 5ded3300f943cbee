#include "cases.h"
#include "consoledesktop.h"

#include <QApplication>
#include <algorithm>
#include <cstring>

// songcase-bench [--stress] [options of Google Benchmark]
int main(int argc, char **argv)
{
    char **end = std::remove_if(argv + 1, argv + argc, [](const char *argument) {
        const bool stress = std::strcmp(argument, "--stress") == 0;
        if (stress)
            benchdata::runStressToo();
        return stress;
    });
    argc = int(end - argv);
    // The screens are made for real, on a display that nobody sees.
    qputenv("QT_QPA_PLATFORM", "offscreen");
    const QApplication application(argc, argv);
    const ConsoleDesktop desktop;
    registerOpenCases();
    registerBrowseCases();
    registerTextCases();
    registerOrphanCases();
    registerSearchCases();
    registerStatementCases();
    registerEditCases();
    registerTextRuleCases();
    registerDiscCases();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 2;
    benchmark::RunSpecifiedBenchmarks();
    return desktop.failed ? 1 : 0;
}
