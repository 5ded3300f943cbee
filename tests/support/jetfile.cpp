#include "support/jetfile.h"

#include <QtEndian>

namespace
{

template <typename Number> void put(QByteArray &page, qsizetype at, Number number)
{
    qToLittleEndian(number, page.data() + at);
}

template <typename Number> QByteArray little(Number number)
{
    QByteArray bytes(sizeof number, 0);
    put(bytes, 0, number);
    return bytes;
}

bool isVariable(const JetColumn &column)
{
    return column.type == JetColumn::Text || column.type == JetColumn::Memo;
}

int sizeOf(const JetColumn &column)
{
    switch (column.type) {
    case JetColumn::Byte:
        return 1;
    case JetColumn::Int:
        return 2;
    case JetColumn::Long:
        return 4;
    case JetColumn::Double:
        return 8;
    default:
        return 0;
    }
}

// Where things stand in the pages of a generation.
struct Layout {
    int pageSize, rowCount, firstRow;                     // of data pages
    int rows, kind, columnCounts, maps, firstColumn;      // of the page of a table
    int columnSize, number, variable, flags, fixed, size; // of a column there
    int count;                                            // bytes of a number in a row
};
constexpr Layout layout3{2048, 8, 10, 12, 20, 21, 35, 43, 18, 1, 3, 13, 14, 16, 1};
constexpr Layout layout4{4096, 12, 14, 16, 40, 41, 55, 63, 25, 5, 7, 15, 21, 23, 2};

class Maker
{
public:
    explicit Maker(const JetHeader &header)
        : mHeader(header), mLayout(header.generation == 4 ? layout4 : layout3)
    {
        mPages.resize(3, QByteArray(mLayout.pageSize, 0)); // header, free pages, list of objects
    }

    QByteArray make(const std::vector<JetTable> &tables);

private:
    int addPage();
    int addDataPage(quint32 owner);
    int addRow(int page, const QByteArray &row, int mark = 0);
    void writeTable(int page, const JetTable &table);
    int writeMaps(const std::vector<int> &pages);
    std::vector<int> writeRows(int page, const JetTable &table);
    void writeColumns(int page, const JetTable &table);
    QByteArray number(int value) const
    {
        return mLayout.count == 1 ? little(quint8(value)) : little(quint16(value));
    }
    QByteArray rowOf(const JetTable &table, const QVariantList &values);
    QByteArray fixedValue(const JetColumn &column, const QVariant &value) const;
    QByteArray textBytes(const QVariant &value) const;
    QByteArray memoBytes(const QByteArray &text);
    QByteArray headerPage() const;

