// Label: unit
#include "platform/text/likepattern.h"
#include "support/datarows.h"
#include "support/referencelike.h"

#include <random>

namespace
{

bool fastLike(const QString &pattern, const QString &text)
{
    return text::LikePattern(pattern.toStdString()).matches(text.toStdString());
}

} // namespace

/// The fast matcher of LIKE, by example and against a slow one.
class tst_LikePattern : public QObject
{
    Q_OBJECT

private slots:
    void matches_data()
    {
        const DataRows<QString, QString, bool> pair("pattern", "text", "fits");
        const auto row = [&](const char *pattern, const char *text, bool fits) {
            pair(QByteArray(pattern) + " : " + text, pattern, text, fits);
        };
        row("", "", true);
        row("", "a", false);
        row("%", "", true);
        row("_", "", false);
        row("_", "\U0001F3B5", true);
        row("love", "LOVE", true);
        row("love", "loves", false);
        row("love%", "Lovely", true);
        row("%love", "glove", true);
        row("%love%", "my GLOVES", true);
        row("%ab%ab%", "ab", false);
        row("ab%ab", "ab", false);
        row("ab%b", "ab", false);
        row("%aab", "aaab", true);
        row("%_", "", false);
        row("_%_", "a", false);
        row("björk", "BJÖRK", true);
        row("bjork", "björk", false);
        row("ça%", "ÇA VA", true);
        row("%ΩΔΉ%", "ωδή", true);
        row("ж%", "ЖУК", true);
        row("σ", "ς", true);
        row("\u212A", "k", true);
        row("%k_", "ri\u212As", true); // the Kelvin sign and the long s are folded into ASCII
        row("%k%", "Bri\u212As", true);
        row("kiss", "ki\u017F\u017F", true);
        row("kit", "ki\u017F", false);
        row("ß", "ss", false);
        row("a.c*[b]", "a.c*[B]", true); // nothing else is wild
        row("a.c", "abc", false);
    }

    void matches()
    {
        QFETCH(QString, pattern);
        QFETCH(QString, text);
        QTEST(fastLike(pattern, text), "fits");
        QTEST(referenceLike(pattern, text), "fits");
    }
};

QTEST_APPLESS_MAIN(tst_LikePattern)
#include "tst_LikePattern.moc"
