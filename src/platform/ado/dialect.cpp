#include "platform/ado/dialect.h"

#include "platform/error/error.h"

#include <QString>
#include <algorithm>

using namespace Qt::StringLiterals;

namespace ADODB
{

namespace
{

// Every statement of the program passes through here, those of long loads a hundred thousand times:
// the small functions below are kept free of calls and allocations.

bool startsWord(QChar c)
{
    const char16_t u = c.unicode(), small = u | 0x20;
    return (small >= u'a' && small <= u'z') || u == u'_' || u >= 0x80;
}

bool inWord(QChar c)
{
    return startsWord(c) || (c >= u'0' && c <= u'9');
}

bool isBlank(QChar c)
{
    return c == u' ' || c == u'\t' || c == u'\n' || c == u'\r';
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

bool nextWordIs(QStringView s, qsizetype i, QLatin1String keyword)
{
    i = skipBlanks(s, i);
    return is(s.sliced(i, wordEnd(s, i) - i), keyword);
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

} // namespace

void Dialect::refuse(const QString &why) const
{
    throw makeError(errSyntax, why);
}

void Dialect::translate(QStringView statement)
{
    mKnown = mShapes.match(statement, mLiterals);
    if (mKnown)
        return;
    begin(statement);
    const QStringView first = statement.sliced(mAt, wordEnd(statement, mAt) - mAt);
    mLifts = !isOneOf(first, {"create", "alter", "drop"});
    if (is(first, "shape"_L1)) {
        translateShape(statement);
        return;
    }
    if (mLifts && !isOneOf(first, {"select", "insert", "update", "delete"}))
        refuse(first.toString());
    translatePiece(statement);
    mShapes.remember(statement, mGaps, mSql);
}

void Dialect::begin(QStringView statement)
{
    mSql.clear();
    mLiterals.clear();
    mGaps.clear();
    mAt = skipBlanks(statement, 0);
    mEnded = false;
    mOrdinals.assign(1, false);
    mValues = Values::None;
    mBetween = Between::None;
    mDelete = Delete::None;
}

void Dialect::translateShape(QStringView statement)
{
    const QString content = shapeContent(statement);
    mAt = 0;
    translatePiece(content);
}

void Dialect::translatePiece(QStringView s)
{
    while (mAt < s.size()) {
        const QChar c = s[mAt];
        if (isBlank(c)) {
            mAt = skipBlanks(s, mAt);
            if (!mSql.empty() && mAt < s.size())
                mSql.push_back(' ');
            continue;
        }
        if (mEnded || (mValues == Values::Behind && c != u';'))
            refuse(QString(c));
        if (startsWord(c))
            word(s);
        else if (startsNumber(s, mAt))
            number(s);
        else if (c == u'\'' || c == u'"')
            quoted(s);
        else
            otherSign(s);
    }
}

void Dialect::word(QStringView s)
{
    const auto end = wordEnd(s, mAt);
    const QStringView w = s.sliced(mAt, end - mAt);
    mAt = end;
    if (is(w, "left"_L1) && charAt(s, skipBlanks(s, end)) == u'(') {
        mSql.append("\"left\"");
        return;
    }
    if (is(w, "max"_L1) && maxOfSum(s))
        return;
    if (is(w, "like"_L1) && likeText(s, w))
        return;
    deleteAlias(w);
    mBetween = betweenAfter(mBetween, w);
    const auto last = mSql.find_last_not_of(' ');
    if (last == std::string::npos || mSql[last] != '.')
        mNameAt = mSql.size();
    appendUtf8(mSql, w);
    afterWord(s, w);
}

// "between a and b": a condition may begin behind the next "and" only.
Dialect::Between Dialect::betweenAfter(Between now, QStringView w)
{
    if (is(w, "between"_L1))
        return Between::Lower;
    if (!is(w, "and"_L1))
        return is(w, "or"_L1) ? Between::None : now;
    return now == Between::Lower ? Between::Upper : Between::None;
}

void Dialect::afterWord(QStringView s, QStringView w)
{
    const bool orders = is(w, "order"_L1) || is(w, "group"_L1);
    if (orders && nextWordIs(s, mAt, "by"_L1)) {
        mOrdinals.back() = true;
    } else if (is(w, "having"_L1) || is(w, "union"_L1)) {
        mOrdinals.back() = false;
    } else if (is(w, "values"_L1)) {
        mValues = Values::Expected;
    }
}

// max(id+1): as it stands it reads the whole table; as max(id)+1 it reads one entry of the index.
// So with any number: a shape that is remembered stands for all of them.
bool Dialect::maxOfSum(QStringView s)
{
    const auto open = skipBlanks(s, mAt);
    const auto from = skipBlanks(s, open + 1), to = wordEnd(s, from);
    const auto plus = skipBlanks(s, to), one = skipBlanks(s, plus + 1);
    const bool sum = charAt(s, open) == u'(' && to > from && charAt(s, plus) == u'+';
    if (!sum || one >= s.size() || !startsNumber(s, one))
        return false;
    const auto close = skipBlanks(s, numberEnd(s, one));
    if (charAt(s, close) != u')')
        return false;
    mSql.append("(max(");
    appendUtf8(mSql, s.sliced(from, to - from));
    mSql.append(")+");
    mAt = one;
    number(s);
    mSql.push_back(')');
    mAt = close + 1;
    return true;
}

void Dialect::deleteAlias(QStringView w)
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

// "a.name like 'text'" becomes "unlikely(a.name like ?)", if it is a condition of its own.
bool Dialect::likeText(QStringView s, QStringView w)
{
    const auto from = skipBlanks(s, mAt);
    const auto end = charAt(s, from) == u'\'' ? closingQuote(s, from) : -1;
    if (!mLifts || mBetween != Between::None || end < 0 || !isCondition(mSql, mNameAt) ||
        !conditionEnds(s, end + 1))
        return false;
    mSql.insert(mNameAt, "unlikely(");
    appendUtf8(mSql, w);
    mSql.push_back(' ');
    mAt = from;
    quoted(s);
    mSql.push_back(')');
    return true;
}

void Dialect::quoted(QStringView s)
{
    const char16_t quote = s[mAt].unicode();
    const auto end = closingQuote(s, mAt);
    if (end < 0)
        refuse(QString(QChar(quote)));
    if (inWord(charAt(s, end + 1)))
        refuse(s.sliced(end + 1, wordEnd(s, end + 1) - end - 1).toString());
    if (mLifts) {
        mLiterals.addText(s.sliced(mAt + 1, end - mAt - 1), quote);
        mGaps.push_back({mAt, end + 1, quote});
        mSql.push_back('?');
    } else {
        keepText(s.sliced(mAt + 1, end - mAt - 1), quote);
    }
    mAt = end + 1;
}

// A text that cannot be lifted, between single quotes.
void Dialect::keepText(QStringView content, char16_t quote)
{
    if (content.contains(QChar::Null))
        refuse(QString(QChar(quote)));
    QString text = content.toString();
    text.replace(QString(2, QChar(quote)), QString(1, QChar(quote)));
    text.replace(u'\'', "''"_L1);
    mSql.push_back('\'');
    appendUtf8(mSql, text.normalized(QString::NormalizationForm_C));
    mSql.push_back('\'');
}

void Dialect::number(QStringView s)
{
    const auto from = mAt;
    mAt = numberEnd(s, from);
    const QStringView digits = s.sliced(from, mAt - from);
    if (inWord(charAt(s, mAt)))
        refuse(digits.toString() + s[mAt]);
    if (from > 0 && inWord(s[from - 1])) // "a.5": remembered, its gap would take "a5" for the same
        refuse(s[from - 1] + digits.toString());
    if (liftsHere()) {
        mLiterals.addNumber(digits);
        mGaps.push_back({from, mAt, 0});
        mSql.push_back('?');
    } else {
        appendUtf8(mSql, digits);
    }
}

void Dialect::otherSign(QStringView s)
{
    const QChar c = s[mAt], next = charAt(s, mAt + 1);
    const bool comment = (c == u'-' && next == u'-') || (c == u'/' && next == u'*');
    const bool control = c < u' '; // SQLite takes a NUL for the end of the statement
    const bool parameter = c == u'?' || c == u':' || c == u'@' || c == u'$' || c == u'#';
    if (comment || control || parameter || (c == u'|' && next == u'|'))
        refuse(QString(c) + next);
    if (c == u';')
        mEnded = true;
    else
        sign(s);
    ++mAt;
}

void Dialect::sign(QStringView s)
{
    const char16_t c = s[mAt].unicode();
    if (c == u'(') {
        mOrdinals.push_back(mOrdinals.back());
        if (mValues == Values::Expected)
            mValues = Values::Inside;
    } else if (c == u')') {
        if (mOrdinals.size() == 1)
            refuse(QString(QChar(c)));
        mOrdinals.pop_back();
        if (mValues == Values::Inside && mOrdinals.size() == 1)
            mValues = Values::Behind;
    }
    appendUtf8(mSql, s.sliced(mAt, 1));
}

} // namespace ADODB