    const JetHeader mHeader;
    const Layout mLayout;
    std::vector<QByteArray> mPages;
};

int Maker::addPage()
{
    mPages.emplace_back(mLayout.pageSize, 0);
    return int(mPages.size()) - 1;
}

int Maker::addDataPage(quint32 owner)
{
    const int page = addPage();
    mPages[size_t(page)].replace(0, 2, "\1\1");
    put(mPages[size_t(page)], 4, owner);
    return page;
}

// Rows stand from the end of a page towards its beginning, where their places are. -1: no room.
int Maker::addRow(int page, const QByteArray &row, int mark)
{
    QByteArray &bytes = mPages[size_t(page)];
    const int rows = qFromLittleEndian<quint16>(bytes.constData() + mLayout.rowCount);
    const int places = mLayout.firstRow + 2 * rows;
    const int end = rows == 0 ? mLayout.pageSize
                              : qFromLittleEndian<quint16>(bytes.constData() + places - 2) & 0x1FFF;
    const int start = end - int(row.size());
    if (start < places + 2)
        return -1;
    bytes.replace(start, row.size(), row);
    put(bytes, places, quint16(start | mark));
    put(bytes, mLayout.rowCount, quint16(rows + 1));
    return rows;
}

QByteArray Maker::fixedValue(const JetColumn &column, const QVariant &value) const
{
    QByteArray bytes =
        column.type == JetColumn::Double ? little(value.toDouble()) : little(value.toLongLong());
    return bytes.left(sizeOf(column));
}

QByteArray Maker::textBytes(const QVariant &value) const
{
    if (value.typeId() == QMetaType::QByteArray)
        return value.toByteArray();
    const QString text = value.toString();
    if (mHeader.generation == 3)
        return text.toLatin1();
    const bool narrow = std::all_of(text.begin(), text.end(),
                                    [](QChar c) { return c.unicode() > 0 && c.unicode() < 256; });
    if (narrow && text.size() > 2)
        return "\xFF\xFE" + text.toLatin1();
    QByteArray wide;
    for (const QChar c : text)
        wide += little(c.unicode());
    return wide;
}

// In the row, or, longer ones, in a chain of pages, the last of which is made first.
QByteArray Maker::memoBytes(const QByteArray &text)
{
    constexpr quint32 here = 0x80000000;
    constexpr int longest = 1000;
    const auto size = quint32(text.size());
    if (text.size() <= longest)
        return little(here | size) + QByteArray(8, 0) + text;
    quint32 next = 0;
    for (auto at = (text.size() - 1) / longest * longest; at >= 0; at -= longest) {
        const int page = addDataPage(qFromLittleEndian<quint32>("LVAL"));
        const int row = addRow(page, little(next) + text.mid(at, longest));
        next = quint32(page) << 8 | quint32(row);
    }
    return little(size) + little(next) + QByteArray(4, 0);
}

QByteArray Maker::rowOf(const JetTable &table, const QVariantList &values)
{
    const auto count = int(table.columns.size());
    QByteArray row = number(count), mask((count + 7) / 8, 0), places;
    int variables = 0;
    for (const bool variable : {false, true}) {
        for (int i = 0; i < count; ++i) {
            const JetColumn &column = table.columns[size_t(i)];
            const QVariant &value = values[i];
            const bool marked = column.type == JetColumn::Bool ? value.toBool() : value.isValid();
            if (marked)
                mask[i / 8] = char(mask[i / 8] | 1 << i % 8);
            if (isVariable(column) != variable)
                continue;
            if (variable) {
                places.prepend(number(int(row.size())));
                ++variables;
            }
            if (!variable)
                row += fixedValue(column, value);
            else if (marked)
                row +=
                    column.type == JetColumn::Memo ? memoBytes(textBytes(value)) : textBytes(value);
        }
    }
    return row + number(int(row.size())) + places + number(variables) + mask;
}

std::vector<int> Maker::writeRows(int page, const JetTable &table)
{
    std::vector<int> pages;
    for (size_t i = 0; i < table.rows.size(); ++i) {
        const QByteArray row = rowOf(table, table.rows[i]);
        const int mark = i < table.marks.size() ? table.marks[i] : 0;
        if (pages.empty() || addRow(pages.back(), row, mark) < 0) {
            pages.push_back(addDataPage(quint32(page)));
            addRow(pages.back(), row, mark);
        }
    }
    return pages;
}

// Two rows that name pages of marks: the pages of the table, and those with room.
int Maker::writeMaps(const std::vector<int> &pages)
{
    constexpr int mapSize = 69, marksFrom = 4;
    const int marksOfPage = (mLayout.pageSize - marksFrom) * 8;
    QByteArray map(mapSize, 0);
    map[0] = 1;
    for (const int page : pages) {
        const int at = 1 + 4 * (page / marksOfPage), mark = page % marksOfPage;
        auto marks = qFromLittleEndian<quint32>(map.constData() + at);
        if (marks == 0) {
            marks = quint32(addPage());
            mPages[marks].replace(0, 2, "\5\1");
            put(map, at, marks);
        }
        char &byte = mPages[marks].data()[marksFrom + mark / 8];
        byte = char(byte | 1 << mark % 8);
    }
    const int page = addDataPage(1);
    addRow(page, map);
    addRow(page, QByteArray(1, 1) + QByteArray(mapSize - 1, 0));
    return page;
}

void Maker::writeColumns(int page, const JetTable &table)
{
    QByteArray columns, names;
    int fixed = 0, variables = 0, count = 0;
    for (const JetColumn &column : table.columns) {
        QByteArray entry(mLayout.columnSize, 0);
        entry[0] = char(column.type);
        put(entry, mLayout.number, quint16(count));
        put(entry, mLayout.number + 4, quint16(count++));
        put(entry, mLayout.variable, quint16(isVariable(column) ? variables++ : 0));
        entry[mLayout.flags] = char(isVariable(column) ? 2 : 3);
        put(entry, mLayout.fixed, quint16(fixed));
        put(entry, mLayout.size, quint16(isVariable(column) ? 510 : sizeOf(column)));
        fixed += sizeOf(column);
        columns += entry;
        QByteArray wide;
        for (const char c : column.name)
            wide.append(c).append(mLayout.count - 1, '\0');
        names += number(int(wide.size())) + wide;
    }
    columns += names;
    QByteArray &bytes = mPages[size_t(page)];
    put(bytes, mLayout.columnCounts, quint16(count));
    put(bytes, mLayout.columnCounts + 2, quint16(variables));
    put(bytes, mLayout.columnCounts + 4, quint16(count));
    bytes.replace(mLayout.firstColumn, columns.size(), columns);
}

void Maker::writeTable(int page, const JetTable &table)
{
    const auto rows = table.statedRows < 0 ? int(table.rows.size()) : table.statedRows;
    const int maps = writeMaps(writeRows(page, table));
    writeColumns(page, table);
    QByteArray &bytes = mPages[size_t(page)];
    bytes.replace(0, 2, "\2\1");
    put(bytes, 8, quint32(mLayout.pageSize));
    put(bytes, mLayout.rows, quint32(rows));
    bytes[mLayout.kind] = 'N';
    put(bytes, mLayout.maps, quint32(maps) << 8);
    put(bytes, mLayout.maps + 4, quint32(maps) << 8 | 1);
}

// Most of the header is hidden behind what one key gives, the password behind the date as well.
QByteArray Maker::headerPage() const
{
    QByteArray page(mLayout.pageSize, 0);
    page.replace(0, 20, QByteArray("\0\1\0\0Standard Jet DB\0", 20));
    page[0x14] = mHeader.generation == 4;
    put(page, 0x3C, quint16(1252));
    put(page, 0x3E, mHeader.key);
    page.replace(0x42, mHeader.password.size(), mHeader.password);
    if (mHeader.generation == 4) {
        constexpr double created = 38143.5;
        for (int i = 0; i < 40; ++i)
            page[0x42 + i] = char(page[0x42 + i] ^ int(created) >> 8 * (i % 4));
        put(page, 0x72, created);
    }
    const QByteArray mask = QByteArray::fromHex(
        "b56f03626108c255eba96772433f009c7a9f90ff809a31c579baed30bcdfcc9d63d9e4c37b42"
        "fb8abc4e86fbec375d449cfac65e28e613b68a6054947b36f572dfb177f41343cfafb1333461"
        "795b92b57c2a05f17c99011b98fd124f4a946c3e60265f95f8d089248567c61f2744d2eecf65"
        "edff07c746a178160cede92d62d4");
    for (int n = 0; n < (mHeader.generation == 4 ? 128 : 126); ++n)
        page[0x18 + n] = char(page[0x18 + n] ^ mask[n]);
    return page;
}

QByteArray Maker::make(const std::vector<JetTable> &tables)
{
    using enum JetColumn::Type;
    constexpr int listPage = 2;
    constexpr auto properties = JetColumn::Type(11);
    JetTable list{
        "MSysObjects",
        {{"Id", Long}, {"Name", Text}, {"Type", Int}, {"Flags", Long}, {"LvProp", properties}},
        {}};
    list.rows.push_back({listPage, u"MSysObjects"_s, 1, qint64(0x80000000), {}});
    for (const JetTable &table : tables) {
        const int page = addPage();
        writeTable(page, table);
        list.rows.push_back({page, QString::fromLatin1(table.name), 1, 0, {}});
    }
    writeTable(listPage, list);
    mPages[0] = headerPage();
    QByteArray file;
    for (const QByteArray &page : mPages)
        file += page;
    return file;
}

} // namespace

