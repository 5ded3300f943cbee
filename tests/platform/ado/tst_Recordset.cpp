// Label: unit
#include "platform/ado/recordset.h"
#include "support/testcatalogue.h"

#include <QTest>

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
