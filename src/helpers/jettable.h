#pragma once

#include "helpers/jetheader.h"

#include <array>
#include <cstdint>
#include <mdbtools.h>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace jet
{

struct Cell {
    enum Kind { Null, Number, Text } kind = Null;
    std::string bytes; // a number in digits, a text as it stands in the file
};
using Cells = std::vector<Cell>;

/// A table of a database, row by row. Of the library's own reading of rows nothing is used: it
/// takes an empty text for NULL, and says nothing where it gives up.
class Table
{
public:
    /// pages: in the file.
    Table(MdbHandle *file, MdbCatalogEntry *entry, std::size_t pages);
    ~Table();
    Table(const Table &) = delete;
    Table &operator=(const Table &) = delete;

    bool isThere() const { return mTable != nullptr; }
    std::uint32_t statedRows() const { return mTable->num_rows; }

    /// The columns that hold texts or numbers: those that rows have.
    const std::vector<std::string> &columns() const { return mNames; }

    /// The next row that is not deleted. False: there is none, or no reading on.
    bool next(Cells &row);

    /// Behind the last row: whether all came that the file states.
    Result result() const;

private:
    struct Bytes {
        const unsigned char *data = nullptr;
        std::size_t size = 0;
        std::uint32_t number(std::size_t at) const;
        std::string_view text() const;
    };
    void readColumns();
    bool nextPage();
    bool readRow(int start, std::size_t size, Cells &row);
    bool readCell(const MdbField &field, int type, Cell &cell);
    bool readNumber(Bytes bytes, int type, Cell &cell) const;
    bool readMemo(Bytes bytes, Cell &cell);
    bool appendChain(std::uint32_t row, std::size_t size, std::string &text);
    std::optional<Bytes> longRow(std::uint32_t row);
    Result broken() const;
    bool mapLiesBehindFile(unsigned long page) const;
    bool reachesBehindFile() const;

    MdbHandle *mFile;
    MdbTableDef *mTable = nullptr;
    const std::size_t mPages;
    std::vector<std::string> mNames;
    std::vector<int> mShown; // numbers of the columns
    std::array<MdbField, MDB_MAX_COLS> mFields{};
    int mRow = 0, mRowsOfPage = 0;
    std::uint64_t mRead = 0;
    std::size_t mPagesRead = 0;
    Result mResult = Result::Read;
};

} // namespace jet
