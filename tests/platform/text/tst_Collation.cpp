// Label: unit
#include "platform/text/collation.h"
#include "support/datarows.h"
#include "support/icuorder.h"

#include <QString>
#include <random>

namespace
{

int sign(int n)
{
    return (n > 0) - (n < 0);
}

using Alphabet = std::vector<std::string>;

// Texts that differ in little: where two agree for long, the short ways have the most to get wrong.
std::string changed(std::string s, const Alphabet &alphabet, std::mt19937 &random)
{
    const auto &piece = alphabet[random() % alphabet.size()];
    switch (random() % 4) {
    case 0:
        return s + piece;
    case 1:
        return piece + s;
    case 2:
        return s.insert(random() % (s.size() + 1), piece);
    default:
        return s.substr(0, random() % (s.size() + 1)) + piece;
    }
}

// What the prefixes tell of two texts, piece after piece; 0 if they leave it to the comparison.
int byPrefixes(std::string_view a, std::string_view b)
{
    constexpr std::uint64_t lastByte = 0xFF;
    const auto &ours = text::Collation::root();
    std::uint64_t x = lastByte, y = lastByte;
    while (x & lastByte) {
        std::size_t usedA = 0, usedB = 0;
        if (!ours.sortPrefix(a, x, usedA) || !ours.sortPrefix(b, y, usedB))
            return 0;
        if (x != y)
            return x < y ? -1 : 1;
        a.remove_prefix(usedA);
        b.remove_prefix(usedB);
    }
    return 0;
}

Alphabet asciiAlphabet()
{
    Alphabet all;
    for (char c = 0; c >= 0 && c < 127; ++c)
        all.push_back(std::string(1, c));
    all.push_back("\x7F");
    return all;
}

Alphabet operator+(Alphabet a, const Alphabet &b)
{
    a.insert(a.end(), b.begin(), b.end());
    return a;
}

Alphabet range(char32_t from, char32_t to)
{
    Alphabet all;
    for (char32_t c = from; c < to; ++c)
        all.push_back(QString::fromUcs4(&c, 1).toStdString());
    return all;
}

} // namespace

/// Holds the short ways of the order of texts against ICU itself.
class tst_Collation : public QObject
{
    Q_OBJECT

private slots:
    void agreesWithIcu_data()
    {
        const DataRows<Alphabet> row("alphabet");
        const Alphabet letters{"a", "A", "b", "e", "E", "i", "o",
                               "s", "S", "z", " ", "-", "'", "1"};
        row("all of ASCII", asciiAlphabet());
        row("Latin", letters + range(0x80, 0x250));
        row("combining marks", letters + range(0x300, 0x330) + Alphabet{"\x01", "l"});
        row("signs of three bytes", letters + Alphabet{"l", "L", "n", "–", "—", "…", "’", "“", "€",
                                                       "™", "ﬁ", "ß", "ẞ", "æ", "·", "ŀ", "ŉ"});
        row("other scripts", letters + range(0x391, 0x3CA) + range(0x410, 0x450) +
                                 Alphabet{"日", "本", "ア", "가", "\U0001F3B5"});
        row("broken UTF-8", letters + Alphabet{"\x80", "\xC2", "\xC3", "\xC9", "\xE2", "\xE2\x80",
                                               "\xF0", "\xFF", "é"});
    }

    void agreesWithIcu()
    {
        QFETCH(Alphabet, alphabet);
        const auto &ours = text::Collation::root();
        const IcuOrder icu;
        std::mt19937 random(1);
        for (int i = 0; i < 20000; ++i) {
            std::string a;
            for (auto n = random() % 24; n > 0; --n)
                a = changed(a, alphabet, random);
            const std::string b = changed(a, alphabet, random);
            const int right = icu.compare(a, b);
            const QByteArray what =
                QByteArray::fromStdString(a).toHex() + " / " + QByteArray::fromStdString(b).toHex();
            QVERIFY2(sign(ours.compare(a, b)) == right, what.constData());
            if (const int told = byPrefixes(a, b))
                QVERIFY2(told == right, what.constData());
            std::string keyA, keyB;
            ours.appendSortKey(a, keyA);
            ours.appendSortKey(b, keyB);
            QVERIFY2(sign(keyA.compare(keyB)) == right, what.constData());
        }
    }
};

QTEST_APPLESS_MAIN(tst_Collation)
#include "tst_Collation.moc"
