#include "catalogue/cataloguefile.h"

#include "catalogue/schemacheck.h"
#include "platform/ado/connection.h"
#include "platform/ado/engineerror.h"
#include "platform/ado/sqlfunctions.h"
#include "platform/text/collation.h"
#include "services/messages.h"

#include <QFile>
#include <QFileInfo>
#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace cataloguefile
{

namespace
{

// Text columns carry the collation, so that each comparison and each index of theirs goes by it.
// CD_Type is one of two letters and is compared without. Indexes stand on every column that
// statements search or join by; further columns behind those spare the lists of the browser and the
// search the way to the rows.
constexpr char schema[] = R"sql(
create table Artiesten(ID integer primary key, Naam text collate SONGCASE);
create table Tracks(ID integer primary key, Artiest_ID integer, Titel text collate SONGCASE,
                    Genre text collate SONGCASE, Hitjaar integer);
create table CDTitels(ID integer primary key, Titel text collate SONGCASE, Artiest_ID integer,
                      CD_Type text collate NOCASE, Genre text collate SONGCASE, Hitjaar integer);
create table CompactDiscs(ID integer primary key, CDTitels_ID integer, DiskNo integer,
                          TrackNo integer, Track_ID integer, Opmerking text collate SONGCASE);
create table MP3Collections(ID integer primary key, Map text collate SONGCASE,
                            Album text collate SONGCASE);
create table MP3Files(ID integer primary key, Volgnummer integer, FileName text collate SONGCASE,
                      CollectionId integer);
create index ArtiestenNaam on Artiesten(Naam);
create index TracksArtiest on Tracks(Artiest_ID, Titel, Genre, Hitjaar);
create index CDTitelsArtiest on CDTitels(Artiest_ID, Titel);
create index CDTitelsTitel on CDTitels(Titel, CD_Type, Artiest_ID);
create index CompactDiscsTitel on CompactDiscs(CDTitels_ID, DiskNo, TrackNo);
create index CompactDiscsTrack on CompactDiscs(Track_ID, CDTitels_ID, DiskNo, TrackNo);
create index MP3FilesCollection on MP3Files(CollectionId, Volgnummer);
)sql";

// What the engine is to believe of the sizes: rows, then how many of them share the first column of
// an index, the first two and so on. Told once, this gives the same plans for every catalogue and
// each day. The numbers were found by trial on made-up catalogues of 3,000 and of 100,000 discs and
// are not quite the shape of either: with these a search begins with the artists if it asks for
// one, with the tracks if it asks for something of theirs, and with the discs if it asks for
// nothing or for a span of years alone, each the fastest way; without them a search for an artist
// reads all discs. To find better ones: bench/trystatistics.py moves one number after the other and
// tells what becomes of the plans and the times.
constexpr char statistics[] = R"sql(
analyze;
insert into sqlite_stat1(tbl, idx, stat) values
    ('Artiesten', 'ArtiestenNaam', '10000 1'),
    ('Tracks', 'TracksArtiest', '40000 20 1 1 1'),
    ('CDTitels', 'CDTitelsArtiest', '2500 2 1'),
    ('CDTitels', 'CDTitelsTitel', '2500 1 1 1'),
    ('CompactDiscs', 'CompactDiscsTitel', '25000 20 15 1'),
    ('CompactDiscs', 'CompactDiscsTrack', '25000 1 1 1 1'),
    ('MP3Files', 'MP3FilesCollection', '2000 12 1');
)sql";

// Compared through, each index with its table, this takes a quarter of a second; a look at how the
// pages hang together is ten times as quick and is taken at any size.
constexpr qint64 quicklyCompared = 16 << 20;

int currentVersion()
{
    return formatVersion << 24 | int(text::Collation::root().version() & 0xFFFFFF);
}

QByteArray pragma(const char *name, int value)
{
    return QByteArray("PRAGMA ") + name + '=' + QByteArray::number(value);
}

} // namespace

void create(const QString &file)
{
    if (QFile::exists(file))
        throw ADODB::engineError(SQLITE_CANTOPEN, file);
    sqlite3 *db = nullptr;
    int code = sqlite3_open(file.toUtf8().constData(), &db);
    if (code == SQLITE_OK)
        code = ADODB::registerFunctions(db);
    const auto run = [&](const char *sql) {
        if (code == SQLITE_OK)
            code = sqlite3_exec(db, sql, nullptr, nullptr, nullptr);
    };
    run("begin");
    run(pragma("application_id", applicationId).constData());
    run(pragma("user_version", currentVersion()).constData());
    run(schema);
    run(statistics);
    run("commit");
    sqlite3_close(db);
    if (code != SQLITE_OK) {
        QFile::remove(file); // a half one must not be taken for a catalogue
        throw ADODB::engineError(code, file);
    }
}

namespace
{

void requireSound(ADODB::Connection &connection, bool thorough)
{
    const char *check = thorough ? "PRAGMA integrity_check(1)" : "PRAGMA quick_check(1)";
    if (connection.housekeeping(check) != "ok"_L1)
        throw Error(errCannotUse, u"Songcase"_s, GetMessage("xDamaged"));
}

bool quicklyComparable(const ADODB::Connection &connection)
{
    const QFileInfo file(ADODB::Connection::dataSource(connection.ConnectionString));
    return file.size() <= quicklyCompared;
}

// Indexes and statistics that an older version made, or none; another version of the sort order.
QByteArray remedyFor(ADODB::Connection &connection)
{
    QByteArray remedy = schemacheck::compare(connection, QByteArray(schema) + statistics);
    if (connection.housekeeping("PRAGMA user_version").toInt() != currentVersion())
        remedy += "REINDEX SONGCASE;" + pragma("user_version", currentVersion());
    return remedy;
}

} // namespace

void verify(ADODB::Connection &connection, bool thorough)
{
    // Fails here and not at the first change if another program holds the file.
    ADODB::Transaction transaction(connection);
    if (const QByteArray remedy = remedyFor(connection); !remedy.isEmpty()) {
        requireSound(connection, false);
        connection.housekeeping(remedy.constData());
    }
    requireSound(connection, thorough || quicklyComparable(connection));
    transaction.CommitTrans();
    // Another program may have left it in a mode that keeps files beside it.
    connection.housekeeping("PRAGMA journal_mode=DELETE");
}

} // namespace cataloguefile
