// Label: unit
#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/ordinaryuser.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QtEndian>
#include <csignal>
#include <sqlite3.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace
{

// Enough rows that every table and index has pages of its own.
constexpr char someRows[] =
    "with recursive n(i) as (select 1 union all select i+1 from n where i<1000) "
    "insert into tracks select i, i, 'title '||i, 'genre', 1985 from n;"
    "insert into artiesten select id, 'artist '||id from tracks;";

} // namespace

/// The file itself: a new one, wrong ones of every kind, one left behind by a crash.
class tst_CatalogueFile : public QObject
{
    Q_OBJECT

private:
    using Harm = std::function<void(const QString &file)>;
    using Snapshot = QMap<QString, QByteArray>;
    // Of all files in the folder.
    Snapshot snapshot() const
    {
        Snapshot all;
        for (const QString &name : QDir(folder()).entryList(QDir::Files | QDir::Hidden))
            all[name] = readFile(folder() + u'/' + name);
        return all;
    }

    void exec(const QByteArray &sql)
    {
        const OtherProgram raw(file());
        QVERIFY2(raw.run(sql) == SQLITE_OK, sqlite3_errmsg(raw.db));
    }

    // Opens it as the program does; gives what is told to the user, nothing if it went well.
    QString opening(bool thorough = true)
    {
        try {
            cataloguefile::inspect(file());
            openConnection(file());
            cataloguefile::verify(*gConnection, thorough);
            return {};
        } catch (const Error &error) {
            return error.Description;
        }
    }

    void opensUnchanged()
    {
        const auto before = snapshot();
        QCOMPARE(opening(), QString());
        gConnection.reset();
        QCOMPARE(snapshot(), before);
    }

    QString folder() const { return mTemporary->filePath(u"data"_s); }
    QString file() const { return folder() + u"/Compact4.orv"_s; }

    std::unique_ptr<QTemporaryDir> mTemporary;

private slots:
    void init()
    {
        mTemporary = std::make_unique<QTemporaryDir>();
        QFile::setPermissions(mTemporary->path(), QFile::Permissions(0x7777));
        QDir().mkpath(folder());
        cataloguefile::create(file());
        exec(someRows);
    }

    void cleanup() { gConnection.reset(); }

    void newOne()
    {
        QFile::remove(file());
        cataloguefile::create(file());
        QCOMPARE(QDir(folder()).entryList(QDir::Files).size(), 1);
        QCOMPARE(opening(), QString());
        QCOMPARE(gConnection->housekeeping("PRAGMA application_id"), u"1399811687"_s);
        QCOMPARE(gConnection->housekeeping("PRAGMA user_version").toInt() >> 24, 4);
        QCOMPARE(gConnection->housekeeping("PRAGMA encoding"), u"UTF-8"_s);
    }

    void syncsTheFolderToo()
    {
        ADODB::Connection connection;
        configureConnection(connection, file());
        connection.Open();
        QCOMPARE(connection.housekeeping("PRAGMA synchronous"), u"3"_s); // EXTRA
    }

    void makesNoneOverAnother()
    {
        const auto before = snapshot();
        QVERIFY_EXCEPTION_THROWN(cataloguefile::create(file()), Error);
        QCOMPARE(snapshot(), before);
        const QString nowhere = folder() + u"/none/Compact4.orv"_s;
        QVERIFY_EXCEPTION_THROWN(cataloguefile::create(nowhere), Error);
        QVERIFY(!QFile::exists(nowhere));
    }

    void runsNothingOfTheFile()
    {
        exec("create table seen(x); create trigger t after insert on artiesten begin "
             "insert into seen values (1); end; create view v as select 1 as x");
        openConnection(file());
        gConnection->Execute(u"insert into artiesten values (2000,'new')"_s);
        QCOMPARE(gConnection->housekeeping("select count(*) from seen"), u"0"_s);
        QVERIFY(numberOf([] { gConnection->Execute(u"select x from v"_s); }) != 0);
    }

