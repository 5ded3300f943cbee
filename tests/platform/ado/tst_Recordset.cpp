// Label: unit
#include "platform/ado/recordset.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

#include <malloc.h>

using namespace ADODB;

namespace
{

Recordset letters(const char *all)
{
    Recordset rs;
    rs.appendField(u"N"_s, adInteger);
    rs.appendField(u"Letter"_s, adVarWChar, 10);
    rs.Open();
    for (int i = 0; all[i]; ++i) {
        rs.AddNew();
        rs.Fields(0).setValue(i);
        rs.Fields(u"letter").setValue(QString(QLatin1Char(all[i])));
        rs.Update();
    }
    return rs;
}

// Where the recordset stands: the letter, or "bof", "eof", "none" of a deleted record.
QString at(Recordset &rs)
{
    if (rs.isBOF() && rs.isEOF())
        return u"empty"_s;
    if (rs.isBOF() || rs.isEOF())
        return rs.isBOF() ? u"bof"_s : u"eof"_s;
    try {
        return rs.Fields(1).Value().toText();
    } catch (const Error &) {
        return u"none"_s;
    }
}

std::shared_ptr<Rows> oneColumn()
{
    return std::make_shared<Rows>(
        std::make_shared<const FieldList>(FieldList{{u"v"_s, adVarWChar, 0}}));
}

} // namespace

/// Recordsets without a connection, the rows behind them and their values.
class tst_Recordset : public QObject
{
    Q_OBJECT

private slots:
    void moves()
    {
        Recordset rs = letters("abc");
        QCOMPARE(rs.RecordCount(), 3);
        QCOMPARE(at(rs), u"c"_s); // AddNew goes there
        rs.MoveFirst();
        rs.MovePrevious();
        QCOMPARE(at(rs), u"bof"_s);
        QCOMPARE(numberOf([&] { rs.MovePrevious(); }), int(errNoCurrentRecord));
        QCOMPARE(numberOf([&] { rs.Fields(0).Value(); }), int(errNoCurrentRecord));
        rs.MoveNext();
        QCOMPARE(at(rs), u"a"_s);
        rs.MoveLast();
        rs.MoveNext();
        QCOMPARE(at(rs), u"eof"_s);
        QCOMPARE(numberOf([&] { rs.MoveNext(); }), int(errNoCurrentRecord));
        rs.MovePrevious();
        QCOMPARE(at(rs), u"c"_s);

        Recordset none = letters("");
        for (auto move : {&Recordset::MoveFirst, &Recordset::MoveLast, &Recordset::MoveNext,
                          &Recordset::MovePrevious, &Recordset::Delete})
            QCOMPARE(numberOf([&] { (none.*move)(); }), int(errNoCurrentRecord));
        QCOMPARE(at(none), u"empty"_s);
    }

    void deletes()
    {
        const char *const around[] = {"bof b", "a c", "b eof"}; // before and behind each of "abc"
        for (int deleted = 0; deleted < 3; ++deleted) {
            for (const bool forward : {true, false}) {
                Recordset rs = letters("abc");
                rs.MoveFirst();
                for (int i = 0; i < deleted; ++i)
                    rs.MoveNext();
                rs.Delete();
                QCOMPARE(rs.RecordCount(), 2);
                QCOMPARE(at(rs), u"none"_s); // stays there, neither end
                QCOMPARE(numberOf([&] { rs.Delete(); }), int(errNoCurrentRecord));
                forward ? rs.MoveNext() : rs.MovePrevious();
                QCOMPARE(at(rs),
                         QString::fromLatin1(around[deleted]).section(u' ', forward, forward));
            }
        }
    }

    void keepsNumbers()
    {
        const auto rows = oneColumn();
        rows->addRow();
        const qint64 edge = qint64(1) << 61;
        for (const qint64 number :
             {qint64(-1), edge - 1, edge, -edge, -edge - 1, std::numeric_limits<qint64>::min()}) {
            rows->setInteger(0, 0, number);
            QCOMPARE(rows->kind(0, 0), Rows::Kind::Integer);
            QCOMPARE(rows->value(0, 0), Value(number));
            rows->setReal(0, 0, double(number) + 0.5);
            QCOMPARE(rows->kind(0, 0), Rows::Kind::Real);
            QCOMPARE(rows->value(0, 0), Value(double(number) + 0.5));
        }
    }

    void keepsTexts()
    {
        const auto rows = oneColumn();
        QStringList texts{QString(), u"a"_s, QString(3 << 20, u'x'), u"\uFEFF\uFEFFx"_s, u"a\0b"_s};
        for (int i = 0; i < 3000; ++i) // over the end of a chunk, more than once
            texts.append(QString(1000, QChar(char16_t(u'a' + i % 26))));
        for (const QString &text : texts)
            rows->setValue(rows->addRow(), 0, text);
        rows->addRow();
        for (int i = 0; i < texts.size(); ++i) {
            QCOMPARE(rows->kind(i, 0), Rows::Kind::Text); // the empty text is not NULL
            QCOMPARE(rows->text(i, 0), texts[i]);
        }
        QCOMPARE(rows->kind(texts.size(), 0), Rows::Kind::Null);
        rows->removeRow(0);
        QCOMPARE(rows->rowCount(), texts.size());
        QCOMPARE(rows->text(0, 0), u"a"_s);
    }

