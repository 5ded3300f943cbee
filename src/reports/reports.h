#pragma once

#include "reports/Report.h"

// The three printed reports, each with the command that fetches its rows and its caption, which is
// English in both languages.

/// The titles of the compilations.
class CompilationReport : public Report
{
    Q_OBJECT

public:
    CompilationReport();
    static QString command();
    static QString caption();
};

/// The albums by artist and title.
class AlbumReport : public Report
{
    Q_OBJECT

public:
    AlbumReport();
    static QString command();
    static QString caption();
};

/// All tracks by artist and title, whatever discs they stand on.
class PlatenbakReport : public Report
{
    Q_OBJECT

public:
    PlatenbakReport();
    static QString command();
    static QString caption();
};
