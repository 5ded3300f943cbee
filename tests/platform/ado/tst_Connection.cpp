// Label: unit
#include "platform/ado/dialect.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

#include <sqlite3.h>

using namespace ADODB;

namespace
{

void addArtist(int id)
{
    gConnection->Execute(u"Insert into Artiesten(ID,Naam) values (%1,'x')"_s.arg(id));
}

Value single(const QString &statement)
{
    Recordset rs;
    rs.Open(statement, *gConnection);
    return rs.Fields(0).Value();
}

int artists()
{
    return int(single(u"select count(*) from artiesten"_s).toLong());
}

} // namespace

/// The connection to a real file: values on their way in and out, transactions, failures.
class tst_Connection : public QObject
{
    Q_OBJECT

private slots:
    void keepsValues_data()
    {
        const DataRows<QString, QString, QString> row("literal", "type", "text");
        row("1e10", "real", "10000000000");
        row("'007'", "text", "007");
        row("-9223372036854775807", "integer", "-9223372036854775807");
        row("1.5", "real", "1.5");
        row("''", "text", "");
        row("NULL", "null", "");
        row("'d''Arc'", "text", "d'Arc");
        row("'\U0001F3B5 Cafe\u0301'", "text", "\U0001F3B5 Caf\u00e9");
        row("NUL", u"'a\0b'"_s, "text", u"a\0b"_s);
        const QString megabytes(3 << 20, u'\u00e9');
        row("long", u'\'' + megabytes + u'\'', "text", megabytes);
    }

    void keepsValues()
    {
        QFETCH(QString, literal);
        TestCatalogue catalogue;
        catalogue.exec("create table loose(v)");
        gConnection->Execute(u"insert into loose values ("_s + literal + u')');
        QTEST(single(u"select typeof(v) from loose"_s).toText(), "type");
        const Value v = single(u"select v from loose"_s);
        QTEST(v.toText(), "text");
        QCOMPARE(v.isNull(), literal == u"NULL");
    }

    // A statement is kept prepared; the columns of its answer are those of the table by then.
    void columnsOfAnotherShape()
    {
        TestCatalogue catalogue;
        addArtist(1);
        for (const char *change : {"select 1", "alter table Artiesten add column More",
                                   "alter table Artiesten rename column More to Less",
                                   "alter table Artiesten drop column Less"}) {
            catalogue.exec(change);
            const auto answer = gConnection->Execute(u"select * from Artiesten"_s);
            QStringList names;
            for (const FieldInfo &field : answer.rows()->fields())
                names.append(field.name);
            QCOMPARE(names, catalogue.rows("select name from pragma_table_info('Artiesten')"));
        }
    }

