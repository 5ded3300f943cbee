// Label: unit
#include "platform/ado/recordset.h"

#include <QTest>

using namespace ADODB;

/// Recordsets without a connection, the rows behind them and their values.
class tst_Recordset : public QObject
{
    Q_OBJECT

private slots:
    void moves();
    void emptyOnes();
    void deletes_data();
    void deletes();
    void needsToBeOpen();
    void fieldsByName();
    void handedOutRowsNeverChange();
    void copiesPart();
    void keepsNumbers_data();
    void keepsNumbers();
    void keepsTexts();
    void clonesBothWrite();
    void toLong_data();
    void toLong();
    void toText();
};

namespace
{

Recordset letters(const char *all)
{
    Recordset rs;
    rs.appendField(QStringLiteral("N"), adInteger);
    rs.appendField(QStringLiteral("Letter"), adVarWChar, 10);
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
        return QStringLiteral("empty");
    if (rs.isBOF() || rs.isEOF())
        return rs.isBOF() ? QStringLiteral("bof") : QStringLiteral("eof");
    try {
        return rs.Fields(1).Value().toText();
    } catch (const Error &) {
        return QStringLiteral("none");
    }
}

int numberOf(const std::function<void()> &fails)
{
    try {
        fails();
    } catch (const Error &error) {
        return error.Number;
    }
    return 0;
}

std::shared_ptr<Rows> oneColumn()
{
    return std::make_shared<Rows>(
        std::make_shared<const FieldList>(FieldList{{QStringLiteral("v"), adVarWChar, 0}}));
}

} // namespace

void tst_Recordset::moves()
{
    Recordset rs = letters("abc");
    QCOMPARE(rs.RecordCount(), 3);
    QCOMPARE(at(rs), QStringLiteral("c")); // AddNew goes there
    rs.MoveFirst();
    rs.MovePrevious();
    QCOMPARE(at(rs), QStringLiteral("bof"));
    QCOMPARE(numberOf([&] { rs.MovePrevious(); }), int(errNoCurrentRecord));
    QCOMPARE(numberOf([&] { rs.Fields(0).Value(); }), int(errNoCurrentRecord));
    rs.MoveNext();
    QCOMPARE(at(rs), QStringLiteral("a"));
    rs.MoveLast();
    rs.MoveNext();
    QCOMPARE(at(rs), QStringLiteral("eof"));
    QCOMPARE(numberOf([&] { rs.MoveNext(); }), int(errNoCurrentRecord));
    QCOMPARE(numberOf([&] { rs.Delete(); }), int(errNoCurrentRecord));
    rs.MovePrevious();
    QCOMPARE(at(rs), QStringLiteral("c"));
}

void tst_Recordset::emptyOnes()
{
    Recordset rs = letters("");
    QCOMPARE(at(rs), QStringLiteral("empty"));
    QCOMPARE(rs.RecordCount(), 0);
    for (auto move : {&Recordset::MoveFirst, &Recordset::MoveLast, &Recordset::MoveNext,
                      &Recordset::MovePrevious, &Recordset::Delete})
        QCOMPARE(numberOf([&] { (rs.*move)(); }), int(errNoCurrentRecord));
    QCOMPARE(at(rs), QStringLiteral("empty"));
}

void tst_Recordset::deletes_data()
{
    QTest::addColumn<int>("deleted"); // index of the record in "abc"
    QTest::addColumn<QString>("next");
    QTest::addColumn<QString>("previous");
    QTest::newRow("first") << 0 << QStringLiteral("b") << QStringLiteral("bof");
    QTest::newRow("middle") << 1 << QStringLiteral("c") << QStringLiteral("a");
    QTest::newRow("last") << 2 << QStringLiteral("eof") << QStringLiteral("b");
}

