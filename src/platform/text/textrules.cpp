#include "platform/text/textrules.h"

#include "platform/text/numeric.h"

namespace text
{

bool isNumeric(QStringView s)
{
    return isNumeric(s.utf16(), std::size_t(s.size()));
}

namespace
{

bool partsWords(QChar c)
{
    return c.isSpace() || c.category() == QChar::Other_Control;
}

} // namespace

QString properCase(const QString &s)
{
    QString out = s;
    bool first = true;
    for (qsizetype i = 0; i < out.size(); ++i) {
        const QChar c = out.at(i);
        if (c.isHighSurrogate() && i + 1 < out.size() && out.at(i + 1).isLowSurrogate()) {
            const char32_t u = QChar::surrogateToUcs4(c, out.at(i + 1));
            const char32_t mapped = first ? QChar::toUpper(u) : QChar::toLower(u);
            if (QChar::requiresSurrogates(mapped)) {
                out[i] = QChar(QChar::highSurrogate(mapped));
                out[i + 1] = QChar(QChar::lowSurrogate(mapped));
            }
            ++i;
        } else {
            out[i] = first ? c.toUpper() : c.toLower();
        }
        first = partsWords(c);
    }
    return out;
}

QString cutTo(const QString &s, qsizetype length)
{
    if (s.size() <= length)
        return s;
    const bool splits = length > 0 && s.at(length - 1).isHighSurrogate();
    return s.left(splits ? length - 1 : length);
}

QString withLineFeeds(QString s)
{
    s.replace(QLatin1String("\r\n"), QLatin1String("\n"));
    s.replace(QLatin1Char('\r'), QLatin1Char('\n'));
    return s;
}

} // namespace text
