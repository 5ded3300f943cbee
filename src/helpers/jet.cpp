#include "helpers/jet.h"

#include "helpers/jettable.h"
#include "helpers/jettext.h"

#include <cstdio>
#include <cstring>
#include <memory>
#include <string_view>
#include <utility>

namespace jet
{

namespace
{

struct CloseFile {
    void operator()(MdbHandle *file) const { mdb_close(file); }
};
using File = std::unique_ptr<MdbHandle, CloseFile>;

MdbCatalogEntry *find(MdbHandle *file, const std::string &name)
{
    for (unsigned i = 0; i < file->num_catalog; ++i) {
        auto *entry = static_cast<MdbCatalogEntry *>(g_ptr_array_index(file->catalog, i));
        if (g_ascii_strcasecmp(entry->object_name, name.c_str()) == 0)
            return entry;
    }
    return nullptr;
}

// A table that is not listed may stand in a part of the list that is lost.
Result stateOfList(MdbHandle *file, std::size_t pages)
{
    constexpr unsigned long firstPage = 2; // in every file
    MdbCatalogEntry list = {};
    list.mdb = file;
    list.object_type = MDB_TABLE;
    list.table_pg = firstPage;
    std::strcpy(list.object_name, "MSysObjects");
    Table table(file, &list, pages);
    Cells row;
    while (table.next(row)) {
    }
    return table.result();
}

class Printer
{
public:
    Printer(MdbHandle *file, const Header &header)
        : mFile(file),
          mHeader(header),
          mDecoder(header.generation == 4 ? TextDecoder::ofUnicode()
                                          : TextDecoder::ofCodePage(header.codePage))
    {
    }

    Result print(const std::vector<std::string> &wanted);

private:
    Result printTable(const std::string &name, MdbCatalogEntry *entry);
    Result printRows(Table &table);
    void startTable(const std::string &name, const Table &table);
    void put(const Cell &cell);
    void put(std::string_view text);
    void flush();

    MdbHandle *mFile;
    const Header &mHeader;
    const TextDecoder mDecoder;
    std::string mOut;
};

Result Printer::print(const std::vector<std::string> &wanted)
{
    bool anyMissing = false;
    for (const std::string &name : wanted) {
        MdbCatalogEntry *entry = find(mFile, name);
        anyMissing |= !entry;
        const Result result = entry ? printTable(name, entry) : Result::Read;
        if (result != Result::Read)
            return result;
    }
    if (anyMissing) {
        if (const Result list = stateOfList(mFile, mHeader.pages); list != Result::Read)
            return list;
    }
    mOut += "end\n";
    flush();
    return Result::Read;
}

Result Printer::printTable(const std::string &name, MdbCatalogEntry *entry)
{
    Table table(mFile, entry, mHeader.pages);
    if (!table.isThere())
        return table.result();
    startTable(name, table);
    return printRows(table);
}

void Printer::startTable(const std::string &name, const Table &table)
{
    mOut += "table " + name + ' ' + std::to_string(table.statedRows()) + '\n';
    for (const std::string &column : table.columns()) {
        mOut += "column ";
        put(std::string_view(column));
        mOut += '\n';
    }
}

Result Printer::printRows(Table &table)
{
    constexpr std::size_t enough = 1 << 16;
    Cells row;
    while (table.next(row)) {
        char before = '=';
        for (const Cell &cell : row) {
            mOut += std::exchange(before, '\t');
            put(cell);
        }
        mOut += '\n';
        if (mOut.size() > enough)
            flush();
    }
    return table.result();
}

void Printer::put(const Cell &cell)
{
    if (cell.kind == Cell::Null) {
        mOut += "\\N";
    } else if (cell.kind == Cell::Number) {
        mOut += cell.bytes;
    } else {
        mOut += '\'';
        put(mDecoder.utf8(cell.bytes));
    }
}

void Printer::put(std::string_view text)
{
    constexpr std::string_view breaking("\\\t\n\r\0", 5), letters("\\tnr");
    for (;;) {
        const auto at = text.find_first_of(breaking);
        mOut += text.substr(0, at);
        if (at == std::string_view::npos)
            return;
        if (text[at] != 0) { // which no text has
            mOut += '\\';
            mOut += letters[breaking.find(text[at])];
        }
        text.remove_prefix(at + 1);
    }
}

void Printer::flush()
{
    std::fwrite(mOut.data(), 1, mOut.size(), stdout);
    std::fflush(stdout);
    mOut.clear();
}

} // namespace

Result printTables(const std::string &name, const std::vector<std::string> &wanted)
{
    Header header;
    if (const Result result = readHeader(name, header); result != Result::Read)
        return result;
    constexpr std::size_t fewest = 3; // header, map of pages, list of objects
    if (header.pages < fewest)
        return Result::CutOff;
    const File file(mdb_open(name.c_str(), MDB_NOFLAGS));
    if (!file)
        return Result::Damaged;
    const bool listed = mdb_read_catalog(file.get(), MDB_TABLE);
    const Result result = listed ? Printer(file.get(), header).print(wanted) : Result::Damaged;
    const bool cut =
        result == Result::Damaged && stateOfList(file.get(), header.pages) == Result::CutOff;
    return cut ? Result::CutOff : result;
}

} // namespace jet