void tst_Recordset::deletes()
{
    QFETCH(int, deleted);
    for (const bool forward : {true, false}) {
        Recordset rs = letters("abc");
        rs.MoveFirst();
        for (int i = 0; i < deleted; ++i)
            rs.MoveNext();
        rs.Delete();
        QCOMPARE(rs.RecordCount(), 2);
        QCOMPARE(at(rs), QStringLiteral("none")); // stays there, neither end
        QCOMPARE(numberOf([&] { rs.Delete(); }), int(errNoCurrentRecord));
        QCOMPARE(numberOf([&] { rs.Fields(0).setValue(1); }), int(errNoCurrentRecord));
        forward ? rs.MoveNext() : rs.MovePrevious();
        QTEST(at(rs), forward ? "next" : "previous");
    }
    Recordset rs = letters("a");
    rs.Delete();
    QVERIFY(!rs.isEOF() && !rs.isBOF());
    rs.MoveNext();
    QCOMPARE(at(rs), QStringLiteral("empty"));
    rs.AddNew();
    QVERIFY(rs.Fields(1).Value().isNull());
}

void tst_Recordset::needsToBeOpen()
{
    Recordset rs;
    QCOMPARE(rs.State(), adStateClosed);
    QCOMPARE(numberOf([&] { rs.Open(); }), int(errNotPermitted)); // no fields
    QCOMPARE(numberOf([&] { rs.isEOF(); }), int(errObjectClosed));
    QCOMPARE(numberOf([&] { rs.AddNew(); }), int(errObjectClosed));
    rs = letters("a");
    QCOMPARE(numberOf([&] { rs.appendField(QStringLiteral("X"), adInteger); }),
             int(errNotPermitted));
    rs.Close();
    QCOMPARE(numberOf([&] { rs.Close(); }), int(errObjectClosed));
    QCOMPARE(numberOf([&] { rs.RecordCount(); }), int(errObjectClosed));
}

void tst_Recordset::fieldsByName()
{
    Recordset rs = letters("a");
    QCOMPARE(rs.fieldCount(), 2);
    QCOMPARE(rs.columnOf(u"LETTER"), 1);
    QCOMPARE(rs.Fields(u"n").Name(), QStringLiteral("N"));
    QCOMPARE(numberOf([&] { rs.Fields(u"nix"); }), int(errItemNotFound));
    QCOMPARE(numberOf([&] { rs.Fields(2); }), int(errItemNotFound));
    QCOMPARE(numberOf([&] { rs.Fields(-1); }), int(errItemNotFound));
}

void tst_Recordset::handedOutRowsNeverChange()
{
    Recordset rs = letters("abc");
    const auto before = rs.rows();
    rs.MoveFirst();
    rs.Fields(1).setValue(QStringLiteral("changed"));
    rs.MoveNext();
    rs.Delete();
    rs.AddNew();
    QCOMPARE(before->rowCount(), 3);
    QCOMPARE(before->text(0, 1), QStringLiteral("a"));
    QCOMPARE(before->text(1, 1), QStringLiteral("b"));
    rs.Close();
    QCOMPARE(before->text(2, 1), QStringLiteral("c"));
}

void tst_Recordset::copiesPart()
{
    Recordset one = letters("ab"), other = one;
    QCOMPARE(one.rows(), other.rows());
    other.Fields(1).setValue(QStringLiteral("other"));
    one.Fields(1).setValue(QStringLiteral("one"));
    QCOMPARE(one.Fields(1).Value().toText(), QStringLiteral("one"));
    QCOMPARE(other.Fields(1).Value().toText(), QStringLiteral("other"));
}

void tst_Recordset::keepsNumbers_data()
{
    QTest::addColumn<qint64>("number");
    const qint64 edge = qint64(1) << 61;
    for (const qint64 n : {qint64(0), qint64(-1), edge - 1, edge, -edge, -edge - 1,
                           std::numeric_limits<qint64>::max(), std::numeric_limits<qint64>::min()})
        QTest::newRow(qPrintable(QString::number(n))) << n;
}

