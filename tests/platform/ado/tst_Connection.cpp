// Label: unit
#include "catalogue/errorboxes.h"
#include "platform/ado/dialect.h"
#include "platform/ado/recordset.h"
#include "platform/ado/sqlfunctions.h"
#include "shell/services/globals.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QElapsedTimer>
#include <QTest>
#include <sqlite3.h>

using namespace ADODB;

/// The connection to a real file: values on their way in and out, transactions, failures.
class tst_Connection : public QObject
{
    Q_OBJECT

private slots:
    void keepsValues_data();
    void keepsValues();
    void findsText_data();
    void findsText();
    void bindsAgain();
    void refusedStatementsChangeNothing_data();
    void refusedStatementsChangeNothing();
    void commitsAndRollsBack();
    void joinedRoutineTakesBackItsOwn();
    void abandonedTransaction_data();
    void abandonedTransaction();
    void handlerInsideARunningRoutine();
    void failedCommit();
    void fateOfATransaction();
    void firstRowsReadsNoMore();
    void engineRollsBackByItself_data();
    void engineRollsBackByItself();
    void closesWithOpenTransaction();
    void errorsHoldTheLastFailure();
    void lockedByAnotherProgram();
    void readOnlyFile();
    void tablesChangeUnderneath();
    void opensWhatIsNamed();
    void nextIdReadsAnIndex_data();
    void nextIdReadsAnIndex();
};

namespace
{

void addArtist(int id, const char *name = "x")
{
    gConnection->Execute(QStringLiteral("Insert into Artiesten(ID,Naam) values (%1,'%2')")
                             .arg(QString::number(id), QString::fromUtf8(name)));
}

Value single(const QString &statement)
{
    Recordset rs;
    rs.Open(statement, *gConnection);
    return rs.Fields(0).Value();
}

int artists()
{
    return int(single(QStringLiteral("select count(*) from artiesten")).toLong());
}

int numberOf(const std::function<void()> &fails)
{
    try {
        fails();
    } catch (const Error &error) {
        return error.Number;
    }
    return 0;
}

// Another program at the same file.
struct OtherProgram {
    explicit OtherProgram(const QString &file)
    {
        sqlite3_open(file.toUtf8().constData(), &db);
        registerFunctions(db);
    }
    ~OtherProgram() { sqlite3_close(db); }
    int run(const char *sql) { return sqlite3_exec(db, sql, nullptr, nullptr, nullptr); }
    sqlite3 *db = nullptr;
};

} // namespace

void tst_Connection::keepsValues_data()
{
    QTest::addColumn<QString>("literal");
    QTest::addColumn<QString>("type");
    QTest::addColumn<QString>("text");
    const auto row = [](const char *literal, const char *type, const QString &text) {
        QTest::newRow(literal) << QString::fromUtf8(literal) << QString::fromLatin1(type) << text;
    };
    row("'1e10'", "text", QStringLiteral("1e10"));
    row("1e10", "real", QStringLiteral("10000000000"));
    row("'007'", "text", QStringLiteral("007"));
    row("1985", "integer", QStringLiteral("1985"));
    row("-9223372036854775807", "integer", QStringLiteral("-9223372036854775807"));
    row("1.5", "real", QStringLiteral("1.5"));
    row("''", "text", QString());
    row("NULL", "null", QString());
    row("'d''Arc'", "text", QStringLiteral("d'Arc"));
    row("'\xF0\x9F\x8E\xB5 Cafe\xCC\x81'", "text", QStringLiteral("\U0001F3B5 Caf\u00e9"));
    QTest::newRow("NUL") << QStringLiteral("'a") + QChar(0) + QStringLiteral("b'")
                         << QStringLiteral("text") << QStringLiteral("a") + QChar(0) + u'b';
    QTest::newRow("long") << QLatin1Char('\'') + QString(3 << 20, u'\u00e9') + QLatin1Char('\'')
                          << QStringLiteral("text") << QString(3 << 20, u'\u00e9');
}

void tst_Connection::keepsValues()
{
    QFETCH(QString, literal);
    TestCatalogue catalogue;
    catalogue.exec(QStringLiteral("create table loose(v)"));
    gConnection->Execute(QStringLiteral("insert into loose values (") + literal +
                         QStringLiteral(")"));
    QTEST(single(QStringLiteral("select typeof(v) from loose")).toText(), "type");
    const Value v = single(QStringLiteral("select v from loose"));
    QTEST(v.toText(), "text");
    QCOMPARE(v.isNull(), literal == QLatin1String("NULL"));
    QCOMPARE(artists(), 0);
}

