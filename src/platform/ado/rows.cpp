#include "platform/ado/rows.h"

#include "platform/text/normalform.h"

#include <QStringConverter>
#include <algorithm>
#include <cstring>

namespace ADODB
{

namespace
{

// A cell: its kind in the low two bits; above them a whole number, or the place of the bytes in the
// heap (chunk above, offset below). What does not fit 62 bits goes to the heap as eight bytes.
constexpr int kindBits = 2;
constexpr std::uint64_t kindMask = (1 << kindBits) - 1;
constexpr std::uint64_t inHeap = std::uint64_t(1) << 63; // of a whole number
constexpr int offsetBits = 28;
constexpr std::size_t chunkSize = std::size_t(1) << 20;
constexpr std::size_t firstChunkSize = 256;
constexpr qint64 smallest = -(qint64(1) << 61), largest = (qint64(1) << 61) - 1;

} // namespace

Rows::Rows(std::shared_ptr<const FieldList> fields)
    : mFields(std::move(fields)), mColumns(int(mFields->size()))
{
}

Rows::Kind Rows::kind(qsizetype row, int column) const
{
    const Cell c = cell(row, column);
    const auto kind = Kind(c & kindMask);
    return kind == Kind::Real && (c & inHeap) ? Kind::Integer : kind;
}

qint64 Rows::integer(qsizetype row, int column) const
{
    const Cell c = cell(row, column);
    if (Kind(c & kindMask) == Kind::Integer)
        return qint64(c) >> kindBits;
    qint64 v;
    std::memcpy(&v, stored(c), sizeof v);
    return v;
}

std::string_view Rows::utf8(qsizetype row, int column) const
{
    return storedText(cell(row, column));
}

std::string_view Rows::storedText(Cell c) const
{
    const char *p = stored(c);
    std::uint32_t size;
    std::memcpy(&size, p, sizeof size);
    return {p + sizeof size, size};
}

Value Rows::value(qsizetype row, int column) const
{
    switch (kind(row, column)) {
    case Kind::Null:
        return {};
    case Kind::Integer:
        return integer(row, column);
    case Kind::Text:
        return text(row, column);
    case Kind::Real:
        break;
    }
    double v;
    std::memcpy(&v, stored(cell(row, column)), sizeof v);
    return v;
}

QString Rows::text(qsizetype row, int column) const
{
    if (kind(row, column) != Kind::Text)
        return value(row, column).toText();
    return text::fromUtf8(utf8(row, column));
}

qsizetype Rows::addRow()
{
    mCells.resize(mCells.size() + std::size_t(mColumns), Cell(Kind::Null));
    return rowCount() - 1;
}

void Rows::removeRow(qsizetype row)
{
    const auto from = mCells.begin() + row * mColumns;
    for (int column = 0; column < mColumns; ++column)
        mDead += bytesOf(from[column]);
    mCells.erase(from, from + mColumns);
}

void Rows::arrange(const std::vector<std::uint32_t> &order)
{
    std::vector<Cell> cells;
    cells.reserve(order.size() * std::size_t(mColumns));
    for (const auto row : order) {
        const auto from = mCells.begin() + qsizetype(row) * mColumns;
        cells.insert(cells.end(), from, from + mColumns);
    }
    mCells.swap(cells);
}

std::shared_ptr<Rows> Rows::clone() const
{
    auto copy = std::make_shared<Rows>(*this);
    copy->mOwnsChunk = false;
    return copy;
}

void Rows::setNull(qsizetype row, int column)
{
    put(cell(row, column), Cell(Kind::Null));
}

void Rows::setInteger(qsizetype row, int column, qint64 v)
{
    const bool fits = v >= smallest && v <= largest;
    put(cell(row, column), fits ? Cell(v) << kindBits | Cell(Kind::Integer)
                                : store(&v, sizeof v, Kind::Real) | inHeap);
}

void Rows::setReal(qsizetype row, int column, double v)
{
    put(cell(row, column), store(&v, sizeof v, Kind::Real));
}

void Rows::setUtf8(qsizetype row, int column, std::string_view v)
{
    put(cell(row, column), store(v.data(), v.size(), Kind::Text));
}

// Rows come in an order: what one says, the next one often says again.
void Rows::setUtf8OrShare(qsizetype row, int column, std::string_view v)
{
    const Cell above = row > 0 ? cell(row - 1, column) : Cell(Kind::Null);
    if (isText(above) && storedText(above) == v)
        cell(row, column) = above;
    else
        setUtf8(row, column, v);
}

void Rows::setValue(qsizetype row, int column, const Value &v)
{
    if (const auto *whole = std::get_if<qint64>(&v.variant())) {
        setInteger(row, column, *whole);
    } else if (const auto *fraction = std::get_if<double>(&v.variant())) {
        setReal(row, column, *fraction);
    } else if (const auto *words = std::get_if<QString>(&v.variant())) {
        put(cell(row, column), storeText(*words, cell(row, column)));
    } else {
        setNull(row, column);
    }
}

std::size_t Rows::bytesOf(Cell c) const
{
    switch (Kind(c & kindMask)) {
    case Kind::Text:
        return sizeof(std::uint32_t) + storedText(c).size();
    case Kind::Real:
        return sizeof(double);
    default:
        return 0;
    }
}

// Making the heap anew takes time for each cell: it waits until that is worth it.
void Rows::put(Cell &place, Cell c)
{
    if (place == c)
        return;
    mDead += bytesOf(place);
    place = c;
    if (mDead > firstChunkSize && mDead > mStored / 2 && mDead > mCells.size() * sizeof(Cell) / 2)
        compact();
}

// The bytes of a cell of other rows, as a cell of these.
Rows::Cell Rows::copyOf(const char *from, std::size_t bytes, Cell c)
{
    std::memcpy(room(bytes), from, bytes);
    return used(bytes, Kind(c & kindMask)) | (c & inHeap);
}

// Cells that share a text with the one above share the new one.
void Rows::compact()
{
    Rows fresh(mFields);
    fresh.mCells.resize(mCells.size());
    for (std::size_t i = 0; i < mCells.size(); ++i) {
        const Cell c = mCells[i];
        const std::size_t bytes = bytesOf(c);
        const bool shares =
            bytes > 0 && i >= std::size_t(mColumns) && mCells[i - std::size_t(mColumns)] == c;
        if (bytes == 0)
            fresh.mCells[i] = c;
        else if (shares)
            fresh.mCells[i] = fresh.mCells[i - std::size_t(mColumns)];
        else
            fresh.mCells[i] = fresh.copyOf(stored(c), bytes, c);
    }
    *this = std::move(fresh);
}

// Room for so many bytes behind the last ones stored; all that is used of it is to be told to
// used().
char *Rows::room(std::size_t need)
{
    if (!mOwnsChunk || mChunkUsed + need > mChunkSize) {
        mStored += mChunkSize - mChunkUsed; // the rest is lost
        mDead += mChunkSize - mChunkUsed;
        mChunkSize = std::max(need, std::clamp(mStored, firstChunkSize, chunkSize));
        mChunks.emplace_back(new char[mChunkSize]);
        mChunkUsed = 0;
        mOwnsChunk = true;
    }
    return mChunks.back().get() + mChunkUsed;
}

Rows::Cell Rows::store(const void *bytes, std::size_t size, Kind kind)
{
    const std::size_t head = kind == Kind::Text ? sizeof(std::uint32_t) : 0;
    char *to = room(head + size);
    if (head) {
        const auto length = std::uint32_t(size);
        std::memcpy(to, &length, head);
    }
    if (size)
        std::memcpy(to + head, bytes, size);
    return used(head + size, kind);
}

// Written where it stays: building a table of a hundred thousand rows allocates nothing per cell. A
// text that the cell has already does not stay.
Rows::Cell Rows::storeText(QStringView text, Cell before)
{
    constexpr std::size_t head = sizeof(std::uint32_t), mostPerUnit = 3;
    char *to = room(head + mostPerUnit * std::size_t(text.size()));
    QStringEncoder encoder(QStringEncoder::Utf8, QStringEncoder::Flag::Stateless);
    const char *end = encoder.appendToBuffer(to + head, text);
    const auto length = std::uint32_t(end - to - head);
    if (isText(before) && storedText(before) == std::string_view(to + head, length))
        return before;
    std::memcpy(to, &length, head);
    return used(head + length, Kind::Text);
}

Rows::Cell Rows::used(std::size_t bytes, Kind kind)
{
    const Cell place = Cell(mChunks.size() - 1) << offsetBits | mChunkUsed;
    mChunkUsed += bytes;
    mStored += bytes;
    return place << kindBits | Cell(kind);
}

const char *Rows::stored(Cell c) const
{
    const Cell place = (c & ~inHeap) >> kindBits;
    return mChunks[place >> offsetBits].get() + (place & ((Cell(1) << offsetBits) - 1));
}

} // namespace ADODB
