// Label: unit
#include "platform/ado/command.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

#include <optional>

using namespace ADODB;

namespace
{

constexpr std::string_view addArtist = "insert into Artiesten(ID,Naam) values (?,?)";

} // namespace

/// Prepared commands: values on their way in, transactions, failures, the end of the connection.
class tst_Command : public QObject
{
    Q_OBJECT

private slots:
    void keepsValues_data()
    {
        const DataRows<Value, QString, QString> row("value", "type", "text");
        row("number", qint64(-9223372036854775807), "integer", "-9223372036854775807");
        row("fraction", 1.5, "real", "1.5");
        row("NULL", Value(), "null", "NULL");
        row("text", u"d'Arc'); --"_s, "text", "d'Arc'); --");
        row("empty", QString(), "text", "");
        row("digits", u"007"_s, "text", "007");
        row("decomposed", u"Cafe\u0301 \U0001F3B5"_s, "text", u"Caf\u00e9 \U0001F3B5"_s);
        row("mark of order", u"\uFEFFe\u0301"_s, "text", u"\uFEFF\u00e9"_s);
    }

    // A text comes in as it is held, and as UTF-8.
    void keepsValues()
    {
        QFETCH(Value, value);
        TestCatalogue catalogue;
        catalogue.exec("create table loose(v)");
        Command insert(*gConnection, "insert into loose values (?)");
        insert.Execute({value});
        if (const auto *text = std::get_if<QString>(&value.variant()))
            insert.Execute({std::string_view(text->toStdString())});
        for (const QString &stored :
             catalogue.rows("select typeof(v)||'|'||ifnull(v,'NULL') from loose")) {
            QTEST(stored.section(u'|', 0, 0), "type");
            QTEST(stored.section(u'|', 1), "text");
        }
    }

    // Nothing of the earlier run is left in it.
    void runsAgain()
    {
        TestCatalogue catalogue;
        Command insert(*gConnection, addArtist);
        for (int id = 1; id <= 3; ++id)
            insert.Execute({id, u"Abba"_s});
        insert.Execute({4}); // a value that is not given is NULL
        QCOMPARE(catalogue.rows("select * from Artiesten where ID > 2"), texts("3|Abba", "4|NULL"));
        Command search(*gConnection,
                       "select ID from Artiesten where Naam = ? and ID < ? order by ID desc");
        for (const auto &[below, rows, id] :
             {std::tuple(1, 0, 0), {2, 1, 1}, {3, 2, 2}, {9, 2, 3}}) {
            const auto match = search.find({u"ABBA"_s, below});
            QCOMPARE(match.rows, rows);
            QCOMPARE(match.id, id);
        }
        QCOMPARE(search.Execute({u"abba"_s, 9}).RecordCount(), 3);
        QCOMPARE(insert.Execute({5, nullptr}).State(), adStateClosed);
    }

    void failsAsTheEngine()
    {
        TestCatalogue catalogue;
        Command insert(*gConnection, addArtist);
        insert.Execute({1, u"x"_s});
        QCOMPARE(numberOf([&] { insert.Execute({1, u"y"_s}); }), int(errConstraint));
        QCOMPARE(gConnection->Errors.size(), 1u);
        QVERIFY(numberOf([&] { insert.Execute({2, u"y"_s, 3}); }) != 0); // a value too many
        insert.Execute({2, u"y"_s});
        QCOMPARE(numberOf([&] { Command(*gConnection, "select wrong").Execute(); }),
                 int(errSyntax));
        QCOMPARE(catalogue.rows("select * from Artiesten"), texts("1|x", "2|y"));
    }

    // A transaction whose routine has gone is rolled back before anything is written, and one that
    // the engine took back is not written on in.
    void keepsTheRulesOfTransactions()
    {
        TestCatalogue catalogue;
        catalogue.exec("create trigger full before insert on Artiesten when new.ID = 9 "
                       "begin select raise(rollback,'full'); end");
        Command insert(*gConnection, addArtist), search(*gConnection, "select ID from Artiesten");
        {
            Transaction half(*gConnection);
            insert.Execute({1, u"x"_s});
        }
        QCOMPARE(search.find({}).id, 1); // reads what is still open
        insert.Execute({2, u"x"_s});
        QCOMPARE(catalogue.rows("select ID from Artiesten"), texts("2"));
        {
            Transaction outer(*gConnection);
            QCOMPARE(numberOf([&] { insert.Execute({9, nullptr}); }), int(errConstraint));
            QCOMPARE(numberOf([&] { insert.Execute({3, nullptr}); }), int(errNotPermitted));
        }
        gConnection->RollbackTrans();
        insert.Execute({4, nullptr});
        QCOMPARE(catalogue.rows("select ID from Artiesten"), texts("2", "4"));
    }

    // The statement is the connection's: neither its end nor the many that it prepares meanwhile
    // leave the command with one that is gone.
    void outlivesItsStatement()
    {
        TestCatalogue catalogue;
        Command insert(*gConnection, addArtist);
        insert.Execute({1, u"x"_s});
        for (int other = 0; other < 500; ++other)
            gConnection->Execute(u"select 1 as c%1"_s.arg(other));
        insert.Execute({2, u"x"_s});
        gConnection->Close();
        QVERIFY(!QFile::exists(catalogue.file() + u"-journal"_s));
        QCOMPARE(numberOf([&] { insert.Execute({3, u"x"_s}); }), int(errObjectClosed));
        gConnection->Open();
        insert.Execute({4, u"x"_s});
        QCOMPARE(catalogue.rows("select ID from Artiesten"), texts("1", "2", "4"));
    }
};

QTEST_GUILESS_MAIN(tst_Command)
#include "tst_Command.moc"
