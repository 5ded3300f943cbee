#pragma once

#include <QStringView>
#include <string>
#include <string_view>
#include <vector>

namespace ADODB
{

/// A value that stood in the text of a statement.
struct Literal {
    enum Kind { Text, Integer, Real } kind;
    std::size_t offset = 0, size = 0; // of a text, in the buffer of all texts
    qint64 integer = 0;
    double real = 0;
};

/// The values of one statement, in their order. Texts are UTF-8 in NFC, all in one buffer, so that
/// the next statement allocates nothing.
class Literals
{
public:
    void clear();

    /// A text as it stands between its quotes, where each of them inside is doubled.
    void addText(QStringView content, char16_t quote);
    void addNumber(QStringView digits);

    const std::vector<Literal> &all() const { return mAll; }
    std::string_view text(const Literal &l) const { return {mTexts.data() + l.offset, l.size}; }

private:
    std::vector<Literal> mAll;
    std::string mTexts;
};

/// Appends text as UTF-8, as it is.
void appendUtf8(std::string &out, QStringView s);

inline bool isDigit(QChar c)
{
    return c >= u'0' && c <= u'9';
}

inline bool startsNumber(QStringView s, qsizetype at)
{
    return isDigit(s[at]) || (s[at] == u'.' && at + 1 < s.size() && isDigit(s[at + 1]));
}

/// Where the number that starts at `at` ends: digits, a point, an exponent.
qsizetype numberEnd(QStringView s, qsizetype at);

/// The place of the quote that closes the one at `at`, or -1.
qsizetype closingQuote(QStringView s, qsizetype at);

} // namespace ADODB
