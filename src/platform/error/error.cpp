#include "platform/error/error.h"

#include <algorithm>
#include <iterator>

using namespace Qt::StringLiterals;

namespace
{

QString keyItself(const char *key)
{
    return QString::fromLatin1(key);
}

constinit TextOfKey gTexts = keyItself;

struct Words {
    ErrorNumber number;
    const char *key;
};

constexpr Words words[] = {
    {errOverflow, "xErrOverflow"},
    {errTypeMismatch, "xErrTypeMismatch"},
    {errItemNotFound, "xErrItemNotFound"},
    {errNoCurrentRecord, "xErrNoCurrentRecord"},
    {errObjectClosed, "xErrObjectClosed"},
    {errNotPermitted, "xErrNotPermitted"},
    {errSyntax, "xErrSyntax"},
    {errConstraint, "xErrConstraint"},
    {errReadOnly, "xErrReadOnly"},
    {errCannotUse, "xErrCannotUse"},
};

} // namespace

QString Error::numbered() const
{
    return QString::number(Number) + u" - "_s + Description;
}

const char *Error::what() const noexcept
{
    mWhat = numbered().toUtf8();
    return mWhat.constData();
}

void setErrorTexts(TextOfKey texts)
{
    gTexts = texts;
}

QString errorText(const char *key, const QString &detail)
{
    const QString text = gTexts(key);
    return detail.isEmpty() ? text : text + u" ("_s + detail + u')';
}

Error makeError(ErrorNumber number, const QString &detail)
{
    const auto *found = std::find_if(std::begin(words), std::end(words),
                                     [&](const Words &w) { return w.number == number; });
    return {number, u"ADODB"_s, errorText(found->key, detail)};
}
