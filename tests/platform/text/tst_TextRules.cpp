// Label: unit
#include "platform/text/codepage.h"
#include "platform/text/textrules.h"
#include "support/datarows.h"

/// What is a number, proper case, cutting, line ends and code pages.
class tst_TextRules : public QObject
{
    Q_OBJECT

private slots:
    void isNumeric_data()
    {
        const DataRows<QString, bool> row("text", "numeric");
        for (const char *yes : {"0", "1985", " 1985", "1985 ", "\t5\t", "+1", "-1", "1.5", ".5",
                                "5.", "-.5e-3", "1e10", "1E+5", "00012", "99999999999999999999"})
            row(yes, true);
        for (const char *no :
             {"",   " ",   ".",    "-",    "+-1",   "--1", "1-",  "1.2.3", "1,5", "1e", "1e+",
              "e5", "1 2", "0x1F", "&H1F", "1985a", "nan", "inf", "½",     "٣",   "１", "1\n"})
            row(no, false);
        row("NUL", u"1"_s + QChar(0), false);
    }

    void isNumeric()
    {
        QFETCH(QString, text);
        QTEST(text::isNumeric(text), "numeric");
    }

    // Byte by byte; the five that the code page leaves open stay as they
    // are, so that no byte is lost.
    void windows1252()
    {
        const char16_t typographic[] = u"€\x81‚ƒ„…†‡ˆ‰Š‹Œ\x8DŽ\x8F\x90‘’“”•–—˜™š›œ\x9DžŸ";
        for (int b = 0; b < 256; ++b) {
            const char byte = char(b);
            const char16_t right = b >= 0x80 && b < 0xA0 ? typographic[b - 0x80] : char16_t(b);
            QCOMPARE(text::decode(QByteArrayView(&byte, 1), text::Encoding::Windows1252),
                     QString(QChar(right)));
        }
    }
};

QTEST_APPLESS_MAIN(tst_TextRules)
#include "tst_TextRules.moc"
