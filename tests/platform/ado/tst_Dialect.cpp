// Label: unit
#include "platform/ado/dialect.h"
#include "platform/error/error.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

using namespace ADODB;

namespace
{

QString literalsOf(const Dialect &dialect)
{
    QStringList all;
    for (const auto &l : dialect.literals()) {
        const auto bytes = dialect.text(l);
        if (l.kind == Literal::Integer)
            all.append(QString::number(l.integer));
        else if (l.kind == Literal::Real)
            all.append(u'r' + QString::number(l.real));
        else
            all.append(u't' + QString::fromUtf8(bytes.data(), qsizetype(bytes.size())));
    }
    return all.join(u'|');
}

} // namespace

/// What becomes of a statement on its way to the engine. A "|" parts the lifted literals in the
/// expected column; whole numbers stand as they are, fractions with an "r", texts with a "t".
class tst_Dialect : public QObject
{
    Q_OBJECT

private slots:
    void rewrites_data()
    {
        const DataRows<QString, QString, QString> row("statement", "sql", "literals");
        row("number and text", "select a from t where b=1985 and c='x'",
            "select a from t where b=? and c=?", "1985|tx");
        row("the same with other values", "select a from t where b=0.5 and c='it''s'",
            "select a from t where b=? and c=?", "r0.5|tit's");
        row("doubled quotes", "select 'd''Arc', '''', ''''''", "select ?, ?, ?", "td'Arc|t'|t''");
        row("double quoted", "select \"it's\", \"a\"\"b\", \"\"", "select ?, ?, ?",
            "tit's|ta\"b|t");
        row("text that looks numeric", "select '1e10', 1e10, .5, 5., 1E-2", "select ?, ?, ?, ?, ?",
            "t1e10|r1e+10|r0.5|r5|r0.01");
        row("number too big for 64 bits", "select 9223372036854775807, 9223372036854775808",
            "select ?, ?", "9223372036854775807|r9.22337e+18");
        row("sign before a number", "select -5, 3-2, a+-1", "select -?, ?-?, a+-?", "5|3|2|1");
        row("decomposed becomes NFC", "select 'Cafe\u0301', 'd''e\u0301'", "select ?, ?",
            "tCaf\u00e9|td'\u00e9");
        row("emoji", "select '\U0001F3B5'", "select ?", "t\U0001F3B5");
        row("harmless inside quotes",
            "select '; drop', '-- no', 'a/*b*/', 'x?', ':a @b $c #d', 'a||b'",
            "select ?, ?, ?, ?, ?, ?", "t; drop|t-- no|ta/*b*/|tx?|t:a @b $c #d|ta||b");
        row("keywords inside quotes", "select 'order by 1', 2 from t", "select ?, ? from t",
            "torder by 1|2");
        row("blanks", " \t select\r\n  1 \n from  t ", "select ? from t", "1");
        row("semicolon at the end", "select 1 ; ", "select ? ", "1");

        row("a condition that seldom holds", "select 1 from t where a.b like '%x' and (c like 'y')",
            "select ? from t where unlikely(a.b like ?) and (unlikely(c like ?))", "1|t%x|ty");
        row("the same behind a between",
            "select a where b between 1 and 2 and c like 'x' order by 1",
            "select a where b between ? and ? and unlikely(c like ?) order by 1", "1|2|tx");
        // Left as they stand.
        for (const char *other :
             {"b not like 'x'", "not b like 'x'", "b like c and 'x' = c", "b + c like 'x'",
              "left(b) like 'x'", "b between c and d like 'x'",
              "case when b like 'x' then c end"}) {
            const QString statement = u"select a from t where "_s + QLatin1String(other);
            QString sql = statement;
            sql.replace(u"'x'"_s, u"?"_s).replace(u"left"_s, u"\"left\""_s);
            row(other, statement, sql, "tx");
        }
        row("with an escape", "select a where b like 'x' escape '!'",
            "select a where b like ? escape ?", "tx|t!");
        row("order by", "select a, 5 from t order by 1,2 desc",
            "select a, ? from t order by 1,2 desc", "5");
        row("other ordinals", "select a, 5 from t order by 1,22 desc",
            "select a, ? from t order by 1,22 desc", "5");
        row("group by, having", "select a from t group by 1 having count(*)= 3 order by 2",
            "select a from t group by 1 having count(*)= ? order by 2", "3");
        row("union", "select 7 from t group by 1 union select 8 from u order by 1",
            "select ? from t group by 1 union select ? from u order by 1", "7|8");
        row("order by of a subselect", "select a from (select b from t order by 1), u where c=4",
            "select a from (select b from t order by 1), u where c=?", "4");
        row("subselect in order by", "select a from t order by (select b from u order by 1), 2",
            "select a from t order by (select b from u order by 1), 2", "");
        row("ordinal in parentheses", "select a from t order by (1), left(a,2)",
            "select a from t order by (1), \"left\"(a,2)", "");
        row("a column named like a part", "select border, orders from groupby where x=1",
            "select border, orders from groupby where x=?", "1");

        row("alias in delete", "delete from tracks trk where not exists (select '1' from c)",
            "delete from tracks as trk where not exists (select ? from c)", "t1");
        row("delete with as", "Delete From t AS x where x.a=1", "Delete From t AS x where x.a=?",
            "1");
        row("delete without alias", "delete from t where a=1", "delete from t where a=?", "1");
        row("delete of all", "delete from t", "delete from t", "");
        row("left function and left join", "select LEFT (a,1) from t left join u",
            "select \"left\" (a,?) from t left join u", "1");
        row("max of a sum", "select 2*MAX( id + 1 ) as ID from t",
            "select ?*(max(id)+?) as ID from t", "2|1");
        row("max of other sums", "select max(id+10), max(id)+1, max(a,b+1), max(t.id+1)",
            "select (max(id)+?), max(id)+?, max(a,b+?), max(t.id+?)", "10|1|1|1");
        row("shape", "SHAPE { select a from t where b='}' order by 1 } as X compute X by a, b",
            "select distinct a from t where b=? order by 1", "t}");
        row("table maker", "create table t(a default 'x''y', b decimal(10,2))",
            "create table t(a default 'x''y', b decimal(10,2))", "");
    }

    // A dialect that has seen all the statements before answers like a new one.
    void rewrites()
    {
        QFETCH(QString, statement);
        static Dialect seasoned;
        Dialect fresh;
        for (Dialect *dialect : {&fresh, &seasoned, &seasoned}) {
            dialect->translate(statement);
            QTEST(QString::fromStdString(dialect->sql()), "sql");
            QTEST(literalsOf(*dialect), "literals");
        }
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
        row("NUL in a default", u"create table t(a default 'x"_s + QChar(0) + u"')"_s);
    }

    void refuses()
    {
        QFETCH(QString, statement);
        Dialect dialect;
        QCOMPARE(numberOf([&] { dialect.translate(statement); }), int(errSyntax));
        dialect.translate(u"select 'a', 2 from t"_s); // nothing of it is left
        QCOMPARE(dialect.sql(), std::string("select ?, ? from t"));
        QCOMPARE(literalsOf(dialect), u"ta|2"_s);
    }
};

QTEST_APPLESS_MAIN(tst_Dialect)
#include "tst_Dialect.moc"
