#include "platform/ado/dialect.h"

#include "platform/ado/error.h"

#include <QString>
#include <algorithm>

namespace ADODB
{

namespace
{

bool startsWord(QChar c)
{
    return c == u'_' || c.unicode() >= 0x80 || c.isLetter();
}

bool inWord(QChar c)
{
    return startsWord(c) || (c >= u'0' && c <= u'9');
}

bool isDigit(QChar c)
{
    return c >= u'0' && c <= u'9';
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

bool is(QStringView word, QLatin1String keyword)
{
    return word.compare(keyword, Qt::CaseInsensitive) == 0;
}

bool nextWordIs(QStringView s, qsizetype i, QLatin1String keyword)
{
    i = skipBlanks(s, i);
    return is(s.sliced(i, wordEnd(s, i) - i), keyword);
}

void appendUtf8(std::string &out, QStringView s)
{
    for (const QChar c : s) {
        if (c.unicode() >= 0x80) {
            const QByteArray bytes = s.toUtf8();
            out.append(bytes.constData(), std::size_t(bytes.size()));
            return;
        }
    }
    for (const QChar c : s)
        out.push_back(char(c.unicode()));
}

// SHAPE { select ... } as X compute X by a, b: the select alone, each row once.
QString shapeContent(QStringView s)
{
    const auto open = s.indexOf(u'{'), close = s.lastIndexOf(u'}');
    if (open < 0 || close < open)
        throw makeError(errSyntax);
    const QStringView content = s.sliced(open + 1, close - open - 1);
    const auto from = skipBlanks(content, 0), end = wordEnd(content, from);
    if (!is(content.sliced(from, end - from), QLatin1String("select")))
        throw makeError(errSyntax);
    return QLatin1String("select distinct") + content.sliced(end);
}

bool isOneOf(QStringView word, std::initializer_list<const char *> keywords)
{
    return std::any_of(keywords.begin(), keywords.end(),
                       [&](const char *k) { return is(word, QLatin1String(k)); });
}

} // namespace

void Dialect::refuse(const QString &why) const
{
    throw makeError(errSyntax, why);
}

void Dialect::translate(QStringView statement)
{
    mSql.clear();
    mTexts.clear();
    mLiterals.clear();
    mAt = skipBlanks(statement, 0);
    mEnded = false;
    mOrdinals.assign(1, false);
    mValues = Values::None;
    mDelete = Delete::None;
    const QStringView first = statement.sliced(mAt, wordEnd(statement, mAt) - mAt);
    mLifts = !isOneOf(first, {"create", "alter", "drop"});
    if (is(first, QLatin1String("shape"))) {
        const QString content = shapeContent(statement);
        mAt = 0;
        translatePiece(content);
    } else if (!mLifts || isOneOf(first, {"select", "insert", "update", "delete"})) {
        translatePiece(statement);
    } else {
        refuse(first.toString());
    }
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
        else if (isDigit(c) || (c == u'.' && isDigit(charAt(s, mAt + 1))))
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
    if (is(w, QLatin1String("left")) && charAt(s, skipBlanks(s, end)) == u'(') {
        mSql.append("\"left\"");
        return;
    }
    if (is(w, QLatin1String("max")) && maxOfSum(s))
        return;
    deleteAlias(w);
    appendUtf8(mSql, w);
    afterWord(s, w);
}

void Dialect::afterWord(QStringView s, QStringView w)
{
    const bool orders = is(w, QLatin1String("order")) || is(w, QLatin1String("group"));
    if (orders && nextWordIs(s, mAt, QLatin1String("by"))) {
        mOrdinals.back() = true;
    } else if (is(w, QLatin1String("having")) || is(w, QLatin1String("union"))) {
        mOrdinals.back() = false;
    } else if (is(w, QLatin1String("values"))) {
        mValues = Values::Expected;
    }
}

// max(id+1): as it stands it reads the whole table; as max(id)+1 it reads one entry of the index.
bool Dialect::maxOfSum(QStringView s)
{
    const auto open = skipBlanks(s, mAt);
    const auto from = skipBlanks(s, open + 1), to = wordEnd(s, from);
    const auto plus = skipBlanks(s, to), one = skipBlanks(s, plus + 1);
    const auto close = skipBlanks(s, one + 1);
    const bool fits = charAt(s, open) == u'(' && to > from && charAt(s, plus) == u'+' &&
                      charAt(s, one) == u'1' && charAt(s, close) == u')';
    if (!fits)
        return false;
    mSql.append("(max(");
    appendUtf8(mSql, s.sliced(from, to - from));
    mSql.append(")+1)");
    mAt = close + 1;
    return true;
}

void Dialect::deleteAlias(QStringView w)
{
    switch (mDelete) {
    case Delete::None:
        mDelete = mSql.empty() && is(w, QLatin1String("delete")) ? Delete::From : Delete::Done;
        break;
    case Delete::From:
        if (!is(w, QLatin1String("from")))
            mDelete = Delete::Table;
        break;
    case Delete::Table:
        if (!is(w, QLatin1String("where")) && !is(w, QLatin1String("as")))
            mSql.append("as ");
        mDelete = Delete::Done;
        break;
    case Delete::Done:
        break;
    }
}

void Dialect::quoted(QStringView s)
{
    const char16_t quote = s[mAt].unicode();
    auto end = mAt + 1;
    for (;; ++end) {
        if (end >= s.size())
            refuse(QString(QChar(quote)));
        if (s[end] != quote)
            continue;
        if (charAt(s, end + 1) != quote)
            break;
        ++end;
    }
    if (inWord(charAt(s, end + 1)))
        refuse(s.sliced(end + 1, wordEnd(s, end + 1) - end - 1).toString());
    literalText(s.sliced(mAt + 1, end - mAt - 1), quote);
    mAt = end + 1;
}

// The text between the quotes, doubled quotes undone, in NFC.
void Dialect::literalText(QStringView s, char16_t quote)
{
    Literal l{Literal::Text, mTexts.size()};
    bool ascii = true;
    for (qsizetype i = 0; i < s.size() && ascii; ++i) {
        const char16_t c = s[i].unicode();
        ascii = c < 0x80;
        mTexts.push_back(char(c));
        if (c == quote)
            ++i;
    }
    if (!ascii) {
        mTexts.resize(l.offset);
        const QString once(1, QChar(quote)), twice(2, QChar(quote));
        QString undone = s.toString();
        undone.replace(twice, once);
        appendUtf8(mTexts, undone.normalized(QString::NormalizationForm_C));
    }
    l.size = mTexts.size() - l.offset;
    if (mLifts) {
        mLiterals.push_back(l);
        mSql.push_back('?');
    } else {
        const std::string content = mTexts.substr(l.offset);
        if (content.find('\0') != std::string::npos)
            refuse(QString(QChar(quote)));
        mSql.push_back('\'');
        for (const char c : content)
            mSql.append(c == '\'' ? 2 : 1, c);
        mSql.push_back('\'');
    }
}

void Dialect::number(QStringView s)
{
    const auto from = mAt;
    auto skipDigits = [&] {
        while (isDigit(charAt(s, mAt)))
            ++mAt;
    };
    skipDigits();
    bool whole = true;
    if (charAt(s, mAt) == u'.') {
        whole = false;
        ++mAt;
        skipDigits();
    }
    if (charAt(s, mAt).toLower() == u'e') {
        auto digits = mAt + 1;
        if (charAt(s, digits) == u'+' || charAt(s, digits) == u'-')
            ++digits;
        if (isDigit(charAt(s, digits))) {
            whole = false;
            mAt = digits;
            skipDigits();
        }
    }
    const QStringView text = s.sliced(from, mAt - from);
    if (inWord(charAt(s, mAt)))
        refuse(text.toString() + s[mAt]);
    if (!liftsHere()) {
        appendUtf8(mSql, text);
        return;
    }
    Literal l{Literal::Integer};
    bool fits = false;
    l.integer = whole ? text.toLongLong(&fits) : 0;
    if (!fits) {
        l.kind = Literal::Real;
        l.real = text.toDouble();
    }
    mLiterals.push_back(l);
    mSql.push_back('?');
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
