#include "collection/resultlines.h"

QString resultLine(const QStringList &texts)
{
    return u'"' + texts.join(QLatin1String("\",\"")) + u'"';
}