void tst_Recordset::keepsNumbers()
{
    QFETCH(qint64, number);
    const auto rows = oneColumn();
    rows->setInteger(rows->addRow(), 0, number);
    rows->setReal(rows->addRow(), 0, double(number) + 0.5);
    QCOMPARE(rows->kind(0, 0), Rows::Kind::Integer);
    QCOMPARE(rows->integer(0, 0), number);
    QCOMPARE(rows->value(0, 0), Value(number));
    QCOMPARE(rows->kind(1, 0), Rows::Kind::Real);
    QCOMPARE(rows->value(1, 0), Value(double(number) + 0.5));
}

void tst_Recordset::keepsTexts()
{
    const auto rows = oneColumn();
    QStringList texts{QString(),
                      QStringLiteral("a"),
                      QStringLiteral("\U0001F3B5\u00e9"),
                      QString(3 << 20, u'x'),
                      QStringLiteral("after the long one"),
                      QStringLiteral("\uFEFF"),
                      QStringLiteral("\uFEFF\uFEFFx"),
                      QStringLiteral("a") + QChar(0) + u'b'};
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
    QVERIFY(rows->value(texts.size(), 0).isNull());
    rows->removeRow(0);
    QCOMPARE(rows->rowCount(), texts.size());
    QCOMPARE(rows->text(0, 0), QStringLiteral("a"));
}

void tst_Recordset::clonesBothWrite()
{
    const auto first = oneColumn();
    first->setUtf8(first->addRow(), 0, "shared");
    const auto second = first->clone(), third = second->clone();
    for (int i = 0; i < 5000; ++i) {
        first->setUtf8(first->addRow(), 0, "first" + std::to_string(i));
        second->setUtf8(second->addRow(), 0, "second" + std::to_string(i));
        third->setUtf8(0, 0, "third" + std::to_string(i));
    }
    for (int i = 0; i < 5000; ++i) {
        QCOMPARE(first->utf8(i + 1, 0), "first" + std::to_string(i));
        QCOMPARE(second->utf8(i + 1, 0), "second" + std::to_string(i));
    }
    QCOMPARE(first->text(0, 0), QStringLiteral("shared"));
    QCOMPARE(second->text(0, 0), QStringLiteral("shared"));
    QCOMPARE(third->text(0, 0), QStringLiteral("third4999"));
    QCOMPARE(third->rowCount(), 1);
}

void tst_Recordset::toLong_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<qint64>("number");
    QTest::addColumn<int>("error");
    const auto row = [](const char *text, qint64 number, int error = 0) {
        QTest::newRow(text) << QString::fromLatin1(text) << number << error;
    };
    row("1985", 1985);
    row(" +7 ", 7);
    row("-0", 0);
    row("1e3", 1000);
    row("0.5", 0);
    row("1.5", 2);
    row("2.5", 2);
    row("-2.5", -2);
    row("9223372036854775807", std::numeric_limits<qint64>::max());
    row("9223372036854775808", 0, errOverflow);
    row("1e400", 0, errOverflow);
    row("", 0, errTypeMismatch);
    row("12a", 0, errTypeMismatch);
    row("1,5", 0, errTypeMismatch);
    row("0x10", 0, errTypeMismatch);
    row("inf", 0, errTypeMismatch);
}

void tst_Recordset::toLong()
{
    QFETCH(QString, text);
    qint64 number = 0;
    QTEST(numberOf([&] { number = Value(text).toLong(); }), "error");
    QTEST(number, "number");
}

void tst_Recordset::toText()
{
    QCOMPARE(Value().toText(), QString());
    QCOMPARE(numberOf([] { Value().toLong(); }), int(errTypeMismatch));
    QCOMPARE(Value(0.1).toText(), QStringLiteral("0.1"));
    QCOMPARE(Value(1985.0).toText(), QStringLiteral("1985"));
    QCOMPARE(Value(1e300).toText(), QStringLiteral("1e+300"));
    QCOMPARE(numberOf([] { Value(1e300).toLong(); }), int(errOverflow));
    QVERIFY(Value(QString()) != Value());
}

QTEST_APPLESS_MAIN(tst_Recordset)
#include "tst_Recordset.moc"
