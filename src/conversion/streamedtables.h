#pragma once

#include "conversion/oldtables.h"
#include "platform/ado/command.h"

#include <optional>
#include <string>

/// Fills a connection of its own with the tables that songcase-jet prints, as they come. What the
/// helper says is not trusted: it reads files that anybody may have damaged. Throws Error for what
/// is no line of it and for a table without a column that is needed.
class StreamedTables
{
public:
    /// The connection is open and has no tables yet.
    explicit StreamedTables(ADODB::Connection &connection);

    void take(std::string_view line);

    /// Whether all has come: the end, and as many rows of each table as it states.
    bool isWhole() const { return mEnded; }
    bool has(const OldTable &table) const;

private:
    void beginTable(std::string_view name, std::string_view rows);
    void addColumn(std::string_view name);
    void takeRow(std::string_view cells);
    ADODB::Parameter valueOf(std::string_view cell, std::size_t place);
    void requireColumns() const;
    void endTable();
    void end();

    ADODB::Connection &mConnection;
    std::optional<ADODB::Transaction> mTransaction;
    const OldTable *mTable = nullptr; // that is coming
    std::vector<const OldTable *> mCame;
    std::vector<int> mPlaces; // of the file's columns in the table's, -1: not wanted
    std::string mInsert;
    std::optional<ADODB::Command> mCommand;
    std::array<std::string, OldTable::mostColumns> mTexts; // of the row
    long long mStated = 0, mRows = 0;
    bool mEnded = false;
};