void tst_Connection::findsText_data()
{
    QTest::addColumn<QString>("stored");
    QTest::addColumn<QString>("asked");
    QTest::addColumn<bool>("found");
    QTest::newRow("case") << QStringLiteral("Björk") << QStringLiteral("BJÖRK") << true;
    QTest::newRow("greek case") << QStringLiteral("Βαγγέλης") << QStringLiteral("ΒΑΓΓΈΛΗΣ") << true;
    QTest::newRow("accent") << QStringLiteral("Édith") << QStringLiteral("Edith") << false;
    QTest::newRow("decomposed") << QStringLiteral("Édith") << QStringLiteral("E\u0301dith") << true;
    QTest::newRow("blank behind") << QStringLiteral("Abba") << QStringLiteral("Abba ") << false;
    QTest::newRow("apostrophe") << QStringLiteral("d''Arc") << QStringLiteral("D''ARC") << true;
    QTest::newRow("digits are a text") << QStringLiteral("10") << QStringLiteral("10.0") << false;
}

void tst_Connection::findsText()
{
    QFETCH(QString, stored);
    QFETCH(QString, asked);
    TestCatalogue catalogue;
    addArtist(1, stored.toUtf8().constData());
    Recordset rs;
    rs.Open(QLatin1String("Select ID, Naam From Artiesten where Naam = '") + asked +
                QLatin1Char('\''),
            *gConnection);
    QTEST(rs.RecordCount() == 1, "found");
}

// One prepared statement, other values: nothing of the earlier run may be left in it.
void tst_Connection::bindsAgain()
{
    TestCatalogue catalogue;
    const char *names[] = {"Abba", "", "Zz Top", "Abba"};
    for (int i = 0; i < 4; ++i)
        addArtist(i + 1, names[i]);
    for (const char *pattern : {"A%", "%", "Z%", "%b_a"}) {
        Recordset rs;
        rs.Open(QStringLiteral("select naam from artiesten where naam like '") +
                    QLatin1String(pattern) + QStringLiteral("'"),
                *gConnection);
        QCOMPARE(rs.RecordCount(), qstrcmp(pattern, "%") == 0 ? 4 : (pattern[0] == 'Z' ? 1 : 2));
    }
    for (int distinct = 0; distinct < 500; ++distinct) // more than are kept
        QCOMPARE(single(QStringLiteral("select 1 as c%1").arg(distinct)).toLong(), 1);
}

void tst_Connection::refusedStatementsChangeNothing_data()
{
    QTest::addColumn<QString>("genre"); // as a text import writes it: not doubled
    QTest::newRow("apostrophe") << QStringLiteral("rock'n'roll");
    QTest::newRow("second row") << QStringLiteral("x',1985),(51,1,'r','y");
    QTest::newRow("second statement") << QStringLiteral("x',1985); delete from tracks; --");
    QTest::newRow("comment") << QStringLiteral("x',1985) --");
    QTest::newRow("select behind") << QStringLiteral("x',1985) union select 1,1,1,1,1 --");
}

void tst_Connection::refusedStatementsChangeNothing()
{
    QFETCH(QString, genre);
    TestCatalogue catalogue;
    catalogue.exec(QStringLiteral("insert into tracks values (1,1,'t',NULL,NULL)"));
    const int number = numberOf([&] {
        gConnection->Execute(
            QStringLiteral(
                "Insert into Tracks(ID,Artiest_ID,Titel,Genre,Hitjaar) values (50,1,'t','") +
            genre + QStringLiteral("',1985)"));
    });
    QCOMPARE(number, int(errSyntax));
    QCOMPARE(gConnection->Errors.size(), std::size_t(1));
    QCOMPARE(catalogue.count(QStringLiteral("select count(*) from tracks")), 1);
}

void tst_Connection::commitsAndRollsBack()
{
    TestCatalogue catalogue;
    gConnection->RollbackTrans(); // none open: nothing
    {
        Transaction t(*gConnection);
        addArtist(1);
        t.CommitTrans();
        QCOMPARE(numberOf([&] { t.CommitTrans(); }), int(errNotPermitted));
    }
    {
        Transaction t(*gConnection);
        addArtist(2);
        t.RollbackTrans();
        t.RollbackTrans();
        addArtist(3); // outside, counts at once
    }
    QCOMPARE(catalogue.rows(QStringLiteral("select id from artiesten")),
             (QStringList{QStringLiteral("1"), QStringLiteral("3")}));
}

