#include "platform/ado/literals.h"

#include <QString>
#include <algorithm>

namespace ADODB
{

namespace
{

constexpr int noQuote = -1;

// Appends characters below U+0300, which are in NFC whatever stands beside them; of a doubled quote
// one. False, and nothing is appended, if there is any other.
bool appendLatin(std::string &out, QStringView s, int quote)
{
    const auto before = out.size();
    out.resize(before + 2 * std::size_t(s.size()));
    char *to = out.data() + before;
    for (qsizetype i = 0; i < s.size(); ++i) {
        const char16_t c = s[i].unicode();
        if (c >= 0x300) {
            out.resize(before);
            return false;
        }
        if (c < 0x80) {
            *to++ = char(c);
        } else {
            *to++ = char(0xC0 | c >> 6);
            *to++ = char(0x80 | (c & 0x3F));
        }
        if (c == quote)
            ++i;
    }
    out.resize(std::size_t(to - out.data()));
    return true;
}

// A run of digits; false if it has more than surely fit.
bool smallWhole(QStringView digits, qint64 &value)
{
    constexpr qsizetype surelyFit = 18;
    if (digits.size() > surelyFit)
        return false;
    value = 0;
    for (const QChar c : digits)
        value = value * 10 + (c.unicode() - u'0');
    return true;
}

qsizetype digitsEnd(QStringView s, qsizetype at)
{
    while (at < s.size() && isDigit(s[at]))
        ++at;
    return at;
}

} // namespace

void appendUtf8(std::string &out, QStringView s)
{
    if (appendLatin(out, s, noQuote))
        return;
    const QByteArray bytes = s.toUtf8();
    out.append(bytes.constData(), std::size_t(bytes.size()));
}

void Literals::clear()
{
    mAll.clear();
    mTexts.clear();
}

void Literals::addText(QStringView content, char16_t quote)
{
    Literal l{Literal::Text, mTexts.size()};
    if (!appendLatin(mTexts, content, quote)) {
        const QString once(1, QChar(quote)), twice(2, QChar(quote));
        QString undone = content.toString();
        undone.replace(twice, once);
        appendUtf8(mTexts, undone.normalized(QString::NormalizationForm_C));
    }
    l.size = mTexts.size() - l.offset;
    mAll.push_back(l);
}

void Literals::addNumber(QStringView digits)
{
    Literal l{Literal::Integer};
    bool fits = std::all_of(digits.begin(), digits.end(), isDigit);
    if (fits && !smallWhole(digits, l.integer))
        l.integer = digits.toLongLong(&fits);
    if (!fits) {
        l.kind = Literal::Real;
        l.real = digits.toDouble();
    }
    mAll.push_back(l);
}

qsizetype numberEnd(QStringView s, qsizetype at)
{
    auto end = digitsEnd(s, at);
    if (end < s.size() && s[end] == u'.')
        end = digitsEnd(s, end + 1);
    if (end >= s.size() || (s[end] != u'e' && s[end] != u'E'))
        return end;
    auto exponent = end + 1;
    if (exponent < s.size() && (s[exponent] == u'+' || s[exponent] == u'-'))
        ++exponent;
    const auto exponentEnd = digitsEnd(s, exponent);
    return exponentEnd > exponent ? exponentEnd : end;
}

qsizetype closingQuote(QStringView s, qsizetype at)
{
    const QChar quote = s[at];
    for (auto end = at + 1; end < s.size(); ++end) {
        if (s[end] != quote)
            continue;
        if (end + 1 == s.size() || s[end + 1] != quote)
            return end;
        ++end;
    }
    return -1;
}

} // namespace ADODB
