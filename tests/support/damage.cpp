#include "support/damage.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/cleanorphans.h"
#include "platform/ado/connection.h"
#include "services/globals.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <random>
#include <sqlite3.h>

namespace damage
{

namespace
{

constexpr qsizetype pageSize = 4096;

// Closes every box.
class PatientDesktop : public ScriptedDesktop
{
public:
    BoxAnswer messageBox(BoxKind, BoxButtons, const QString &text, const QString &) override
    {
        boxes.append(text);
        return vbOK;
    }
};

// Every row of the four tables that the clean-up knows, as far as it can be read without an index.
QSet<QString> rowsOf(const QByteArray &bytes)
{
    const QTemporaryDir folder;
    const OtherProgram reader(writeFile(folder.filePath(u"copy"_s), bytes));
    QSet<QString> rows;
    const auto take = [](void *to, int columns, char **values, char **) {
        QString row;
        for (int i = 0; i < columns; ++i)
            row += QString::fromUtf8(values[i] ? values[i] : "NULL") + u'|';
        static_cast<QSet<QString> *>(to)->insert(row);
        return 0;
    };
    for (const QByteArray table : {"Artiesten", "Tracks", "CDTitels", "CompactDiscs"}) {
        const QByteArray all = "select '" + table + "', * from " + table + " not indexed";
        sqlite3_exec(reader.db, all.constData(), take, &rows, nullptr);
    }
    return rows;
}

// The program's own look at a file of this size; true if it may be worked with.
bool passes(const QString &file, Size size)
{
    cataloguefile::inspect(file);
    openConnection(file);
    if (size == Size::Large)
        return gConnection->housekeeping("PRAGMA quick_check(1)") == "ok"_L1;
    cataloguefile::verify(*gConnection, true);
    return true;
}

QSet<QString> orphans()
{
    static const QSet<QString> rows = [] {
        const QTemporaryDir folder;
        PatientDesktop desktop;
        const QString file = writeFile(folder.filePath(u"Compact4.orv"_s), wholeCatalogue());
        openConnection(file);
        CleanOrphans();
        gConnection.reset();
        return rowsOf(wholeCatalogue()) - rowsOf(readFile(file));
    }();
    return rows;
}

} // namespace

const QByteArray &wholeCatalogue()
{
    static const QByteArray bytes = [] {
        const TestCatalogue catalogue;
        // 100 discs of 20 tracks each, three artists on a disc; every fiftieth track has no disc.
        gConnection->housekeeping(
            "begin; with recursive n(i) as (select 1 union all select i+1 from n where i<2000) "
            "insert into Tracks select i, i*7%300+1, 'Title '||(i*37%2000), 'Genre', 1960+i%60 "
            "from n;"
            "insert into Artiesten select distinct Artiest_ID, 'Artist '||Artiest_ID from Tracks;"
            "insert into Artiesten values (1000, 'Nobody');"
            "insert into CDTitels select ID, 'Disc '||(ID*37%100), iif(ID%2,ID,null), "
            "iif(ID%2,'E','V'), null, null from Tracks where ID<=100;"
            "insert into CompactDiscs select ID, (ID-1)/20+1, 1, (ID-1)%20+1, ID, null "
            "from Tracks where ID%50;"
            "commit");
        return readFile(catalogue.file());
    }();
    return bytes;
}

QByteArray damagedCatalogue(unsigned number)
{
    QByteArray bytes = wholeCatalogue();
    std::mt19937 random(number);
    const auto below = [&](qsizetype limit) { return qsizetype(random() % std::size_t(limit)); };
    const qsizetype pages = bytes.size() / pageSize;
    qsizetype page = below(pages);
    constexpr char indexLeaf = 10;
    for (int tries = 0; random() % 2 && bytes[page * pageSize] != indexLeaf && tries < 1000;
         ++tries)
        page = below(pages);
    const qsizetype at = page * pageSize + below(pageSize);
    switch (number % 4) {
    case 0: // a bit
        bytes[at] = char(bytes[at] ^ (1 << below(8)));
        break;
    case 1: // a byte
        bytes[at] = char(random());
        break;
    case 2: { // a stretch that was never written
        const qsizetype size = std::min(1 + below(64), bytes.size() - at);
        bytes.replace(at, size, QByteArray(size, 0));
        break;
    }
    default: { // a page that went to another's place
        const QByteArray other = bytes.mid(below(pages) * pageSize, pageSize);
        bytes.replace(page * pageSize, pageSize, other);
    }
    }
    return bytes;
}

Outcome startAndEnd(const QByteArray &catalogue, Size size)
{
    const QTemporaryDir folder;
    PatientDesktop desktop;
    const QString file = writeFile(folder.filePath(u"Compact4.orv"_s), catalogue);
    Outcome outcome;
    try {
        outcome.opened = passes(file, size);
        if (outcome.opened)
            CleanOrphans();
    } catch (const Error &) {
    }
    gConnection.reset();
    outcome.toldWhileCleaning = !desktop.boxes.isEmpty();
    outcome.lost = rowsOf(catalogue) - rowsOf(readFile(file)) - orphans();
    return outcome;
}

} // namespace damage