    void commitsAndRollsBack()
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
        QCOMPARE(catalogue.rows("select id from artiesten"), texts("1", "3"));
    }

    void joinedRoutineTakesBackItsOwn()
    {
        for (const bool commits : {true, false}) {
            TestCatalogue catalogue;
            QVERIFY(!gConnection->fate());
            std::vector<std::shared_ptr<const TransactionFate>> fates; // by the artist added
            const auto add = [&](int id) {
                addArtist(id);
                fates.push_back(gConnection->fate());
            };
            const auto inner = [&](int id, auto ending) {
                Transaction joined(*gConnection);
                add(id);
                ending(joined);
            };
            const auto commit = [](Transaction &t) { t.CommitTrans(); };
            Transaction outer(*gConnection);
            add(1);
            inner(2, [&](Transaction &t) {
                inner(3, commit);
                t.RollbackTrans();
            });
            inner(4, commit);
            inner(5, [](Transaction &) {}); // ends without a word: its changes go
            QCOMPARE(catalogue.count("select count(*) from artiesten"), 0);
            commits ? outer.CommitTrans() : outer.RollbackTrans();
            const auto kept = catalogue.rows("select id from artiesten");
            QCOMPARE(kept, commits ? texts("1", "4") : QStringList());
            for (int id = 1; id <= 5; ++id)
                QCOMPARE(fates[std::size_t(id - 1)]->undone(), !kept.contains(QString::number(id)));
        }
    }

    void abandonedTransaction()
    {
        for (const bool begins : {false, true}) {
            TestCatalogue catalogue;
            {
                Transaction half(*gConnection);
                addArtist(1);
            }
            QCOMPARE(artists(), 1); // still open, and seen by who reads
            QCOMPARE(catalogue.count("select count(*) from artiesten"), 0);
            auto next = begins ? std::make_unique<Transaction>(*gConnection) : nullptr;
            addArtist(2);
            if (begins)
                next->CommitTrans();
            QCOMPARE(catalogue.rows("select id from artiesten"), texts("2"));
        }
    }

    void handlerInsideARunningRoutine()
    {
        TestCatalogue catalogue;
        Transaction outer(*gConnection);
        addArtist(1);
        const int number = numberOf([] {
            Transaction inner(*gConnection);
            addArtist(2);
            addArtist(2); // the key is taken
        });
        QCOMPARE(number, int(errConstraint));
        gConnection->RollbackTrans(); // must leave the outer routine's share alone
        outer.CommitTrans();
        QCOMPARE(catalogue.rows("select id from artiesten"), texts("1"));
    }

    void failedCommit()
    {
        TestCatalogue catalogue;
        OtherProgram reader(catalogue.file());
        QCOMPARE(reader.run("begin; select * from artiesten"), SQLITE_OK);
        gConnection->ConnectionTimeout = 0;
        const int number = numberOf([] {
            Transaction t(*gConnection);
            addArtist(1);
            t.CommitTrans(); // the reader keeps it from the file
        });
        QCOMPARE(number, int(errCannotUse));
        gConnection->RollbackTrans();
        QCOMPARE(artists(), 0);
        QCOMPARE(reader.run("commit"), SQLITE_OK);
        addArtist(2);
        QCOMPARE(catalogue.count("select max(id) from artiesten"), 2);
    }

    // A row further on would be an error: it must not be reached.
    void firstRowsReadsNoMore()
    {
        TestCatalogue catalogue;
        for (const int id : {1, 2, 3})
            addArtist(id);
        const QString query =
            u"select iif(ID < 3, ID, abs(-9223372036854775807 - 1)) as n from Artiesten order by ID"_s;
        QCOMPARE(gConnection->firstRows(query, 2).RecordCount(), 2);
        QVERIFY(numberOf([&] { gConnection->firstRows(query, 5); }) != 0);
        QCOMPARE(gConnection->firstRows(u"select ID from Tracks"_s, 2).RecordCount(), 0);
    }

    // As it does when the disk is full. What the routine still writes must not count, not even if
    // it takes no notice of the failure.
    void engineRollsBackByItself()
    {
        TestCatalogue catalogue;
        catalogue.exec("create trigger full before insert on artiesten when new.id=2 "
                       "begin select raise(rollback,'full'); end");
        {
            Transaction outer(*gConnection);
            addArtist(1);
            {
                Transaction inner(*gConnection);
                QCOMPARE(numberOf([] { addArtist(2); }), int(errConstraint));
            }
            QCOMPARE(numberOf([] { addArtist(3); }), int(errNotPermitted));
            QCOMPARE(numberOf([] { Transaction late(*gConnection); }), int(errNotPermitted));
            QCOMPARE(numberOf([&] { outer.CommitTrans(); }), int(errNotPermitted));
        }
        gConnection->RollbackTrans();
        QCOMPARE(artists(), 0);
        addArtist(4);
        QCOMPARE(catalogue.count("select count(*) from artiesten"), 1);
    }

    // What comes in while the engine waits must not reach it; the statement that waits goes on.
    void waitsForAnotherProgram()
    {
        TestCatalogue catalogue;
        const OtherProgram other(catalogue.file());
        QCOMPARE(other.run("begin exclusive"), SQLITE_OK);
        int calls = 0;
        gConnection->WhileLocked = [&] {
            QCOMPARE(numberOf([] { addArtist(7); }), int(errNotPermitted));
            if (++calls == 3)
                QCOMPARE(other.run("commit"), SQLITE_OK);
        };
        addArtist(1);
        QCOMPARE(calls, 3);
        QCOMPARE(catalogue.rows("select id from artiesten"), texts("1"));
    }

    void opensWhatIsNamed()
    {
        const auto source = [](const char *text) {
            return Connection::dataSource(QString::fromUtf8(text));
        };
        QCOMPARE(source("Provider=x;Data Source=/a/b c.orv; "), u"/a/b c.orv"_s);
        QCOMPARE(source("data source=/a;b; c.orv; "), u"/a;b; c.orv"_s);
        QCOMPARE(source("Provider=x"), QString());
    }

    // Counts the engine's own steps: they must not grow with the table.
    void nextIdReadsAnIndex()
    {
        TestCatalogue catalogue;
        catalogue.exec("with recursive n(i) as (select 1 union all select i+1 from n where i<2000) "
                       "insert into tracks select i,1,'t','g',1985 from n");
        const std::string sql = translated(u"select max(id+1) as ID from tracks"_s);
        const OtherProgram other(catalogue.file());
        sqlite3_stmt *s = nullptr;
        QCOMPARE(sqlite3_prepare_v2(other.db, sql.c_str(), -1, &s, nullptr), SQLITE_OK);
        QCOMPARE(sqlite3_step(s), SQLITE_ROW);
        QCOMPARE(sqlite3_column_int(s, 0), 2001);
        const int steps = sqlite3_stmt_status(s, SQLITE_STMTSTATUS_VM_STEP, 0);
        sqlite3_finalize(s);
        QVERIFY2(steps < 50, qPrintable(QString::number(steps)));
    }
};

QTEST_GUILESS_MAIN(tst_Connection)
#include "tst_Connection.moc"
