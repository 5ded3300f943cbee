#include "catalogue/hityear.h"

#include "platform/text/textrules.h"

bool isHitYear(const QString &text)
{
    return text.size() == 4 && text::isNumeric(text) && text.trimmed().toDouble() > 1900;
}
