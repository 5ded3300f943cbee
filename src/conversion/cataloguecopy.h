#pragma once

#include "conversion/oldtables.h"
#include "platform/ado/rows.h"

#include <functional>

namespace ADODB
{
class Connection;
class Command;
} // namespace ADODB

/// Counts the rows of an old catalogue and copies them into an empty one, ids and all. In the
/// transaction of its caller: a copy that was cancelled or that failed leaves what it has written.
class CatalogueCopy
{
public:
    CatalogueCopy(ADODB::Connection &from, ADODB::Connection &to, bool withMP3);

    /// Asked before each count and each row; false ends the work.
    std::function<bool()> mayGoOn = [] { return true; };
    std::function<void(const OldTable &table, qint64 rows)> counted;

    /// Told of each row that was copied, counted from 0, and behind the last of a table.
    std::function<void(const OldTable &table, qint64 row, qint64 rows)> copied;
    std::function<void()> tableCopied;

    // False: cancelled. Throw Error, which names the row.
    bool count();
    bool copy();

    qint64 total() const; // rows, once counted

private:
    bool isWanted(const OldTable &table) const { return mWithMP3 || !table.ofMP3; }
    bool copyTable(const OldTable &table, qint64 rows);

    ADODB::Connection &mFrom, &mTo;
    const bool mWithMP3;
    std::array<qint64, 6> mCounts{}; // of oldTables()
};