    // As a refresh of tags rewrites all cells again and again: the memory in use must not grow.
    void rewritingTakesNoMemory_data()
    {
        const DataRows<bool, bool> row("sameValues", "shared");
        row("the same values", true, false);
        row("others each time", false, false);
        row("others, in rows that a list still holds", false, true);
    }

    void rewritingTakesNoMemory()
    {
        QFETCH(bool, sameValues);
        QFETCH(bool, shared);
        constexpr int count = 3000, columns = 4, rounds = 40;
        Recordset rs;
        for (int column = 0; column < columns; ++column)
            rs.appendField(QString::number(column), adVarWChar, 100);
        rs.Open();
        std::shared_ptr<const Rows> held;
        const auto value = [&](int row, int round) {
            return u"The title of number %1, in the round %2"_s.arg(
                QString::number(row), QString::number(sameValues ? 0 : round));
        };
        for (int row = 0; row < count; ++row)
            rs.AddNew();
        std::size_t afterFirst = 0;
        for (int round = 0; round < rounds; ++round) {
            if (shared)
                held = rs.rows();
            rs.MoveFirst();
            for (int row = 0; row < count; ++row, rs.MoveNext()) {
                for (int column = 0; column < columns; ++column)
                    rs.Fields(column).setValue(value(row + column, round));
            }
            if (round == 1)
                afterFirst = mallinfo2().uordblks + mallinfo2().hblkhd;
        }
        const std::size_t grown = mallinfo2().uordblks + mallinfo2().hblkhd - afterFirst;
        QVERIFY2(qint64(grown) < qint64(2) << 20, qPrintable(QString::number(grown)));
        rs.MoveLast();
        for (int column = 0; column < columns; ++column)
            QCOMPARE(rs.Fields(column).Value().toText(), value(count - 1 + column, rounds - 1));
    }

    // Numbers of 64 bits, NULLs and texts that cells share come through a heap made anew.
    void whatStaysIsKept()
    {
        const auto rows = oneColumn();
        constexpr qint64 large = std::numeric_limits<qint64>::max();
        for (int row = 0; row < 100; ++row)
            rows->setUtf8OrShare(rows->addRow(), 0, "shared");
        rows->setInteger(1, 0, large);
        rows->setReal(2, 0, 1.5);
        rows->setNull(3, 0);
        for (int i = 0; i < 10000; ++i)
            rows->setUtf8(0, 0, std::string(100, char('a' + i % 26)));
        QCOMPARE(rows->text(0, 0), QString(100, QLatin1Char(char('a' + 9999 % 26))));
        QCOMPARE(rows->value(1, 0), Value(large));
        QCOMPARE(rows->value(2, 0), Value(1.5));
        QCOMPARE(rows->kind(3, 0), Rows::Kind::Null);
        for (int row = 4; row < 100; ++row)
            QCOMPARE(rows->utf8(row, 0), "shared");
    }

    void clonesBothWrite()
    {
        const auto first = oneColumn();
        first->setUtf8(first->addRow(), 0, "shared");
        const auto second = first->clone();
        for (int i = 0; i < 5000; ++i) {
            first->setUtf8(first->addRow(), 0, "first" + std::to_string(i));
            second->setUtf8(second->addRow(), 0, "second" + std::to_string(i));
        }
        for (int i = 0; i < 5000; ++i) {
            QCOMPARE(first->utf8(i + 1, 0), "first" + std::to_string(i));
            QCOMPARE(second->utf8(i + 1, 0), "second" + std::to_string(i));
        }
        QCOMPARE(first->text(0, 0), u"shared"_s);
    }

    void toLong()
    {
        const auto as = [](const char *text) { return Value(QString::fromLatin1(text)).toLong(); };
        QCOMPARE(as(" +7 "), 7);
        QCOMPARE(as("1e3"), 1000);
        QCOMPARE(as("1.5"), 2);
        QCOMPARE(as("2.5"), 2); // to the even one
        QCOMPARE(as("9223372036854775807"), std::numeric_limits<qint64>::max());
        QCOMPARE(numberOf([&] { as("9223372036854775808"); }), int(errOverflow));
        for (const char *no : {"", "12a", "0x10"})
            QCOMPARE(numberOf([&] { as(no); }), int(errTypeMismatch));
        QCOMPARE(numberOf([] { Value().toLong(); }), int(errTypeMismatch));
        QCOMPARE(Value(1985.0).toText(), u"1985"_s);
    }
};

QTEST_APPLESS_MAIN(tst_Recordset)
#include "tst_Recordset.moc"
