// Label: unit
#include "platform/ado/ordertail.h"
#include "platform/ado/recordset.h"
#include "platform/text/collation.h"
#include "services/globals.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

/// Rows of "order by 1,2" are sorted in memory; the engine's own order is what they must be in.
class tst_RowOrder : public QObject
{
    Q_OBJECT

private slots:
    void theEndOfAStatement_data()
    {
        const DataRows<QByteArray, QString> row("sql", "columns"); // none: the engine sorts
        row("several", "select a from t order by 1,2,5,3,4 ", "0 1 4 2 3");
        row("capitals, blanks", "select a from t ORDER  BY 2 , 1", "1 0");
        row("a word of others in a text", "select a from t where b='d''Union' order by 1", "0");
        for (const char *other :
             {"select a from t order by 1 desc", "select a from t order by a, 1", "select a from t",
              "select a from t group by 1",
              "select distinct a from t union all select b from u order by 1",
              "select a from t where reorder by 1", "update t set a = 1",
              "select a from t order by 0", "select a from t order by 1,,2",
              "select a from t limit 2", "select a from t where x between 1 and 2",
              "select a from (select b order by 1)", "select a from t order by 1,",
              "select a from t order by 99999999999"})
            row(other, "");
    }

    void theEndOfAStatement()
    {
        QFETCH(QByteArray, sql);
        const auto tail = ADODB::orderTail({sql.data(), std::size_t(sql.size())});
        QStringList columns;
        for (const int column : tail.columns)
            columns.append(QString::number(column));
        QTEST(columns.join(u' '), "columns");
        if (!columns.isEmpty())
            QVERIFY(sql.left(qsizetype(tail.from)).trimmed().startsWith("select a from t"));
    }

    void rowsComeAsTheEngineSortsThem_data()
    {
        const DataRows<QString, QString> row("byNumber", "byName");
        const auto from = u" from Tracks as trk "_s;
        const auto add = [&](const char *columns, const char *numbers, const char *names) {
            const QString select = u"select "_s + QLatin1String(columns) + from;
            row(names, select + u"order by "_s + QLatin1String(numbers),
                select + u"order by "_s + QLatin1String(names));
        };
        add("titel, genre, id", "1,2,3", "trk.titel, trk.genre, trk.id");
        add("hitjaar, titel, id", "1,2,3", "trk.hitjaar, trk.titel, trk.id");
        add("artiest_id, genre, hitjaar, id", "1,3,2,4",
            "trk.artiest_id, trk.hitjaar, trk.genre, trk.id");
        add("distinct titel, genre", "1,2", "trk.titel, trk.genre");
        add("distinct titel, genre, artiest_id", "2,1,3", "trk.genre, trk.titel, trk.artiest_id");
        add("iif(titel='a','x','y') as t, id", "1,2", "iif(titel='a','x','y'), trk.id");
    }

    void rowsComeAsTheEngineSortsThem()
    {
        QFETCH(QString, byNumber);
        QFETCH(QString, byName);
        TestCatalogue catalogue;
        fill(catalogue);
        const auto rows = rowsOf(gConnection->Execute(byNumber));
        QVERIFY(rows.size() > 200);
        // Of rows that differ in case alone a "distinct" may leave either.
        QCOMPARE(rows.join(u'\n').toCaseFolded(),
                 rowsOf(gConnection->Execute(byName)).join(u'\n').toCaseFolded());
    }

    void alikeRowsStayAsTheyAre_data()
    {
        const DataRows<QString> row("column");
        row("titel");
        row("artiest_id");
    }

    void alikeRowsStayAsTheyAre()
    {
        QFETCH(QString, column);
        TestCatalogue catalogue;
        fill(catalogue);
        const QString select = u"select %1, id from Tracks where titel <> '' "_s.arg(column);
        const auto asRead = rowsOf(gConnection->Execute(select)),
                   sorted = rowsOf(gConnection->Execute(select + u"order by 1"_s));
        const auto key = [&](qsizetype row) {
            return sorted[row].section(u'|', 0, 0).toStdString();
        };
        for (qsizetype row = 1; row < sorted.size(); ++row) {
            if (text::Collation::root().compare(key(row - 1), key(row)) == 0)
                QVERIFY(asRead.indexOf(sorted[row - 1]) < asRead.indexOf(sorted[row]));
        }
    }

    void theFirstRowsAreTheFirstOfTheOrder()
    {
        TestCatalogue catalogue;
        fill(catalogue);
        const auto statement = u"select titel, id from Tracks order by 1,2"_s;
        QCOMPARE(rowsOf(gConnection->firstRows(statement, 40)),
                 rowsOf(gConnection->Execute(statement)).mid(0, 40));
    }

private:
    static QStringList rowsOf(const ADODB::Recordset &recordset)
    {
        QStringList lines;
        const auto rows = recordset.rows();
        for (qsizetype row = 0; row < rows->rowCount(); ++row) {
            QStringList cells;
            for (int column = 0; column < rows->columnCount(); ++column)
                cells.append(rows->text(row, column));
            lines.append(cells.join(u'|'));
        }
        return lines;
    }

    // All kinds of cells in one column each, many rows alike in the first columns.
    static void fill(TestCatalogue &catalogue)
    {
        catalogue.exec(QString::fromUtf8(R"(
            create temp table Word(w, n);
            insert into Word values ('abba',1),('ABBA',2),('Ábba',3),('abbà long enough to go on',4),
                ('abba long enough to go on',5),(null,6),('',7),('Édith',8),('edith',9),('Жук',10),
                ('жук',11),('日本',12),('10',13),('9',14),(' a',15),('a',16),('œuvre',17),('zz%',18);
            insert into Artiesten select n, w from Word;
            insert into Tracks select a.n * 100 + b.n, a.n % 5, b.w, a.w,
                case b.n % 5 when 0 then null when 1 then 1985.5 when 2 then 1985 when 3 then b.w
                    else 2000 - b.n end
                from Word a, Word b;)"));
    }
};

QTEST_MAIN(tst_RowOrder)
#include "tst_RowOrder.moc"
