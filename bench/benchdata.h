#pragma once

#include "generate.h"

#include <string>
#include <vector>

/// The files that the benchmarks work on. They are made when they are first asked for and kept in
/// the folder that SONGCASE_BENCH_DATA names, else in one of the system's temporary folder.
namespace benchdata
{

/// A size of catalogue by its name: "owner" or "stress".
struct Scale {
    const char *name;
    CataloguePlan plan;
};

/// The sizes to run at: the owner's always, the stress size where that was asked for.
std::vector<Scale> scales();
void runStressToo();

/// A catalogue of that size; never to be written to.
std::string catalogue(const Scale &scale, double orphans = 0);

/// An empty catalogue, likewise; `nocase`: with SQLite's own NOCASE.
std::string emptyCatalogue(bool nocase = false);

/// A text file of 100,000 tracks in a format 'A' to 'D'.
std::string text(char format);

/// A copy of a file that may be written to; the one before is gone.
std::string scratchCopy(const std::string &file);

} // namespace benchdata
