#include "catalogue/quoting.h"

QString doubled(QString text)
{
    return text.contains(QLatin1Char('\'')) ? text.replace(QLatin1String("'"), QLatin1String("''"))
                                            : text;
}

QString quoted(const QString &text)
{
    return QLatin1Char('\'') + doubled(text) + QLatin1Char('\'');
}

QString quotedOrNull(const QString &text)
{
    return text.isEmpty() ? QStringLiteral("NULL") : quoted(text);
}

QString numberOrNull(const QString &text)
{
    return text.isEmpty() ? QStringLiteral("NULL") : text;
}
