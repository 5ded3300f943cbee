// Label: unit
#include "controls/sortedrows.h"

#include <QTest>
#include <algorithm>
#include <numeric>
#include <random>
#include <unicode/ucol.h>

using namespace ADODB;

namespace
{

using Order = std::vector<std::uint32_t>;

Rows rowsOf(const std::vector<Value> &cells)
{
    Rows rows(std::make_shared<FieldList>(FieldList{{QStringLiteral("Titel"), adVarWChar, 0}}));
    for (const Value &cell : cells)
        rows.setValue(rows.addRow(), 0, cell);
    return rows;
}

/// The order that ICU alone gives, texts of equal rank as they come.
Order orderByIcu(const Rows &rows)
{
    UErrorCode status = U_ZERO_ERROR;
    UCollator *collator = ucol_open("", &status);
    ucol_setStrength(collator, UCOL_SECONDARY);
    Order order(std::size_t(rows.rowCount()));
    std::iota(order.begin(), order.end(), 0);
    std::stable_sort(order.begin(), order.end(), [&](auto a, auto b) {
        const auto x = rows.utf8(a, 0), y = rows.utf8(b, 0);
        return ucol_strcollUTF8(collator, x.data(), int32_t(x.size()), y.data(), int32_t(y.size()),
                                &status) == UCOL_LESS;
    });
    ucol_close(collator);
    return order;
}

QStringList textsIn(const Rows &rows, const Order &order)
{
    QStringList texts;
    for (const auto row : order)
        texts.append(rows.text(row, 0));
    return texts;
}

} // namespace

class tst_sortedRows : public QObject
{
    Q_OBJECT

private slots:
    void ordersAsPeopleRead_data();
    void ordersAsPeopleRead();
    void agreesWithIcu_data();
    void agreesWithIcu();
    void equalTextsKeepTheirOrder();
    void writtenTextsCount();
};

void tst_sortedRows::ordersAsPeopleRead_data()
{
    QTest::addColumn<QStringList>("texts"); // "NULL" is NULL
    QTest::addColumn<QStringList>("expected");
    const auto row = [](const char *name, const char *texts, const char *expected) {
        QTest::newRow(name) << QString::fromUtf8(texts).split(u'|')
                            << QString::fromUtf8(expected).split(u'|');
    };
    row("accents beside their letters", "Edna|Édith|Edith|Zoe|eagles",
        "eagles|Edith|Édith|Edna|Zoe");
    row("accents behind the first eight letters", "Abcdefghé|Abcdefghz|Abcdefgha|Abcdefghe",
        "Abcdefgha|Abcdefghe|Abcdefghé|Abcdefghz");
    row("letters that are two", "Aft|Æon|Ada|straße|strasse a|strata",
        "Ada|Æon|Aft|straße|strasse a|strata");
    row("punctuation before digits before letters", "abc|10cc|'t Hof|Abba|... and",
        "... and|'t Hof|10cc|Abba|abc");
    row("other scripts behind", "Ωmega|Аббат|Abba|東京|Zappa", "Abba|Zappa|Ωmega|Аббат|東京");
    row("empty ones first", "b||a|NULL|-1 x", "||-1 x|a|b");
    row("numbers by value", "10|9|+8|-1|007||1000000000000", "|-1|007|+8|9|10|1000000000000");
    row("one word makes them texts", "10|9|x|100", "10|100|9|x");
    row("fractions are texts", "10|9.5|100", "10|100|9.5");
    row("beyond 64 bits", "99999999999999999999|100000000000000000000|3",
        "100000000000000000000|3|99999999999999999999");
}

void tst_sortedRows::ordersAsPeopleRead()
{
    QFETCH(QStringList, texts);
    QFETCH(QStringList, expected);
    std::vector<Value> cells;
    for (const QString &text : texts)
        cells.push_back(text == QLatin1String("NULL") ? Value() : Value(text));
    const Rows rows = rowsOf(cells);
    QCOMPARE(textsIn(rows, sortedRows(rows, 0)), expected);
    if (texts.contains(QStringLiteral("10"))) { // numbers that are no texts
        for (qsizetype i = 0; i < texts.size(); ++i) {
            bool whole = false;
            const qint64 value = texts[i].toLongLong(&whole);
            if (whole && QString::number(value) == texts[i])
                cells[std::size_t(i)] = value;
        }
        const Rows mixed = rowsOf(cells);
        QCOMPARE(textsIn(mixed, sortedRows(mixed, 0)), expected);
    }
}

void tst_sortedRows::agreesWithIcu_data()
{
    QTest::addColumn<QString>("alphabet");
    QTest::addColumn<int>("longest");
    QTest::newRow("few letters, long texts") << QStringLiteral("aAbéá ") << 30;
    QTest::newRow("ASCII") << QStringLiteral("abzAZ09 '-.,!&()/") << 12;
    QTest::newRow("Latin") << QStringLiteral("aàáâãäåæçèøÿđħłœßıĳŀŉſǆȷ lL") << 11;
    QTest::newRow("marks of their own")
        << QStringLiteral("aelo \u00B7\u0300\u0301\u0327\u0338") << 12;
    QTest::newRow("scripts mixed") << QStringLiteral("abcéБгяאبあ京\u200B\u0007") << 10;
}

void tst_sortedRows::agreesWithIcu()
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

void tst_sortedRows::equalTextsKeepTheirOrder()
{
    std::vector<Value> cells;
    for (int i = 0; i < 3000; ++i) {
        constexpr const char *alike[] = {"yesterday's papers", "Yesterday's Papers",
                                         "YESTERDAY'S PAPERS", "Вчера", "вчера"};
        cells.push_back(QString::fromUtf8(alike[i % 5]));
    }
    const Order order = sortedRows(rowsOf(cells), 0);
    QVERIFY(std::is_sorted(order.begin(), order.begin() + 1800));
    QVERIFY(std::is_sorted(order.begin() + 1800, order.end()));
}

void tst_sortedRows::writtenTextsCount()
{
    const Rows numbers = rowsOf({3, 20, 100});
    QCOMPARE(sortedRows(numbers, 0, {{2, QStringLiteral("4")}}), (Order{0, 2, 1}));
    QCOMPARE(sortedRows(numbers, 0, {{2, QString()}}), (Order{2, 0, 1}));
    QCOMPARE(sortedRows(numbers, 0, {{2, QStringLiteral("2nd")}}), (Order{1, 2, 0}));
}

QTEST_APPLESS_MAIN(tst_sortedRows)
#include "tst_sortedRows.moc"
