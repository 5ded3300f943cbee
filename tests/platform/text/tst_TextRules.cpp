// Label: unit
#include "platform/text/codepage.h"
#include "platform/text/textrules.h"

#include <QTest>

/// What is a number, proper case, cutting, line ends and code pages.
class tst_TextRules : public QObject
{
    Q_OBJECT

private slots:
    void isNumeric_data();
    void isNumeric();
    void properCase_data();
    void properCase();
    void cutTo();
    void lineFeeds();
    void windows1252();
    void encodingOf_data();
    void encodingOf();
};

void tst_TextRules::isNumeric_data()
{
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("numeric");
    for (const char *yes : {"0", "1985", " 1985", "1985 ", "\t5\t", "+1", "-1", "1.5", ".5", "5.",
                            "-.5e-3", "1e10", "1E+5", "00012", "99999999999999999999"})
        QTest::newRow(yes) << QString::fromUtf8(yes) << true;
    for (const char *no :
         {"",   " ",   ".",    "-",    "+-1",   "--1", "1-",  "1.2.3", "1,5", "1e", "1e+",
          "e5", "1 2", "0x1F", "&H1F", "1985a", "nan", "inf", "½",     "٣",   "１", "1\n"})
        QTest::newRow(no) << QString::fromUtf8(no) << false;
    QTest::newRow("NUL") << QStringLiteral("1") + QChar(0) << false;
}

void tst_TextRules::isNumeric()
{
    QFETCH(QString, text);
    QTEST(text::isNumeric(text), "numeric");
}

void tst_TextRules::properCase_data()
{
    QTest::addColumn<QString>("from");
    QTest::addColumn<QString>("to");
    const auto row = [](const char *from, const char *to) {
        QTest::newRow(from) << QString::fromUtf8(from) << QString::fromUtf8(to);
    };
    row("", "");
    row("THE dark SIDE", "The Dark Side");
    row("o'neill-mc (live)", "O'neill-mc (live)");
    row("  two\tblanks", "  Two\tBlanks");
    row("élan VITAL", "Élan Vital");
    row("straße ßa", "Straße ßa");
    row("10cc a1B", "10cc A1b");
    row("\U00010428\U00010400", "\U00010400\U00010428");
    row("line\rbreak", "Line\rBreak");
}

void tst_TextRules::properCase()
{
    QFETCH(QString, from);
    QTEST(text::properCase(from), "to");
    QCOMPARE(text::properCase(from).size(), from.size());
}

void tst_TextRules::cutTo()
{
    const QString s = QStringLiteral("ab\U0001F3B5c");
    const QString expected[] = {QString(),
                                QStringLiteral("a"),
                                QStringLiteral("ab"),
                                QStringLiteral("ab"),
                                QStringLiteral("ab\U0001F3B5"),
                                s,
                                s};
    for (int n = 0; n < 7; ++n)
        QCOMPARE(text::cutTo(s, n), expected[n]);
}

void tst_TextRules::lineFeeds()
{
    QCOMPARE(text::withLineFeeds(QStringLiteral("a\rb\r\nc\nd\r\re")),
             QStringLiteral("a\nb\nc\nd\n\ne"));
}

// Byte by byte; the five that the code page leaves open stay as they
// are, so that no byte is lost.
void tst_TextRules::windows1252()
{
    const char16_t typographic[] = u"€\x81‚ƒ„…†‡ˆ‰Š‹Œ\x8DŽ\x8F\x90‘’“”•–—˜™š›œ\x9DžŸ";
    for (int b = 0; b < 256; ++b) {
        const char byte = char(b);
        const char16_t right = b >= 0x80 && b < 0xA0 ? typographic[b - 0x80] : char16_t(b);
        QCOMPARE(text::decode(QByteArrayView(&byte, 1), text::Encoding::Windows1252),
                 QString(QChar(right)));
    }
}

void tst_TextRules::encodingOf_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::addColumn<bool>("utf8");
    QTest::newRow("empty") << QByteArray() << true;
    QTest::newRow("ASCII") << QByteArray("abc\0d", 5) << true;
    QTest::newRow("UTF-8") << QByteArray("Bj\xC3\xB6rk \xF0\x9F\x8E\xB5") << true;
    QTest::newRow("with BOM") << QByteArray("\xEF\xBB\xBF\xC3\xA9") << true;
    QTest::newRow("Latin") << QByteArray("Bj\xF6rk") << false;
    QTest::newRow("cut off") << QByteArray("Bj\xC3") << false;
    QTest::newRow("overlong") << QByteArray("\xC0\xAF") << false;
    QTest::newRow("surrogate") << QByteArray("\xED\xA0\x80") << false;
    QTest::newRow("one bad byte far behind") << QByteArray(100000, 'x') + '\xE9' << false;
}

void tst_TextRules::encodingOf()
{
    QFETCH(QByteArray, bytes);
    QTEST(text::encodingOf(bytes) == text::Encoding::Utf8, "utf8");
    QCOMPARE(text::withoutByteOrderMark("\xEF\xBB\xBFx"), QByteArrayView("x"));
    QCOMPARE(text::withoutByteOrderMark(bytes).size(),
             bytes.size() - (bytes.startsWith("\xEF\xBB\xBF") ? 3 : 0));
}

QTEST_APPLESS_MAIN(tst_TextRules)
#include "tst_TextRules.moc"
