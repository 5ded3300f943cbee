#include "catalogue/typedtext.h"

#include "platform/text/textrules.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace typedtext
{

namespace
{

constexpr qsizetype longest = 255;

bool breaksLine(QChar c)
{
    return c.category() == QChar::Other_Control || c.category() == QChar::Separator_Line ||
           c.category() == QChar::Separator_Paragraph;
}

} // namespace

Kept keep(const QString &typed, const QString &before)
{
    if (typed == before)
        return {typed};
    QString line = typed.normalized(QString::NormalizationForm_C);
    line.replace("\r\n"_L1, " "_L1);
    std::replace_if(line.begin(), line.end(), breaksLine, u' ');
    line = line.trimmed();
    QString kept = text::cutTo(line, room(before)).trimmed();
    if (!kept.isEmpty() && kept.back().isHighSurrogate())
        kept.chop(1); // of a pair that a field has cut
    return {kept, kept.size() < line.size()};
}

int room(const QString &before)
{
    return int(std::max(longest, before.size()));
}

} // namespace typedtext
