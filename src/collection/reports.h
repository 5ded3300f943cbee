#pragma once

#include "collection/Report.h"

// The three printed reports, each with the command that fetches its rows and its caption, which is
// English in both languages.

/// The titles of the compilations.
class CompilationReport : public Report
{
    Q_OBJECT

public:
    CompilationReport() : Report(QStringLiteral("CompilationReport")) {}
    static QString command();
    static QString caption() { return QStringLiteral("Compilations"); }
};

/// The albums by artist and title.
class AlbumReport : public Report
{
    Q_OBJECT

public:
    AlbumReport() : Report(QStringLiteral("AlbumReport")) {}
    static QString command();
    static QString caption() { return QStringLiteral("Albums"); }
};

/// All tracks by artist and title, whatever discs they stand on.
class PlatenbakReport : public Report
{
    Q_OBJECT

public:
    PlatenbakReport() : Report(QStringLiteral("PlatenbakReport")) {}
    static QString command();
    static QString caption() { return QStringLiteral("Records"); }
};
