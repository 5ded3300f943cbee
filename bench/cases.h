#pragma once

#include "benchdata.h"

#include <benchmark/benchmark.h>

// Each function registers the benchmarks of one subject.

void registerOpenCases();      // what is looked at before a catalogue is worked with
void registerBrowseCases();    // the load of the browser, the sort of one page
void registerTextCases();      // reading and loading text files, and the bare loop
void registerOrphanCases();    // CleanOrphans, and its deletes without the program
void registerSearchCases();    // our LIKE and SQLite's
void registerStatementCases(); // what one statement costs more than a prepared one
void registerEditCases();      // editors, their saves and completion, the record tree
void registerTextRuleCases();  // the sort order
void registerDiscCases();      // answers about discs

/// The name of a case at a size: "browse/owner".
inline std::string caseName(const char *name, const benchdata::Scale &scale)
{
    return std::string(name) + '/' + scale.name;
}
