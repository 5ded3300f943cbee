// Label: unit
#include "platform/ado/dialect.h"
#include "platform/ado/error.h"

#include <QTest>

using namespace ADODB;

/// A dialect that has seen many statements answers as one that has seen none.
class tst_StatementShapes : public QObject
{
    Q_OBJECT

private slots:
    void answersAsIfNew_data();
    void answersAsIfNew();
    void forgetsTheOldest();
};

namespace
{

QString answerOf(Dialect &dialect, const QString &statement)
{
    try {
        dialect.translate(statement);
    } catch (const Error &error) {
        return QStringLiteral("refused: ") + error.Description;
    }
    QString answer = QString::fromStdString(dialect.sql());
    for (const Literal &l : dialect.literals()) {
        const auto text = dialect.text(l);
        answer += QStringLiteral(" [%1 ").arg(l.kind) +
                  QString::fromUtf8(text.data(), qsizetype(text.size())) +
                  QStringLiteral(" %1 %2]").arg(l.integer).arg(l.real);
    }
    return answer;
}

QString answerOfNew(const QString &statement)
{
    Dialect dialect;
    return answerOf(dialect, statement);
}

} // namespace

void tst_StatementShapes::answersAsIfNew_data()
{
    QTest::addColumn<QString>("seen");
    QTest::addColumn<QString>("statement");
    const auto row = [](const char *name, const char *seen, const char *statement) {
        QTest::newRow(name) << QString::fromUtf8(seen) << QString::fromUtf8(statement);
    };
    const char *insert = "insert into T(a,b) values (1,'x')";
    row("other values", insert, "insert into T(a,b) values (22,'it''s Édith, E\u0301dith')");
    row("a second row", insert, "insert into T(a,b) values (1,'x'),(2,'y')");
    row("a second row in a text", insert, "insert into T(a,b) values (1,'x''),(2,''y')");
    row("a comment", insert, "insert into T(a,b) values (1,'x')--");
    row("a second statement", insert, "insert into T(a,b) values (1,'x');delete from T");
    row("a fraction", insert, "insert into T(a,b) values (1.5e3,'x')");
    row("a number that is glued", insert, "insert into T(a,b) values (1x,'x')");
    row("no number", insert, "insert into T(a,b) values (NULL,'x')");
    row("no text", insert, "insert into T(a,b) values (1,2)");
    row("the other quotes", insert, "insert into T(a,b) values (1,\"x\")");
    row("a text without end", insert, "insert into T(a,b) values (1,'x)");
    row("a part of it", insert, "insert into T(a,b) values (1");
    row("more than it", insert, "insert into T(a,b) values (1,'x') ");
    row("ordinals", "select a from T where b=1 order by 1", "select a from T where b=2 order by 2");
    row("the same ordinals", "select a from T where b=1 order by 1",
        "select a from T where b=2 order by 1");
    row("a text behind a number", "select 1", "select 1'x'");
    row("a number that a word swallows", "select a.5", "select a5");
    row("another sum", "select max(id+2) from T", "select max(id+1) from T");
    row("a sign before it", "select a from T where b=1", "select a from T where b=-1");
    row("ordinals that begin alike", "select a from T where b='x' order by 1",
        "select a from T where b='x' order by 12");
    row("a parenthesis more", insert, "insert into T(a,b) values (1,'x'))");
    row("a value more", insert, "insert into T(a,b) values (1,'x','y')");
    row("nothing in it", "select ''", "select ''''");
    row("a shape", "SHAPE { select a from T where b=1 } as X compute X by a",
        "SHAPE { select a from T where b=2 } as X compute X by a");
}

void tst_StatementShapes::answersAsIfNew()
{
    QFETCH(QString, seen);
    QFETCH(QString, statement);
    Dialect dialect;
    answerOf(dialect, seen);
    QCOMPARE(answerOf(dialect, statement), answerOfNew(statement));
    QCOMPARE(answerOf(dialect, seen), answerOfNew(seen));
}

void tst_StatementShapes::forgetsTheOldest()
{
    Dialect dialect;
    for (int round = 0; round < 2; ++round) {
        for (int i = 0; i < 100; ++i) {
            const QString statement =
                QStringLiteral("select c%1 from T where a=%2 and b='%3'").arg(i).arg(round).arg(i);
            QCOMPARE(answerOf(dialect, statement), answerOfNew(statement));
        }
    }
}

QTEST_APPLESS_MAIN(tst_StatementShapes)
#include "tst_StatementShapes.moc"
