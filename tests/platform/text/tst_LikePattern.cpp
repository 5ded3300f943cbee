// Label: unit
#include "platform/text/likepattern.h"
#include "support/referencelike.h"

#include <QTest>
#include <random>

/// The fast matcher of LIKE, by example and against a slow one.
class tst_LikePattern : public QObject
{
    Q_OBJECT

private slots:
    void matches_data();
    void matches();
    void agreesWithTheReference_data();
    void agreesWithTheReference();
};

namespace
{

bool fastLike(const QString &pattern, const QString &text)
{
    return text::LikePattern(pattern.toStdString()).matches(text.toStdString());
}

} // namespace

void tst_LikePattern::matches_data()
{
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("fits");
    const auto row = [](const char *pattern, const char *text, bool fits) {
        QTest::newRow(qPrintable(QString::fromUtf8(pattern) + QStringLiteral(" : ") +
                                 QString::fromUtf8(text)))
            << QString::fromUtf8(pattern) << QString::fromUtf8(text) << fits;
    };
    row("", "", true);
    row("", "a", false);
    row("%", "", true);
    row("%%", "é", true);
    row("_", "", false);
    row("_", "\U0001F3B5", true);
    row("__", "é", false);
    row("love", "LOVE", true);
    row("love", "loves", false);
    row("love%", "Lovely", true);
    row("%love", "glove", true);
    row("%love%", "my GLOVES", true);
    row("%ab%ab%", "ab", false);
    row("ab%ab", "ab", false);
    row("ab%b", "ab", false);
    row("%aab", "aaab", true);
    row("a_c%e", "abcde", true);
    row("%_", "", false);
    row("_%_", "a", false);
    row("björk", "BJÖRK", true);
    row("bjork", "björk", false);
    row("ça%", "ÇA VA", true);
    row("%ΩΔΉ%", "ωδή", true);
    row("ж%", "ЖУК", true);
    row("σ", "ς", true);
    row("k", "\u212A", true); // the Kelvin sign is a k
    row("\u212A", "k", true);
    row("ß", "ss", false);
    row("100%", "100 %", true);
    row("a.c*[b]", "a.c*[B]", true); // nothing else is wild
    row("a.c", "abc", false);
}

void tst_LikePattern::matches()
{
    QFETCH(QString, pattern);
    QFETCH(QString, text);
    QTEST(fastLike(pattern, text), "fits");
    QTEST(referenceLike(pattern, text), "fits");
}

void tst_LikePattern::agreesWithTheReference_data()
{
    QTest::addColumn<QString>("alphabet");
    QTest::newRow("ASCII") << QStringLiteral("aAbB c");
    QTest::newRow("two bytes") << QStringLiteral("aAéÉöÖß");
    QTest::newRow("mixed") << QStringLiteral("aK\u212AſsΣσςЖж日\u1E9Eß");
    QTest::newRow("surrogates") << QStringLiteral("a\U0001F3B5\U00010400\U00010428");
}

void tst_LikePattern::agreesWithTheReference()
{
    QFETCH(QString, alphabet);
    const auto letters = alphabet.toUcs4();
    std::mt19937 random(2);
    const auto make = [&](unsigned length, bool wild) {
        QString s;
        for (auto n = random() % length; n > 0; --n) {
            const auto dice = random() % 10;
            const char32_t c = wild && dice < 3 ? (dice < 2 ? U'%' : U'_')
                                                : letters[qsizetype(random()) % letters.size()];
            s += QString::fromUcs4(&c, 1);
        }
        return s;
    };
    int fits = 0;
    for (int i = 0; i < 20000; ++i) {
        const QString pattern = make(8, true), text = make(10, false);
        const bool right = referenceLike(pattern, text);
        fits += right;
        QVERIFY2(fastLike(pattern, text) == right,
                 qPrintable(pattern + QStringLiteral(" : ") + text));
    }
    QVERIFY(fits > 1000); // else the random texts prove little
}

QTEST_APPLESS_MAIN(tst_LikePattern)
#include "tst_LikePattern.moc"