    void preparedByOthers_data()
    {
        const DataRows<QString, QString> row("made", "told");
        const auto again = [&](const char *name, const char *table, const QString &columns,
                               const AnyText &told = {"table MP3Files"}) {
            row(name, u"drop table %1; create table %1(%2)"_s.arg(QLatin1String(table), columns),
                told);
        };
        row("trigger",
            "create trigger artiesten after delete on Tracks begin delete from Artiesten; end",
            "trigger artiesten");
        row("table", "create table more(x)", "table more");
        row("index with a condition",
            "drop index ArtiestenNaam; create index ArtiestenNaam on Artiesten(Naam) where ID>5",
            "index ArtiestenNaam");
        row("view for a table", "drop table MP3Files; create view MP3Files as select 1 as ID",
            "view MP3Files");
        row("further column", "alter table Tracks add column Map text", "table Tracks");
        row("generated column", "alter table Tracks add column g as (ID+1)", "table Tracks");
        const QString rest = u"Volgnummer integer, FileName text collate SONGCASE, "
                             "CollectionId integer"_s;
        again("condition", "MP3Files", u"ID integer primary key check(ID<9), "_s + rest);
        again("default", "MP3Files", u"ID integer primary key, "_s + rest + u" default 1"_s);
        again("other key", "Artiesten", u"ID integer, Naam text collate SONGCASE primary key"_s,
              "index sqlite_autoindex_Artiesten_1");
        again("other order of letters", "Artiesten", u"ID integer primary key, Naam text"_s,
              "table Artiesten");
        again("other type", "Artiesten", u"ID integer primary key, Naam integer collate SONGCASE"_s,
              "table Artiesten");
    }

    void preparedByOthers()
    {
        QFETCH(QString, made);
        QFETCH(QString, told);
        exec(made.toUtf8());
        const auto before = snapshot();
        const QString said = opening();
        gConnection.reset();
        QVERIFY2(said.contains("not made by this program"_L1) && said.endsWith(told),
                 qPrintable(said));
        QCOMPARE(snapshot(), before);
    }

    // Made by another tool or an older version: it holds the same tables.
    void putsRight_data()
    {
        const DataRows<QString> row("made");
        row("no index", "drop index TracksArtiest; drop index MP3FilesCollection");
        row("older indexes", "drop index CompactDiscsTrack; "
                             "create index CompactDiscsTrack on CompactDiscs(Track_ID)");
        row("no statistics", "drop table sqlite_stat1");
        row("others' statistics", "analyze");
    }

    void putsRight()
    {
        const auto shape = [this] {
            const OtherProgram other(file());
            QStringList all;
            const auto take = [](void *to, int, char **values, char **) {
                static_cast<QStringList *>(to)->append(QLatin1String(values[0]));
                return 0;
            };
            sqlite3_exec(other.db,
                         "select type||name||sql from sqlite_schema union all "
                         "select tbl||idx||stat from sqlite_stat1 order by 1",
                         take, &all, nullptr);
            return all;
        };
        const QStringList asNew = shape();
        QFETCH(QString, made);
        exec(made.toUtf8());
        QVERIFY(shape() != asNew);
        QCOMPARE(opening(), QString());
        QCOMPARE(gConnection->housekeeping("PRAGMA integrity_check"), u"ok"_s);
        gConnection.reset();
        QCOMPARE(shape(), asNew);
        opensUnchanged(); // once, not at every start
    }

    void takesTheSameTablesWrittenOtherwise()
    {
        exec("drop table MP3Collections; create table \"mp3collections\" ([id] INTEGER,\n"
             "\t`Map` TEXT COLLATE songcase, 'Album' text collate SONGCASE, PRIMARY KEY(\"id\"))");
        opensUnchanged();
    }

    // A hot journal, the last change of which was one over several files.
    void journalThatNamesAnother()
    {
        const QString victim = writeFile(folder() + u"/letter.txt"_s, "dear"),
                      journal = file() + u"-journal"_s;
        const auto number = [](quint32 n) {
            return QByteArray(reinterpret_cast<const char *>(&(n = qToBigEndian(n))), 4);
        };
        const QByteArray mark = QByteArray::fromHex("d9d505f920a163d7"), name = victim.toUtf8();
        const auto pages = quint32(QFileInfo(file()).size() / 4096);
        quint32 sum = 0;
        for (const char c : name)
            sum += quint32(c);
        const QByteArray header =
            mark + number(0) + number(0) + number(pages) + number(512) + number(4096);
        writeFile(journal, header.leftJustified(512, 0) + number((1 << 30) / 4096 + 1) + name +
                               number(quint32(name.size())) + number(sum) + mark);
        const auto before = snapshot();
        QVERIFY2(opening().endsWith(journal), "named");
        gConnection.reset();
        QCOMPARE(snapshot(), before);
        // What it would have been good for.
        exec("select * from Artiesten");
        QVERIFY(!QFile::exists(victim));
    }

    void pipes_data()
    {
        const DataRows<QString, QString> row("end", "told");
        row("catalogue", "", "not a catalogue");
        row("journal", "-journal", "-journal");
        row("log", "-wal", "-wal");
    }

    // To open one is to wait for ever.
    void pipes()
    {
        QFETCH(QString, end);
        const QByteArray name = (file() + end).toUtf8();
        QFile::remove(file() + end);
        QCOMPARE(mkfifo(name.constData(), 0600), 0);
        alarm(20);
        const QString said = opening();
        alarm(0);
        QFETCH(QString, told);
        QVERIFY2(said.contains(told), qPrintable(said));
    }

