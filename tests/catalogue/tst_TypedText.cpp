// Label: unit
#include "catalogue/typedtext.h"
#include "support/datarows.h"

namespace
{

QString longText(int characters)
{
    return QString(characters, u'x');
}

} // namespace

/// What becomes of a text that was typed or pasted.
class tst_TypedText : public QObject
{
    Q_OBJECT

private slots:
    void keeps_data()
    {
        const DataRows<QString, QString, QString, bool> row("typed", "before", "kept", "cut");
        const QString pair = u"\U0001F3B5"_s;
        row("as it is", "d'Arc \"50%1\" <b>", "", "d'Arc \"50%1\" <b>", false);
        row("only blanks", " \t ", "", "", false);
        row("blanks around", "  a  b ", "", "a  b", false);
        row("line breaks", "a\r\nb\nc\u2028d\te\r", "", "a b c d e", false);
        row("composed", "E\u0301dith", "", "\u00C9dith", false);
        row("255", longText(255), "", longText(255), false);
        row("256", longText(256), "", longText(255), true);
        row("blanks behind 255", longText(255) + u"  "_s, "", longText(255), false);
        row("cut before a pair", longText(254) + pair, "", longText(254), true);
        row("a pair at the end", longText(253) + pair, "", longText(253) + pair, false);
        row("as it was before", u" a\t"_s + longText(300), u" a\t"_s + longText(300),
            u" a\t"_s + longText(300), false);
        row("as long as before", longText(300), u'a' + longText(299), longText(300), false);
        row("longer than before", longText(301), u'a' + longText(299), longText(300), true);
    }

    void keeps()
    {
        QFETCH(QString, typed);
        QFETCH(QString, before);
        const auto kept = typedtext::keep(typed, before);
        QTEST(kept.text, "kept");
        QTEST(kept.cut, "cut");
    }
};

QTEST_APPLESS_MAIN(tst_TypedText)
#include "tst_TypedText.moc"