QByteArray jetFile(const std::vector<JetTable> &tables, const JetHeader &header)
{
    return Maker(header).make(tables);
}

// Some columns in another order and another spelling than the statements have.
std::vector<JetTable> emptyOldCatalogue()
{
    const auto table = [](const QByteArray &name, const QByteArray &columns) {
        JetTable empty{name, {}, {}};
        for (const QByteArray &column : columns.split(' ')) // "ID:4"
            empty.columns.push_back(
                {column.split(':')[0], JetColumn::Type(column.split(':')[1].toInt())});
        return empty;
    };
    return {table("ARTIESTEN", "Naam:10 ID:4"),
            table("Tracks", "ID:4 artiest_id:4 Titel:10 Genre:10 Hitjaar:3"),
            table("CDTitels", "ID:4 Titel:12 Artiest_ID:4 CD_Type:10 Genre:10 Hitjaar:7"),
            table("CompactDiscs", "ID:4 CDTitels_ID:4 Opmerking:10 DiskNo:2 TrackNo:3 Track_ID:4"),
            table("MP3Collections", "ID:4 Map:10 Album:10"),
            table("MP3Files", "ID:4 Volgnummer:4 FileName:10 CollectionId:4")};
}

std::vector<JetTable> oldCatalogue()
{
    auto tables = emptyOldCatalogue();
    const QVariant null;
    tables[0].rows = {{u"Guns N' Roses"_s, 3}, {u"Édith Piaf"_s, 7}};
    tables[1].rows = {{5, 3, u"November Rain"_s, u"Rock"_s, 1992},
                      {6, 7, u"Milord"_s, null, null},
                      {9, 7, u"No \"1\"\\\t%_"_s, u""_s, 0}};
    tables[2].rows = {{2, u"Use Your Illusion"_s, 3, u"E"_s, null, 1991.0},
                      {4, u"Mix"_s, null, u"V"_s, u"Pop"_s, null}};
    tables[3].rows = {
        {1, 2, u"scratched"_s, 1, 1, 5}, {2, 4, null, 2, 12, 6}, {3, 4, null, 2, 13, 9}};
    tables[4].rows = {{1, u"D:\\Muziek\\Pop"_s, u"Pop"_s}};
    tables[5].rows = {{8, 1, u"Café.mp3"_s, 1}};
    return tables;
}
