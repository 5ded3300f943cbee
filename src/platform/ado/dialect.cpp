#include "platform/ado/dialect.h"

#include "platform/error/error.h"
#include "platform/text/normalform.h"

#include <QString>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace ADODB
{

namespace
{

bool startsWord(QChar c)
{
    const char16_t u = c.unicode(), small = u | 0x20;
    return (small >= u'a' && small <= u'z') || u == u'_' || u >= 0x80;
}

bool isBlank(QChar c)
{
    return c == u' ' || c == u'\t' || c == u'\n' || c == u'\r';
}

bool isDigit(QChar c)
{
    return c >= u'0' && c <= u'9';
}

bool inWord(QChar c)
{
    return startsWord(c) || isDigit(c);
}

QChar charAt(QStringView s, qsizetype i)
{
    return i < s.size() ? s[i] : QChar();
}

qsizetype skipBlanks(QStringView s, qsizetype i)
{
    while (i < s.size() && isBlank(s[i]))
        ++i;
    return i;
}

qsizetype wordEnd(QStringView s, qsizetype i)
{
    while (i < s.size() && inWord(s[i]))
        ++i;
    return i;
}

bool startsNumber(QStringView s, qsizetype at)
{
    return isDigit(charAt(s, at)) || (charAt(s, at) == u'.' && isDigit(charAt(s, at + 1)));
}

qsizetype digitsEnd(QStringView s, qsizetype at)
{
    while (isDigit(charAt(s, at)))
        ++at;
    return at;
}

// Where the number that starts here ends: digits, a point, an exponent.
qsizetype numberEnd(QStringView s, qsizetype at)
{
    auto end = digitsEnd(s, at);
    if (charAt(s, end) == u'.')
        end = digitsEnd(s, end + 1);
    if (charAt(s, end) != u'e' && charAt(s, end) != u'E')
        return end;
    auto exponent = end + 1;
    if (charAt(s, exponent) == u'+' || charAt(s, exponent) == u'-')
        ++exponent;
    const auto exponentEnd = digitsEnd(s, exponent);
    return exponentEnd > exponent ? exponentEnd : end;
}

// The place of the quote that closes the one here, or -1.
qsizetype closingQuote(QStringView s, qsizetype at)
{
    const QChar quote = s[at];
    for (auto end = s.indexOf(quote, at + 1); end >= 0; end = s.indexOf(quote, end + 2)) {
        if (charAt(s, end + 1) != quote)
            return end;
    }
    return -1;
}

// A text as the engine reads it, of what stands between these quotes. A NUL would end the statement
// there.
std::string literal(QStringView content, QChar quote)
{
    QString text = content.toString();
    text.replace(QString(2, quote), QString(quote));
    text.replace(u'\'', "''"_L1);
    const bool parts = text.contains(QChar::Null);
    if (parts)
        text.replace(QString(QChar::Null), "'||char(0)||'"_L1);
    const std::string quoted = '\'' + text::nfc(text).toStdString() + '\'';
    return parts ? '(' + quoted + ')' : quoted;
}

// The keyword is in small letters.
bool is(QStringView word, QLatin1String keyword)
{
    if (word.size() != keyword.size())
        return false;
    for (qsizetype i = 0; i < word.size(); ++i) {
        if ((word[i].unicode() | 0x20) != keyword[i].unicode())
            return false;
    }
    return true;
}

// SHAPE { select ... } as X compute X by a, b: the select alone, each row once.
QString shapeContent(QStringView s)
{
    const auto open = s.indexOf(u'{'), close = s.lastIndexOf(u'}');
    if (open < 0 || close < open)
        throw makeError(errSyntax);
    const QStringView content = s.sliced(open + 1, close - open - 1);
    const auto from = skipBlanks(content, 0), end = wordEnd(content, from);
    if (!is(content.sliced(from, end - from), "select"_L1))
        throw makeError(errSyntax);
    return "select distinct"_L1 + content.sliced(end);
}

bool isOneOf(QStringView word, std::initializer_list<const char *> keywords)
{
    return std::any_of(keywords.begin(), keywords.end(),
                       [&](const char *k) { return is(word, QLatin1String(k)); });
}

// Whether the name of a column at this place, which all behind it belongs to, begins a condition.
bool isCondition(std::string_view sql, std::size_t nameAt)
{
    const auto last = sql.find_last_not_of(' ');
    if (nameAt == 0 || last < nameAt || !inWord(QLatin1Char(sql[last])))
        return false;
    const auto before = sql.substr(0, nameAt);
    const auto end = before.find_last_not_of(' ') + 1;
    auto begin = end;
    while (begin > 0 && inWord(QLatin1Char(sql[begin - 1])))
        --begin;
    const QString word = QLatin1String(sql.data() + begin, qsizetype(end - begin)).toString();
    const bool first = end > 0 && sql[end - 1] == '(';
    const bool name = !sql.substr(nameAt).starts_with("not ");
    return name && (first || isOneOf(word, {"where", "and", "or"}));
}

// Whether a condition may end here: what comes next is no part of it.
bool conditionEnds(QStringView s, qsizetype at)
{
    at = skipBlanks(s, at);
    const QChar c = charAt(s, at);
    return c.isNull() || c == u')' || c == u';' ||
           isOneOf(s.sliced(at, wordEnd(s, at) - at), {"and", "or", "order", "group"});
}

/// One reading of a statement, from its start to its end. What the signs to come mean depends on
/// these:
///
/// state     becomes                                            and then
/// mDepth    one more at each "(", one less at its ")"          a ")" too many is refused
/// mEnded    true at ";"                                        all but blanks is refused
/// mValues   Expected at "values", Inside at its "(",           all but ";" is refused
///           Behind at the ")" that closes that
/// mDelete   From if "delete" is the first word, Table at       the word behind the table gets its
///           the first one behind "from", Done at the next      "as", unless it is "as" or "where"
/// mBetween  Lower at "between", Upper at its "and", None at    a LIKE belongs to the upper bound
///           the next "and" or "or"                             unless it is None
/// mNameAt   where in mSql the last word begins, of one with    a LIKE takes its column from there
///           points its first part; 0 behind a number
class Translation
{
public:
    explicit Translation(QStringView statement) : mText(statement) {}
    std::string run();

private:
    void word();
    void quoted();
    void number();
    void otherSign();
    void parenthesis(QChar c);
    bool maxOfSum();
    bool likeText(QStringView w);
    void deleteAlias(QStringView w);
    [[noreturn]] void refuse(const QString &near) const { throw makeError(errSyntax, near); }
    QStringView upTo(qsizetype end) const { return mText.sliced(mAt, end - mAt); }
    void append(QStringView s) { mSql += s.toUtf8().toStdString(); }

    QStringView mText;
    qsizetype mAt = 0;
    std::string mSql;

    int mDepth = 0;
    bool mEnded = false;
    enum class Values { None, Expected, Inside, Behind } mValues = Values::None;
    enum class Delete { None, From, Table, Done } mDelete = Delete::None;
    enum class Between { None, Lower, Upper } mBetween = Between::None;
    static Between betweenAfter(Between now, QStringView w);
    std::size_t mNameAt = 0;
};

std::string Translation::run()
{
    while (mAt < mText.size()) {
        const QChar c = mText[mAt];
        if (isBlank(c)) {
            mAt = skipBlanks(mText, mAt);
            if (!mSql.empty() && mAt < mText.size())
                mSql.push_back(' ');
            continue;
        }
        if (mEnded || (mValues == Values::Behind && c != u';'))
            refuse(QString(c));
        if (startsWord(c))
            word();
        else if (startsNumber(mText, mAt))
            number();
        else if (c == u'\'' || c == u'"')
            quoted();
        else
            otherSign();
    }
    return mSql;
}

void Translation::word()
{
    const QStringView w = upTo(wordEnd(mText, mAt));
    mAt += w.size();
    if (is(w, "left"_L1) && charAt(mText, skipBlanks(mText, mAt)) == u'(') {
        mSql.append("\"left\"");
        return;
    }
    if ((is(w, "max"_L1) && maxOfSum()) || (is(w, "like"_L1) && likeText(w)))
        return;
    if (is(w, "x"_L1) && (charAt(mText, mAt) == u'\'' || charAt(mText, mAt) == u'"'))
        refuse(w.toString()); // bytes, to the engine
    if (is(w, "values"_L1))
        mValues = Values::Expected;
    deleteAlias(w);
    mBetween = betweenAfter(mBetween, w);
    const auto last = mSql.find_last_not_of(' ');
    if (last == std::string::npos || mSql[last] != '.')
        mNameAt = mSql.size();
    append(w);
}

Translation::Between Translation::betweenAfter(Between now, QStringView w)
{
    if (is(w, "between"_L1))
        return Between::Lower;
    if (!is(w, "and"_L1))
        return is(w, "or"_L1) ? Between::None : now;
    return now == Between::Lower ? Between::Upper : Between::None;
}

// max(id+1): as it stands it reads the whole table; as max(id)+1 it reads one entry of the index.
bool Translation::maxOfSum()
{
    const auto open = skipBlanks(mText, mAt);
    const auto from = skipBlanks(mText, open + 1), to = wordEnd(mText, from);
    const auto plus = skipBlanks(mText, to), addend = skipBlanks(mText, plus + 1);
    const bool sum = charAt(mText, open) == u'(' && to > from && charAt(mText, plus) == u'+';
    if (!sum || !startsNumber(mText, addend))
        return false;
    const auto close = skipBlanks(mText, numberEnd(mText, addend));
    if (charAt(mText, close) != u')')
        return false;
    mSql.append("(max(");
    append(mText.sliced(from, to - from));
    mSql.append(")+");
    mAt = addend;
    number();
    mSql.push_back(')');
    mAt = close + 1;
    return true;
}

void Translation::deleteAlias(QStringView w)
{
    switch (mDelete) {
    case Delete::None:
        mDelete = mSql.empty() && is(w, "delete"_L1) ? Delete::From : Delete::Done;
        break;
    case Delete::From:
        if (!is(w, "from"_L1))
            mDelete = Delete::Table;
        break;
    case Delete::Table:
        if (!is(w, "where"_L1) && !is(w, "as"_L1))
            mSql.append("as ");
        mDelete = Delete::Done;
        break;
    case Delete::Done:
        break;
    }
}

// "a.name like 'text'" becomes "unlikely(a.name like 'text')", if it is a condition of its own.
bool Translation::likeText(QStringView w)
{
    const auto from = skipBlanks(mText, mAt);
    const auto end = charAt(mText, from) == u'\'' ? closingQuote(mText, from) : -1;
    if (mBetween != Between::None || end < 0 || !isCondition(mSql, mNameAt) ||
        !conditionEnds(mText, end + 1))
        return false;
    mSql.insert(mNameAt, "unlikely(");
    append(w);
    mSql.push_back(' ');
    mAt = from;
    quoted();
    mSql.push_back(')');
    return true;
}

void Translation::quoted()
{
    const QChar quote = mText[mAt];
    const auto end = closingQuote(mText, mAt);
    if (end < 0)
        refuse(QString(quote));
    if (const auto glued = wordEnd(mText, end + 1); glued > end + 1)
        refuse(mText.sliced(end + 1, glued - end - 1).toString());
    mSql += literal(mText.sliced(mAt + 1, end - mAt - 1), quote);
    mAt = end + 1;
}

void Translation::number()
{
    const QStringView digits = upTo(numberEnd(mText, mAt));
    const QChar before = mAt > 0 ? mText[mAt - 1] : QChar(),
                behind = charAt(mText, mAt + digits.size());
    if (inWord(behind))
        refuse(digits.toString() + behind);
    if (inWord(before)) // "a.5"
        refuse(before + digits.toString());
    append(digits);
    mAt += digits.size();
    mNameAt = 0;
}

void Translation::otherSign()
{
    const QChar c = mText[mAt], next = charAt(mText, mAt + 1);
    const bool comment = (c == u'-' && next == u'-') || (c == u'/' && next == u'*');
    const bool control = c < u' '; // SQLite takes a NUL for the end of the statement
    const bool parameter = c == u'?' || c == u':' || c == u'@' || c == u'$' || c == u'#';
    if (comment || control || parameter || (c == u'|' && next == u'|'))
        refuse(QString(c) + next);
    ++mAt;
    if (c == u';') {
        mEnded = true;
        return;
    }
    parenthesis(c);
    append(QStringView(&c, 1));
}

void Translation::parenthesis(QChar c)
{
    if (c == u'(' && mDepth++ == 0 && mValues == Values::Expected)
        mValues = Values::Inside;
    if (c != u')')
        return;
    if (mDepth-- == 0)
        refuse(QString(c));
    if (mDepth == 0 && mValues == Values::Inside)
        mValues = Values::Behind;
}

} // namespace

std::string translated(QStringView statement)
{
    const auto from = skipBlanks(statement, 0);
    const QStringView first = statement.sliced(from, wordEnd(statement, from) - from);
    if (is(first, "shape"_L1))
        return Translation(shapeContent(statement)).run();
    if (!isOneOf(first, {"select", "insert", "update", "delete", "create", "alter", "drop"}))
        throw makeError(errSyntax, first.toString());
    return Translation(statement).run();
}

} // namespace ADODB