void tst_Connection::joinedRoutineTakesBackItsOwn()
{
    TestCatalogue catalogue;
    Transaction outer(*gConnection);
    addArtist(1);
    {
        Transaction inner(*gConnection);
        addArtist(2);
        {
            Transaction innermost(*gConnection);
            addArtist(3);
            innermost.CommitTrans();
        }
        inner.RollbackTrans();
    }
    {
        Transaction inner(*gConnection);
        addArtist(4);
        inner.CommitTrans();
    }
    {
        Transaction left(*gConnection); // ends without a word: its changes go, the others stay
        addArtist(5);
    }
    QCOMPARE(catalogue.count(QStringLiteral("select count(*) from artiesten")), 0);
    outer.CommitTrans();
    QCOMPARE(catalogue.rows(QStringLiteral("select id from artiesten")),
             (QStringList{QStringLiteral("1"), QStringLiteral("4")}));
}

void tst_Connection::abandonedTransaction_data()
{
    QTest::addColumn<QString>("next");
    QTest::newRow("begins") << QStringLiteral("begin");
    QTest::newRow("writes") << QStringLiteral("write");
    QTest::newRow("closes") << QStringLiteral("close");
}

void tst_Connection::abandonedTransaction()
{
    QFETCH(QString, next);
    TestCatalogue catalogue;
    {
        Transaction half(*gConnection);
        addArtist(1);
    }
    QCOMPARE(artists(), 1); // still open, and seen by who reads
    QCOMPARE(catalogue.count(QStringLiteral("select count(*) from artiesten")), 0);
    if (next == QLatin1String("begin")) {
        Transaction t(*gConnection);
        addArtist(2);
        t.CommitTrans();
    } else if (next == QLatin1String("write")) {
        addArtist(2);
    } else {
        gConnection->Close();
        openConnection(catalogue.file());
        addArtist(2);
    }
    QCOMPARE(catalogue.rows(QStringLiteral("select id from artiesten")),
             QStringList{QStringLiteral("2")});
}

void tst_Connection::handlerInsideARunningRoutine()
{
    TestCatalogue catalogue;
    Transaction outer(*gConnection);
    addArtist(1);
    try {
        Transaction inner(*gConnection);
        addArtist(2);
        addArtist(2); // the key is taken
        QFAIL("no error");
    } catch (const Error &error) {
        QCOMPARE(error.Number, int(errConstraint));
        gConnection->RollbackTrans(); // must leave the outer routine's share alone
    }
    outer.CommitTrans();
    QCOMPARE(catalogue.rows(QStringLiteral("select id from artiesten")),
             QStringList{QStringLiteral("1")});
}

void tst_Connection::failedCommit()
{
    TestCatalogue catalogue;
    OtherProgram reader(catalogue.file());
    QCOMPARE(reader.run("begin; select * from artiesten"), SQLITE_OK);
    try {
        Transaction t(*gConnection);
        addArtist(1);
        t.CommitTrans(); // the reader keeps it from the file
        QFAIL("no error");
    } catch (const Error &error) {
        QCOMPARE(error.Number, int(errCannotUse));
        gConnection->RollbackTrans();
    }
    QCOMPARE(artists(), 0);
    QCOMPARE(reader.run("commit"), SQLITE_OK);
    addArtist(2);
    QCOMPARE(catalogue.count(QStringLiteral("select max(id) from artiesten")), 2);
}

void tst_Connection::fateOfATransaction()
{
    TestCatalogue catalogue;
    QVERIFY(!gConnection->fate());
    std::shared_ptr<const TransactionFate> kept, joined, joinedLost, outer, left;
    {
        Transaction t(*gConnection);
        outer = gConnection->fate();
        {
            Transaction inner(*gConnection);
            joinedLost = gConnection->fate();
            inner.RollbackTrans();
        }
        QCOMPARE(gConnection->fate(), outer);
        Transaction inner(*gConnection);
        joined = gConnection->fate();
        inner.CommitTrans();
        QVERIFY(joinedLost->undone() && !joined->undone() && !outer->undone());
        t.RollbackTrans();
        QVERIFY(joined->undone() && outer->undone());
    }
    {
        Transaction t(*gConnection);
        kept = gConnection->fate();
        t.CommitTrans();
    }
    {
        Transaction t(*gConnection);
        left = gConnection->fate();
    }
    QVERIFY(!left->undone());
    gConnection->RollbackTrans();
    QVERIFY(left->undone() && !kept->undone());
}

