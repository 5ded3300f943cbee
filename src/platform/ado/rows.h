#pragma once

#include "platform/ado/value.h"

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace ADODB
{

enum DataTypeEnum { adInteger = 3, adDouble = 5, adBigInt = 20, adVarWChar = 202 };

/// Name and declared type of a column; size in characters, 0 where it does not matter.
struct FieldInfo {
    QString name;
    DataTypeEnum type = adVarWChar;
    int size = 0;
};
using FieldList = std::vector<FieldInfo>;

/// The rows behind a recordset or a list: eight bytes a cell, and the texts in a heap of UTF-8. A
/// million rows take tens of megabytes and no object each. What is written over stays in the heap
/// until half of it is dead; then the heap is made anew, and texts seen before are gone. Rows are
/// shared as shared_ptr<const Rows>; who wants to change shared ones clones them first.
class Rows
{
public:
    explicit Rows(std::shared_ptr<const FieldList> fields);

    const FieldList &fields() const { return *mFields; }
    int columnCount() const { return mColumns; }
    qsizetype rowCount() const { return mColumns ? qsizetype(mCells.size()) / mColumns : 0; }

    enum class Kind { Null, Integer, Text, Real };
    Kind kind(qsizetype row, int column) const;
    qint64 integer(qsizetype row, int column) const;        // of a cell of kind Integer
    std::string_view utf8(qsizetype row, int column) const; // of a cell of kind Text
    Value value(qsizetype row, int column) const;

    /// The cell as an id: 0 for whatever is no whole number, which the rules forbid there.
    qint64 id(qsizetype row, int column) const
    {
        return kind(row, column) == Kind::Integer ? integer(row, column) : 0;
    }

    /// The cell as text, NULL as the empty text.
    QString text(qsizetype row, int column) const;

    /// Appends a row of NULLs and gives its number.
    qsizetype addRow();
    void removeRow(qsizetype row);
    void arrange(const std::vector<std::uint32_t> &order); // keeps these rows, in this order
    void setNull(qsizetype row, int column);
    void setInteger(qsizetype row, int column, qint64 v);
    void setReal(qsizetype row, int column, double v);
    void setUtf8(qsizetype row, int column, std::string_view v);
    void setUtf8OrShare(qsizetype row, int column, std::string_view v); // with the row above
    void setValue(qsizetype row, int column, const Value &v);

    std::shared_ptr<Rows> clone() const;

private:
    using Cell = std::uint64_t;
    const Cell &cell(qsizetype row, int column) const { return mCells[row * mColumns + column]; }
    Cell &cell(qsizetype row, int column) { return mCells[row * mColumns + column]; }
    char *room(std::size_t need);
    Cell used(std::size_t bytes, Kind kind);
    Cell store(const void *bytes, std::size_t size, Kind kind);
    Cell storeText(QStringView text, Cell before);
    Cell copyOf(const char *from, std::size_t bytes, Cell c);
    static bool isText(Cell c) { return Kind(c & 3) == Kind::Text; }
    const char *stored(Cell c) const;
    std::string_view storedText(Cell c) const;
    std::size_t bytesOf(Cell c) const;
    void put(Cell &place, Cell c);
    void compact();

    std::shared_ptr<const FieldList> mFields;
    int mColumns;
    std::vector<Cell> mCells;

    // Full chunks are shared between clones; each one writes to chunks of its own.
    std::vector<std::shared_ptr<char[]>> mChunks;
    std::size_t mChunkUsed = 0, mChunkSize = 0;
    bool mOwnsChunk = false;

    // Bytes of the heap, and those of them that no cell has any more. Too many rather than too few:
    // a text that cells share counts with each.
    std::size_t mStored = 0, mDead = 0;
};

} // namespace ADODB
