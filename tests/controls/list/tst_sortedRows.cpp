// Label: unit
#include "controls/list/sortedrows.h"
#include "support/datarows.h"
#include "support/icuorder.h"

#include <algorithm>
#include <numeric>
#include <random>

using namespace ADODB;

namespace
{

using Order = std::vector<std::uint32_t>;

Rows rowsOf(const std::vector<Value> &cells)
{
    Rows rows(std::make_shared<FieldList>(FieldList{{u"Titel"_s, adVarWChar, 0}}));
    for (const Value &cell : cells)
        rows.setValue(rows.addRow(), 0, cell);
    return rows;
}

/// The order that ICU alone gives, texts of equal rank as they come.
Order orderByIcu(const Rows &rows)
{
    const IcuOrder icu;
    Order order(std::size_t(rows.rowCount()));
    std::iota(order.begin(), order.end(), 0);
    std::stable_sort(order.begin(), order.end(), [&](auto a, auto b) {
        return icu.compare(rows.utf8(a, 0), rows.utf8(b, 0)) < 0;
    });
    return order;
}

} // namespace

/// The order of a column's cells: texts as people read them, whole numbers by value.
class tst_sortedRows : public QObject
{
    Q_OBJECT

private slots:
    void ordersAsPeopleRead_data()
    {
        // Joined by "|"; "NULL" is NULL.
        const DataRows<QString, QString> row("texts", "expected");
        row("accents beside their letters", "Edna|Édith|Edith|Zoe|eagles",
            "eagles|Edith|Édith|Edna|Zoe");
        row("accents behind the first eight letters", "Abcdefghé|Abcdefghz|Abcdefgha|Abcdefghe",
            "Abcdefgha|Abcdefghe|Abcdefghé|Abcdefghz");
        row("punctuation before digits before letters", "abc|10cc|'t Hof|Abba|... and",
            "... and|'t Hof|10cc|Abba|abc");
        row("empty ones first", "b||a|NULL|-1 x", "||-1 x|a|b");
        row("numbers by value", "10|9|+8|-1|007||1000000000000", "|-1|007|+8|9|10|1000000000000");
        row("one word makes them texts", "10|9|x|100", "10|100|9|x");
        row("fractions are texts", "10|9.5|100", "10|100|9.5");
        row("beyond 64 bits", "99999999999999999999|100000000000000000000|3",
            "100000000000000000000|3|99999999999999999999");
    }

    void ordersAsPeopleRead()
    {
        QFETCH(QString, texts);
        for (const bool asNumbers : {false, true}) { // cells that are no texts sort alike
            std::vector<Value> cells;
            for (const QString &text : texts.split(u'|')) {
                const qint64 number = text.toLongLong();
                if (text == u"NULL")
                    cells.push_back(Value());
                else if (asNumbers && QString::number(number) == text)
                    cells.push_back(number);
                else
                    cells.push_back(text);
            }
            const Rows rows = rowsOf(cells);
            QStringList found;
            for (const auto row : sortedRows(rows, 0))
                found.append(rows.text(row, 0));
            QTEST(found.join(u'|'), "expected");
        }
    }

    void agreesWithIcu_data()
    {
        const DataRows<QString, int> row("alphabet", "longest");
        row("few letters, long texts", "aAbéá ", 30); // many of equal rank
        row("ASCII", "abzAZ09 '-.,!&()/", 12);
        row("Latin", "aàáâãäåæçèøÿđħłœßıĳŀŉſǆȷ lL", 11);
        row("marks of their own", "aelo \u00B7\u0300\u0301\u0327\u0338", 12);
        row("scripts mixed", "abcéБгяאبあ京\u200B\u0007", 10);
    }

    void agreesWithIcu()
    {
        QFETCH(QString, alphabet);
        QFETCH(int, longest);
        std::mt19937 random(20261122);
        std::vector<Value> cells;
        for (int i = 0; i < 4000; ++i) {
            QString text(1, alphabet[0]);
            for (int length = int(random() % unsigned(longest)); length > 0; --length)
                text += alphabet[qsizetype(random() % unsigned(alphabet.size()))];
            cells.push_back(text);
        }
        const Rows rows = rowsOf(cells);
        QVERIFY(sortedRows(rows, 0) == orderByIcu(rows));
    }

    void writtenTextsCount()
    {
        const Rows numbers = rowsOf({3, 20, 100});
        QCOMPARE(sortedRows(numbers, 0, {{2, u"4"_s}}), (Order{0, 2, 1}));
        QCOMPARE(sortedRows(numbers, 0, {{2, QString()}}), (Order{2, 0, 1}));
        QCOMPARE(sortedRows(numbers, 0, {{2, u"2nd"_s}}), (Order{1, 2, 0}));
    }
};

QTEST_APPLESS_MAIN(tst_sortedRows)
#include "tst_sortedRows.moc"
