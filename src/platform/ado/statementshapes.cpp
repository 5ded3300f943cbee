#include "platform/ado/statementshapes.h"

#include <cstring>

namespace ADODB
{

namespace
{

bool takeFixed(QStringView &s, const QString &fixed)
{
    const auto bytes = std::size_t(fixed.size()) * sizeof(QChar);
    if (s.size() < fixed.size() || std::memcmp(s.data(), fixed.constData(), bytes) != 0)
        return false;
    s = s.sliced(fixed.size());
    return true;
}

// Takes the literal of a gap off the front of the statement; false if there is none of its kind.
bool takeLiteral(QStringView &s, char16_t quote, Literals &literals)
{
    if (s.isEmpty() || (quote ? s[0] != quote : !startsNumber(s, 0)))
        return false;
    const auto end = quote ? closingQuote(s, 0) : numberEnd(s, 0);
    if (end < 0)
        return false;
    if (quote)
        literals.addText(s.sliced(1, end - 1), quote);
    else
        literals.addNumber(s.first(end));
    s = s.sliced(quote ? end + 1 : end);
    return true;
}

} // namespace

void StatementShapes::remember(QStringView statement, const Gaps &gaps, const std::string &sql)
{
    if (mShapes.size() < kept)
        mShapes.emplace_back();
    Shape &shape = mShapes[mNext++ % kept];
    shape = {{}, {}, sql};
    qsizetype from = 0;
    for (const Gap &gap : gaps) {
        shape.fixed.push_back(statement.sliced(from, gap.from - from).toString());
        shape.quotes.push_back(gap.quote);
        from = gap.to;
    }
    shape.fixed.push_back(statement.sliced(from).toString());
}

bool StatementShapes::Shape::fits(QStringView statement, Literals &literals) const
{
    for (std::size_t i = 0; i < fixed.size(); ++i) {
        if (!takeFixed(statement, fixed[i]))
            return false;
        if (i < quotes.size() && !takeLiteral(statement, quotes[i], literals))
            return false;
    }
    return statement.isEmpty();
}

// Loads send their statements in the same order again and again: the search goes on where the last
// one ended.
const std::string *StatementShapes::match(QStringView statement, Literals &literals)
{
    for (std::size_t tried = 1; tried <= mShapes.size(); ++tried) {
        const std::size_t at = (mLast + tried) % mShapes.size();
        literals.clear();
        if (mShapes[at].fits(statement, literals)) {
            mLast = at;
            return &mShapes[at].sql;
        }
    }
    literals.clear();
    return nullptr;
}

} // namespace ADODB