// A row further on would be an error: it must not be reached.
void tst_Connection::firstRowsReadsNoMore()
{
    TestCatalogue catalogue;
    for (const int id : {1, 2, 3})
        addArtist(id);
    const QString query = QStringLiteral(
        "select iif(ID < 3, ID, abs(-9223372036854775807 - 1)) as n from Artiesten order by ID");
    QCOMPARE(gConnection->firstRows(query, 2).RecordCount(), 2);
    QVERIFY(numberOf([&] { gConnection->firstRows(query, 5); }) != 0);
    QCOMPARE(gConnection->firstRows(QStringLiteral("select ID from Tracks"), 2).RecordCount(), 0);
}

void tst_Connection::engineRollsBackByItself_data()
{
    QTest::addColumn<bool>("joined");
    QTest::newRow("alone") << false;
    QTest::newRow("in a joined routine") << true;
}

// As it does when the disk is full. What the routine still writes must not count, not even if it
// takes no notice of the failure.
void tst_Connection::engineRollsBackByItself()
{
    QFETCH(bool, joined);
    TestCatalogue catalogue;
    catalogue.exec(QStringLiteral("create trigger full before insert on artiesten when new.id=2 "
                                  "begin select raise(rollback,'full'); end"));
    {
        Transaction outer(*gConnection);
        addArtist(1);
        if (joined) {
            Transaction inner(*gConnection);
            QCOMPARE(numberOf([] { addArtist(2); }), int(errConstraint));
        } else {
            QCOMPARE(numberOf([] { addArtist(2); }), int(errConstraint));
        }
        QCOMPARE(numberOf([] { addArtist(3); }), int(errNotPermitted));
        QCOMPARE(numberOf([] { Transaction late(*gConnection); }), int(errNotPermitted));
        QCOMPARE(numberOf([&] { outer.CommitTrans(); }), int(errNotPermitted));
    }
    gConnection->RollbackTrans();
    QCOMPARE(artists(), 0);
    addArtist(4);
    QCOMPARE(catalogue.count(QStringLiteral("select count(*) from artiesten")), 1);
}

void tst_Connection::closesWithOpenTransaction()
{
    TestCatalogue catalogue;
    {
        Transaction t(*gConnection);
        addArtist(1);
        gConnection->Close();
        QCOMPARE(numberOf([&] { t.CommitTrans(); }), int(errNotPermitted));
        openConnection(catalogue.file()); // the old one is gone when t ends
    }
    {
        Transaction t(*gConnection);
        addArtist(1);
        gConnection.reset();
    }
    openConnection(catalogue.file());
    QCOMPARE(artists(), 0);
    gConnection->Close();
    QCOMPARE(gConnection->State(), adStateClosed);
    QCOMPARE(numberOf([] { artists(); }), int(errObjectClosed));
    QCOMPARE(numberOf([] { gConnection->Close(); }), int(errObjectClosed));
}

void tst_Connection::errorsHoldTheLastFailure()
{
    TestCatalogue catalogue;
    ScriptedDesktop desktop;
    QVERIFY(gConnection->Errors.empty());
    QVERIFY(numberOf([] { artists(); }) == 0 && gConnection->Errors.empty());
    for (const char *bad : {"select * from nothing", "select", "select a from Artiesten"}) {
        try {
            gConnection->Execute(QLatin1String(bad));
            QFAIL(bad);
        } catch (const Error &error) {
            desktop.expectBox(QStringLiteral("error [Title] ") + error.numbered());
            desktop.expectBox(error.numbered());
            showDatabaseErrors(error, QStringLiteral("Title"));
        }
    }
    desktop.verifyAllCame();
    QCOMPARE(desktop.boxes.size(), 6);
    artists();
    QCOMPARE(gConnection->Errors.size(), std::size_t(1)); // a success does not take it away
}

void tst_Connection::lockedByAnotherProgram()
{
    TestCatalogue catalogue;
    OtherProgram other(catalogue.file());
    QCOMPARE(other.run("begin exclusive"), SQLITE_OK);
    QElapsedTimer clock;
    clock.start();
    try {
        addArtist(1);
        QFAIL("no error");
    } catch (const Error &error) {
        QCOMPARE(error.Number, int(errCannotUse));
        QVERIFY(error.Description.contains(QLatin1String("in use by another program")));
    }
    QVERIFY(clock.elapsed() < 5000);
    QCOMPARE(other.run("commit"), SQLITE_OK);
    addArtist(1);
}

