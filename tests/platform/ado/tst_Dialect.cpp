// Label: unit
#include "platform/ado/dialect.h"
#include "platform/error/error.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

using namespace ADODB;

/// What becomes of a statement on its way to the engine.
class tst_Dialect : public QObject
{
    Q_OBJECT

private slots:
    void rewrites_data()
    {
        const DataRows<QString, QString> row("statement", "sql");
        for (const char *asItIs :
             {"select a from t where b=1985 and c='x'", "select 'd''Arc', '''', ''''''",
              "select '1e10', 1e10, .5, 5., 1E-2, 9223372036854775808", "select -5, 3-2, a+-1",
              "select '; drop', '-- no', 'a/*b*/', 'x?', ':a @b $c #d', 'a||b'",
              "select '\U0001F3B5', 'order by 1', 2 from t", "select a, 5 from t order by 1,2 desc",
              "select a from t left join u",
              "select a from t group by 1 having count(*)= 3 order by 2",
              "select 7 from t group by 1 union select 8 from u order by 1",
              "select border, xx, max(id)+1, max(a,b+1), max(t.id+1) from groupby where x=1",
              "Delete From t AS x where x.a=1", "delete from t where a=1", "delete from t",
              "create table t(a default 'x''y', b decimal(10,2))",
              // A text that is like no column of its own.
              "select a from t where b not like 'x'", "select a from t where not b like 'x'",
              "select a from t where b like c and 'x' = c", "select a from t where b + c like 'x'",
              "select a from t where b between c and d like 'x'",
              "select a from t where b between 1 and 2 like 'x'",
              "select a from t where b or 5 like 'x'",
              "select a from t where case when b like 'x' then c end",
              "select a where b like 'x' escape '!'"})
            row(asItIs, asItIs);

        row("double quoted", "select \"it's\", \"a\"\"b\", \"\", \"d''A\"",
            "select 'it''s', 'a\"b', '', 'd''''A'");
        row("decomposed becomes NFC", "select 'Cafe\u0301', 'd''e\u0301'",
            "select 'Caf\u00e9', 'd''\u00e9'");
        row("NUL", u"select 'a\0b'"_s, "select ('a'||char(0)||'b')");
        row("blanks", " \t select\r\n  1 \n from  t ", "select 1 from t");
        row("semicolon at the end", "select 1 ; ", "select 1 ");

        row("a condition that seldom holds",
            "select 1 from t where a.b like '%x' and (c like 'y''z')",
            "select 1 from t where unlikely(a.b like '%x') and (unlikely(c like 'y''z'))");
        row("the same behind a between",
            "select a where b between 1 and 2 and c like 'x' order by 1",
            "select a where b between 1 and 2 and unlikely(c like 'x') order by 1");

        row("alias in delete", "delete from tracks trk where not exists (select '1' from c)",
            "delete from tracks as trk where not exists (select '1' from c)");
        row("left function", "select LEFT (a,1) from t left join u order by left(a,2)",
            "select \"left\" (a,1) from t left join u order by \"left\"(a,2)");
        row("max of a sum", "select 2*MAX( id + 1 ) as ID, max(id+10) from t",
            "select 2*(max(id)+1) as ID, (max(id)+10) from t");
        row("shape", "SHAPE { select a from t where b='}' order by 1 } as X compute X by a, b",
            "select distinct a from t where b='}' order by 1");
    }

    void rewrites()
    {
        QFETCH(QString, statement);
        QTEST(QString::fromStdString(translated(statement)), "sql");
    }

    void refuses_data()
    {
        const DataRows<QString> row("statement");
        for (const char *bad : {"",
                                "  ",
                                ";",
                                "select 1; select 2",
                                "select 1;;",
                                "select 1 -- the rest",
                                "select 1 /* x */",
                                "select 'rock'n'roll'",
                                "insert into t values (1,'rock'n'roll')",
                                "select 'open",
                                "select 'open''",
                                "select \"open",
                                "select 'a'5",
                                "insert into t(a) values (1),(2)",
                                "insert into t(a) values (5,1,'t','x',1985),(51,1,'r','y',NULL)",
                                "insert into t(a) values (1) union select 2",
                                "insert into t(a) values (1) returning a",
                                "select a where b=?",
                                "select :a",
                                "select @a",
                                "select $a",
                                "select #1#",
                                "select 'a'||'b'",
                                "select 1985x",
                                "select 0x10",
                                "select 1_000",
                                "select 1e",
                                "select a.5",
                                "select x'41'",
                                "select X\"41\"",
                                "select 1.5.3",
                                "select a)",
                                "select \f1",
                                "SHAPE { delete from t } as X",
                                "SHAPE select a as X",
                                "SHAPE } select a {",
                                "pragma user_version=1",
                                "attach 'x' as y",
                                "commit",
                                "begin",
                                "explain select 1"})
            row(bad);
        // The engine would take the first part for the whole.
        row("NUL", u"delete from t "_s + QChar(0) + u"where 0"_s);
    }

    void refuses()
    {
        QFETCH(QString, statement);
        QCOMPARE(numberOf([&] { translated(statement); }), int(errSyntax));
    }
};

QTEST_APPLESS_MAIN(tst_Dialect)
#include "tst_Dialect.moc"