    void wrongOnes_data()
    {
        const DataRows<Harm, QString> row("harm", "told");
        const auto resized = [](int percent) {
            return [=](const QString &f) { QFile::resize(f, QFileInfo(f).size() * percent / 100); };
        };
        const auto rights = [](int them) {
            return [=](const QString &f) { QFile::setPermissions(f, QFile::Permissions(them)); };
        };
        const auto changed = [this](const char *sql) {
            return [=, this](const QString &) { exec(sql); };
        };
        const auto gone = [](const QString &f) { QFile::remove(f); };
        const auto folder = [](const QString &f) { return QFile::remove(f) && QDir().mkpath(f); };
        const auto foreign = [this](const QString &f) {
            QFile::remove(f);
            exec("create table artiesten(id)");
        };
        row("empty", resized(0), "not a catalogue");
        row("folder", folder, "not a catalogue");
        row("database of another program", foreign, "not a catalogue");
        row("not there", gone, "cannot be opened");
        row("no rights", rights(0), "cannot be opened");
        row("newer", changed("pragma user_version=83886080"), "newer version"); // 5 << 24
        row("table missing", changed("drop table MP3Files"), "table is missing: MP3Files");
        const auto index = [](const QString &f) { // no page of it is: a name is another one there
            QByteArray bytes = readFile(f);
            const auto at = bytes.lastIndexOf("artist 777");
            writeFile(f, bytes.replace(at, 10, "artist 778"));
        };
        row("index damaged", index, "damaged");
        row("half", resized(50), "damaged");
        const auto schema = [](const QString &f) {
            writeFile(f, readFile(f).replace(100, 3996, QByteArray(3996, '\x5A')));
        };
        row("garbage schema", schema, "damaged");
        row("read-only", rights(0x4444), "read-only");
        row(
            "read-only folder", [=](const QString &f) { rights(0x5555)(QFileInfo(f).path()); },
            "read-only");
    }

    void wrongOnes()
    {
        QFETCH(Harm, harm);
        harm(file());
        const auto before = snapshot();
        QString said;
        {
            const bool noRights = !(QFile::permissions(file()) & QFile::ReadOwner);
            const auto user = noRights ? std::make_unique<OrdinaryUser>() : nullptr;
            said = opening();
            gConnection.reset();
        }
        const auto after = snapshot();
        QFile::setPermissions(folder(), QFile::Permissions(0x7700));
        QFETCH(QString, told);
        QVERIFY2(said.contains(told), qPrintable(said));
        QCOMPARE(after, before);
    }

    // The program is killed in the middle of a large change that has reached the file in part.
    void survivesACrash()
    {
        const auto before = snapshot();
        const pid_t child = fork();
        QVERIFY(child >= 0);
        if (child == 0) {
            const OtherProgram raw(file());
            raw.run("pragma cache_size=5; begin; update tracks set titel='changed'; delete from "
                    "artiesten");
            kill(getpid(), SIGKILL);
        }
        int status = 0;
        QCOMPARE(waitpid(child, &status, 0), child);
        QVERIFY(WIFSIGNALED(status));
        const auto crashed = snapshot();
        QVERIFY(crashed.size() == 2 && crashed[u"Compact4.orv"_s] != before.first());
        QCOMPARE(opening(), QString());
        gConnection.reset();
        QCOMPARE(snapshot(), before); // every byte is back, and no journal beside it
    }

    void sortOrderOfAnotherVersion()
    {
        {
            const OtherProgram other(file());
            const auto bytewise = [](void *, int n, const void *a, int m, const void *b) {
                const int c = memcmp(a, b, std::size_t(std::min(n, m)));
                return c ? c : n - m;
            };
            sqlite3_create_collation(other.db, "SONGCASE", SQLITE_UTF8, nullptr, bytewise);
            QCOMPARE(other.run("insert into artiesten values (2001,'Zappa'),(2002,'abba'),"
                               "(2003,'Abc'),(2004,'zz'); pragma user_version=67108865"),
                     SQLITE_OK);
        }
        const auto found = [] {
            ADODB::Recordset rs;
            rs.Open(
                u"Select ID From Artiesten where Naam in ('ZAPPA','abba','ABC','Zz','Artist 7')"_s,
                *gConnection);
            return int(rs.RecordCount());
        };
        openConnection(file());
        QVERIFY(found() < 5);
        QCOMPARE(opening(), QString());
        QCOMPARE(found(), 5);
        gConnection.reset();
        opensUnchanged(); // once, not at every start
    }
};

QTEST_GUILESS_MAIN(tst_CatalogueFile)
#include "tst_CatalogueFile.moc"
