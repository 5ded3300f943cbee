#include "catalogue/cataloguefile.h"

#include "platform/ado/engineerror.h"
#include "platform/ado/recordset.h"
#include "platform/ado/sqlfunctions.h"
#include "platform/text/collation.h"
#include "services/messages.h"

#include <QFile>
#include <QFileInfo>
#include <QtEndian>
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
// each day. Not quite a collection's shape: with these a search begins with the artists if it asks
// for one, with the tracks if it asks for something of theirs, and with the discs if it asks for
// nothing, each the fastest way; without them a search for an artist reads all discs.
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

constexpr const char *tables[] = {"Artiesten",    "Tracks",         "CDTitels",
                                  "CompactDiscs", "MP3Collections", "MP3Files"};

// A catalogue of this size is checked through in a few milliseconds, so each start does it.
constexpr qint64 quicklyChecked = 8 << 20;

constexpr qsizetype headerSize = 100;
constexpr qsizetype versionOffset = 60, applicationOffset = 68;

int currentVersion()
{
    return formatVersion << 24 | int(text::Collation::root().version() & 0xFFFFFF);
}

QByteArray pragma(const char *name, int value)
{
    return QByteArray("PRAGMA ") + name + '=' + QByteArray::number(value);
}

[[noreturn]] void refuse(ErrorNumber number, const char *key)
{
    throw Error(number, u"Songcase"_s, GetMessage(key));
}

bool mayBeWritten(const QFileInfo &file)
{
    // The bits are looked at as well: some users the system does not stop, and "WriteUser" says so.
    constexpr auto anyWrite = QFile::WriteOwner | QFile::WriteGroup | QFile::WriteOther;
    const QFileInfo folder(file.absolutePath());
    return file.isWritable() && (file.permissions() & anyWrite) && folder.isWritable() &&
           (folder.permissions() & anyWrite);
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

void inspect(const QString &name)
{
    const QFileInfo info(name);
    QFile file(name);
    if (info.isDir())
        refuse(errCannotUse, "xNotACatalogue");
    if (!file.open(QIODevice::ReadOnly))
        throw ADODB::engineError(SQLITE_CANTOPEN, file.errorString());
    const QByteArray header = file.read(headerSize);
    const bool database = header.size() == headerSize && header.startsWith("SQLite format 3");
    if (!database ||
        qFromBigEndian<qint32>(header.constData() + applicationOffset) != applicationId)
        refuse(errCannotUse, "xNotACatalogue");
    if (qFromBigEndian<quint32>(header.constData() + versionOffset) >> 24 > quint32(formatVersion))
        refuse(errCannotUse, "xNewerCatalogue");
    if (!mayBeWritten(info))
        refuse(errReadOnly, "xReadOnly");
}

namespace
{

void requireTables(ADODB::Connection &connection)
{
    ADODB::Recordset names;
    names.Open(u"select name as Name from sqlite_schema where type='table'"_s, connection);
    QStringList found;
    for (; !names.isEOF(); names.MoveNext())
        found.append(names.Fields(0).Value().toText().toLower());
    for (const char *table : tables) {
        if (!found.contains(QLatin1String(table).toString().toLower()))
            refuse(errCannotUse, "xTablesMissing");
    }
}

void keepSortOrder(ADODB::Connection &connection)
{
    if (connection.housekeeping("PRAGMA user_version").toInt() == currentVersion())
        return;
    ADODB::Transaction transaction(connection);
    connection.housekeeping("REINDEX SONGCASE");
    connection.housekeeping(pragma("user_version", currentVersion()).constData());
    transaction.CommitTrans();
}

} // namespace

void verify(ADODB::Connection &connection, bool thorough)
{
    // Fails here and not at the first change if another program holds the file.
    {
        ADODB::Transaction probe(connection);
        probe.RollbackTrans();
    }
    requireTables(connection);
    const QFileInfo file(ADODB::Connection::dataSource(connection.ConnectionString));
    const bool check = thorough || file.size() <= quicklyChecked;
    if (check && connection.housekeeping("PRAGMA quick_check(1)") != "ok"_L1)
        refuse(errCannotUse, "xDamaged");
    // Another program may have left it in a mode that keeps files beside it.
    connection.housekeeping("PRAGMA journal_mode=DELETE");
    keepSortOrder(connection);
}

} // namespace cataloguefile
