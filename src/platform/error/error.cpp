#include "platform/error/error.h"

#include "platform/text/messagetexts.h"

#include <algorithm>
#include <iterator>

using namespace Qt::StringLiterals;

namespace
{

struct Words {
    ErrorNumber number;
    const char *key;
};

constexpr Words errorWords[] = {
    {errOverflow, "xErrOverflow"},
    {errTypeMismatch, "xErrTypeMismatch"},
    {errFileFailed, "xErrFileFailed"},
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

QString errorText(const char *key, const QString &detail)
{
    const QString words = text::ofKey(key);
    return detail.isEmpty() ? words : words + u" ("_s + detail + u')';
}

Error makeError(ErrorNumber number, const QString &detail)
{
    const auto *found = std::find_if(std::begin(errorWords), std::end(errorWords),
                                     [&](const Words &w) { return w.number == number; });
    return {number, u"ADODB"_s, errorText(found->key, detail)};
}
