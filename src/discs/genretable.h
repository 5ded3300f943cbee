#pragma once

#include <QHash>
#include <QString>
#include <QStringList>

/// Genres by number. Those of the usual table come first; any other name gets a number of its own
/// when it is first asked for, and keeps it in this run.
class GenreTable
{
public:
    GenreTable();

    /// The number as text; empty for an empty name. Case does not count.
    QString idOf(const QString &name);
    QString nameOf(const QString &id) const; // empty for a number that is none
    const QStringList &usualNames() const;   // for a list to choose from, in its order

private:
    QStringList mNames;
    QHash<QString, int> mIds;
};

/// The name of an ID3v1 genre number; empty above the table.
QString id3GenreName(int number);

/// A genre as it is written: as in the usual table where it stands there (case, blanks and hyphens
/// do not count), else with a capital at its start.
QString genreAsWritten(const QString &name);