void tst_Connection::readOnlyFile()
{
    TestCatalogue catalogue;
    gConnection->Close();
    gConnection->Mode = adModeRead;
    gConnection->Open();
    QCOMPARE(artists(), 0);
    QCOMPARE(numberOf([] { addArtist(1); }), int(errReadOnly));
    Transaction t(*gConnection);
    QCOMPARE(numberOf([] { addArtist(1); }), int(errReadOnly));
}

// A prepared statement meets tables that another program has changed since.
void tst_Connection::tablesChangeUnderneath()
{
    TestCatalogue catalogue;
    catalogue.exec(QStringLiteral("create table t(a,b); insert into t values (1,2)"));
    const auto ask = [] {
        Recordset rs;
        rs.Open(QStringLiteral("select * from t"), *gConnection);
        QString all;
        for (int i = 0; i < rs.fieldCount(); ++i)
            all += rs.Fields(i).Name() + rs.Fields(i).Value().toText();
        return all;
    };
    QCOMPARE(ask(), QStringLiteral("a1b2"));
    catalogue.exec(QStringLiteral("alter table t add column c default 3"));
    QCOMPARE(ask(), QStringLiteral("a1b2c3"));
    catalogue.exec(QStringLiteral("alter table t drop column a; alter table t rename b to d"));
    QCOMPARE(ask(), QStringLiteral("d2c3"));
    catalogue.exec(QStringLiteral("drop table t"));
    QCOMPARE(numberOf([&] { ask(); }), int(errSyntax));
    catalogue.exec(QStringLiteral("create table t(e); insert into t values (5)"));
    QCOMPARE(ask(), QStringLiteral("e5"));
}

void tst_Connection::opensWhatIsNamed()
{
    const auto source = [](const char *text) {
        return Connection::dataSource(QString::fromUtf8(text));
    };
    QCOMPARE(source("Provider=x;Data Source=/a/b c.orv; "), QStringLiteral("/a/b c.orv"));
    QCOMPARE(source("data source=/a;b; c.orv; "), QStringLiteral("/a;b; c.orv"));
    QCOMPARE(source("Data Source=/a.orv;"), QStringLiteral("/a.orv"));
    QCOMPARE(source("Provider=x"), QString());

    TestCatalogue catalogue;
    for (const QString &name : {QString(), catalogue.path(QStringLiteral("none.orv"))}) {
        Connection connection;
        connection.Mode = adModeReadWrite;
        connection.ConnectionString = QStringLiteral("Data Source=") + name + QStringLiteral("; ");
        QCOMPARE(numberOf([&] { connection.Open(); }), int(errCannotUse));
        QCOMPARE(connection.State(), adStateClosed);
        QVERIFY(!QFile::exists(catalogue.path(QStringLiteral("none.orv")))); // never made
    }
    QCOMPARE(numberOf([] { gConnection->Open(); }), int(errNotPermitted));
}

void tst_Connection::nextIdReadsAnIndex_data()
{
    QTest::addColumn<QString>("statement");
    for (const char *s :
         {"Select max(id) + 1 as N from CDTitels", "select max(id+1) as ID from tracks",
          "Select max(ID)+1 as ID from Tracks"})
        QTest::newRow(s) << QString::fromLatin1(s);
}

// Counts the engine's own steps: they must not grow with the table.
void tst_Connection::nextIdReadsAnIndex()
{
    QFETCH(QString, statement);
    TestCatalogue catalogue;
    catalogue.exec(
        QStringLiteral("with recursive n(i) as (select 1 union all select i+1 from n where i<2000) "
                       "insert into tracks select i,1,'t','g',1985 from n; "
                       "insert into cdtitels select id,titel,NULL,'V',NULL,NULL from tracks"));
    Dialect dialect;
    dialect.translate(statement);
    OtherProgram other(catalogue.file());
    sqlite3_stmt *s = nullptr;
    QCOMPARE(sqlite3_prepare_v2(other.db, dialect.sql().c_str(), -1, &s, nullptr), SQLITE_OK);
    for (std::size_t i = 0; i < dialect.literals().size(); ++i)
        sqlite3_bind_int64(s, int(i) + 1, dialect.literals()[i].integer);
    QCOMPARE(sqlite3_step(s), SQLITE_ROW);
    QCOMPARE(sqlite3_column_int(s, 0), 2001);
    const int steps = sqlite3_stmt_status(s, SQLITE_STMTSTATUS_VM_STEP, 0);
    sqlite3_finalize(s);
    QVERIFY2(steps < 50, qPrintable(QString::number(steps)));
}

QTEST_GUILESS_MAIN(tst_Connection)
#include "tst_Connection.moc"
