#include "collection/resultlines.h"

using namespace Qt::StringLiterals;

QString resultLine(const QStringList &texts)
{
    return u'"' + texts.join("\",\""_L1) + u'"';
}
