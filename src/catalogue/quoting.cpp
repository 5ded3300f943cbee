#include "catalogue/quoting.h"

using namespace Qt::StringLiterals;

QString doubled(QString text)
{
    return text.contains(u'\'') ? text.replace("'"_L1, "''"_L1) : text;
}

QString quoted(const QString &text)
{
    return u'\'' + doubled(text) + u'\'';
}

QString quotedOrNull(const QString &text)
{
    return text.isEmpty() ? u"NULL"_s : quoted(text);
}

QString numberOrNull(const QString &text)
{
    return text.isEmpty() ? u"NULL"_s : text;
}
