#include "tags/tagerrors.h"

using namespace Qt::StringLiterals;

Error tagError(TagError number, const char *key, const QString &path)
{
    return {number, u"Tags"_s, errorText(key, path)};
}
