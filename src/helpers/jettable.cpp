#include "helpers/jettable.h"

#include <cstdio>
#include <cstring>

namespace jet
{

namespace
{

// The start of a row has two marks beside it. A row that was moved is read where it lies now; where
// it was there is only the way there.
constexpr int movedAway = 0x4000, place = 0x1FFF, mostRows = 1000;

// A memo begins with its size and where it is: here, in one row elsewhere, or in a chain of rows.
constexpr std::uint32_t memoHere = 0x80000000, memoInOneRow = 0x40000000, memoSize = 0x3FFFFFFF;
constexpr std::size_t memoHead = 12, link = 4, longestText = 16 << 20;

template <typename Number> Number numberAt(const unsigned char *bytes)
{
    Number number;
    std::memcpy(&number, bytes, sizeof number);
    return number;
}

std::string digits(double number)
{
    char text[40];
    return {text, std::size_t(std::snprintf(text, sizeof text, "%.17g", number))};
}

// The bytes that a value of a column takes; 0 for texts, -1 for what is neither text nor number.
int sizeOf(int type)
{
    switch (type) {
    case MDB_BOOL:
    case MDB_TEXT:
    case MDB_MEMO:
        return 0;
    case MDB_BYTE:
        return 1;
    case MDB_INT:
        return 2;
    case MDB_LONGINT:
    case MDB_FLOAT:
        return 4;
    case MDB_MONEY:
    case MDB_DOUBLE:
    case MDB_DATETIME:
        return 8;
    default:
        return -1;
    }
}

std::string numberOf(const unsigned char *bytes, int type)
{
    constexpr double moneyUnit = 10000;
    switch (type) {
    case MDB_BYTE:
        return std::to_string(*bytes);
    case MDB_INT:
        return std::to_string(numberAt<std::int16_t>(bytes));
    case MDB_LONGINT:
        return std::to_string(numberAt<std::int32_t>(bytes));
    case MDB_FLOAT:
        return digits(double(numberAt<float>(bytes)));
    case MDB_MONEY:
        return digits(double(numberAt<std::int64_t>(bytes)) / moneyUnit);
    default:
        return digits(numberAt<double>(bytes));
    }
}

} // namespace

std::uint32_t Table::Bytes::number(std::size_t at) const
{
    return numberAt<std::uint32_t>(data + at);
}

std::string_view Table::Bytes::text() const
{
    return {reinterpret_cast<const char *>(data), size};
}

Table::Table(MdbHandle *file, MdbCatalogEntry *entry, std::size_t pages)
    : mFile(file), mPages(pages)
{
    if (entry->table_pg < pages)
        mTable = mdb_read_table(entry);
    if (!mTable || !mdb_read_columns(mTable)) {
        const bool cut = entry->table_pg >= pages || mapLiesBehindFile(entry->table_pg);
        mResult = cut ? Result::CutOff : Result::Damaged;
        return;
    }
    readColumns();
    mdb_rewind_table(mTable);
}

Table::~Table()
{
    if (mTable)
        mdb_free_tabledef(mTable);
}

void Table::readColumns()
{
    for (unsigned i = 0; i < mTable->num_cols && i < mTable->columns->len; ++i) {
        const auto *column = static_cast<MdbColumn *>(g_ptr_array_index(mTable->columns, i));
        if (sizeOf(column->col_type) < 0)
            continue;
        mNames.emplace_back(column->name);
        mShown.push_back(int(i));
    }
}

bool Table::nextPage()
{
    if (!mdb_read_next_dpg(mTable))
        return false;
    mRow = 0;
    mRowsOfPage = mdb_get_int16(mFile->pg_buf, mFile->fmt->row_count_offset);
    if (mRowsOfPage > mostRows || ++mPagesRead > mPages) // or it goes round for ever
        mResult = Result::Damaged;
    return mResult == Result::Read;
}

bool Table::next(Cells &row)
{
    if (mResult != Result::Read)
        return false;
    for (;;) {
        while (mRow >= mRowsOfPage) {
            if (!nextPage())
                return false;
        }
        int start = 0;
        std::size_t size = 0;
        if (mdb_find_row(mFile, mRow++, &start, &size) != 0) {
            mResult = Result::Damaged;
            return false;
        }
        if (!(start & movedAway))
            return readRow(start & place, size, row);
    }
}

bool Table::readRow(int start, std::size_t size, Cells &row)
{
    const int count = size > 0 ? mdb_crack_row(mTable, start, size, mFields.data()) : -1;
    bool good = count > 0 && ++mRead <= mTable->num_rows;
    row.resize(mShown.size());
    for (std::size_t i = 0; good && i < mShown.size(); ++i) {
        const auto *column =
            static_cast<MdbColumn *>(g_ptr_array_index(mTable->columns, unsigned(mShown[i])));
        good = mShown[i] < count &&
               readCell(mFields[std::size_t(mShown[i])], column->col_type, row[i]);
    }
    if (!good && mResult == Result::Read)
        mResult = Result::Damaged;
    return good;
}

bool Table::readCell(const MdbField &field, int type, Cell &cell)
{
    cell.bytes.clear();
    cell.kind = Cell::Null;
    if (type == MDB_BOOL) { // which has no bytes beside its mark
        cell.kind = Cell::Number;
        cell.bytes = field.is_null ? "0" : "1";
        return true;
    }
    if (field.is_null)
        return true;
    const bool fits =
        field.siz >= 0 && field.start >= 0 && field.start + field.siz <= int(mFile->fmt->pg_size);
    if (!fits)
        return false;
    const Bytes bytes{mFile->pg_buf + field.start, std::size_t(field.siz)};
    if (sizeOf(type) > 0)
        return readNumber(bytes, type, cell);
    cell.kind = Cell::Text;
    if (type == MDB_MEMO)
        return readMemo(bytes, cell);
    cell.bytes = bytes.text();
    return true;
}

bool Table::readNumber(Bytes bytes, int type, Cell &cell) const
{
    if (bytes.size < std::size_t(sizeOf(type)))
        return false;
    cell.kind = Cell::Number;
    cell.bytes = numberOf(bytes.data, type);
    return true;
}

bool Table::readMemo(Bytes bytes, Cell &cell)
{
    if (bytes.size == 0)
        return true; // the empty text
    if (bytes.size < memoHead)
        return false;
    const std::uint32_t head = bytes.number(0), row = bytes.number(4);
    const std::size_t size = head & memoSize;
    if (size > longestText)
        mResult = Result::TooLong;
    if (mResult != Result::Read)
        return false;
    if (!(head & (memoHere | memoInOneRow)))
        return appendChain(row, size, cell.bytes);
    std::optional<Bytes> text;
    if (head & memoHere)
        text = Bytes{bytes.data + memoHead, bytes.size - memoHead};
    else
        text = longRow(row);
    if (!text || text->size < size)
        return false;
    cell.bytes = text->text().substr(0, size);
    return true;
}

// The rows say where the next one is. Each must bring something, or a ring of them has no end.
bool Table::appendChain(std::uint32_t row, std::size_t size, std::string &text)
{
    while (text.size() < size) {
        const auto part = longRow(row);
        if (!part || part->size <= link)
            return false;
        text += part->text().substr(link);
        row = part->number(0);
    }
    text.resize(size);
    return true;
}

// A row anywhere in the file; the page that is being read stays where it is.
std::optional<Table::Bytes> Table::longRow(std::uint32_t row)
{
    void *page = nullptr;
    int start = 0;
    std::size_t size = 0;
    if (mdb_find_pg_row(mFile, int(row), &page, &start, &size) != 0)
        return {};
    start &= place;
    if (std::size_t(start) + size > std::size_t(mFile->fmt->pg_size))
        return {};
    return Bytes{static_cast<unsigned char *>(page) + start, size};
}

Result Table::result() const
{
    if (mResult == Result::TooLong || !mTable)
        return mResult;
    const bool whole = mResult == Result::Read && mRead == mTable->num_rows;
    return whole ? Result::Read : broken();
}

Result Table::broken() const
{
    return reachesBehindFile() ? Result::CutOff : Result::Damaged;
}

// Of a table that the library does not read: it looks for the map of its pages at once.
bool Table::mapLiesBehindFile(unsigned long page) const
{
    if (mdb_read_pg(mFile, page) <= 0)
        return true;
    const long row = mdb_get_int32(mFile->pg_buf, mFile->fmt->tab_usage_map_offset);
    return std::size_t(std::uint32_t(row) >> 8) >= mPages;
}

// The map holds marks, or the numbers of pages that hold them.
bool Table::reachesBehindFile() const
{
    constexpr std::size_t number = 4;
    const unsigned char *map = mTable->usage_map;
    if (mTable->map_sz > 0 && map[0] == 1) {
        for (std::size_t at = 1; at + number <= mTable->map_sz; at += number) {
            if (numberAt<std::uint32_t>(map + at) >= mPages)
                return true;
        }
    }
    for (gint32 page = 0;;) {
        const gint32 next =
            mdb_map_find_next(mFile, mTable->usage_map, unsigned(mTable->map_sz), guint32(page));
        if (next <= page)
            return false;
        if (std::size_t(next) >= mPages)
            return true;
        page = next;
    }
}

} // namespace jet
