#include "platform/text/textrules.h"

#include "platform/text/numeric.h"

using namespace Qt::StringLiterals;

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

QChar cased(QChar c, bool capital)
{
    const char16_t u = c.unicode();
    if (u >= 0x80)
        return capital ? c.toUpper() : c.toLower();
    const bool letter = (u | 0x20) >= u'a' && (u | 0x20) <= u'z';
    return letter ? QChar(char16_t(capital ? u & ~0x20 : u | 0x20)) : c;
}

// The pair of surrogates at p.
void casePair(QChar *p, bool capital)
{
    const char32_t u = QChar::surrogateToUcs4(p[0], p[1]);
    const char32_t mapped = capital ? QChar::toUpper(u) : QChar::toLower(u);
    if (QChar::requiresSurrogates(mapped)) {
        p[0] = QChar(QChar::highSurrogate(mapped));
        p[1] = QChar(QChar::lowSurrogate(mapped));
    }
}

} // namespace

QString properCase(const QString &s)
{
    QString out = s;
    bool first = true;
    QChar *const end = out.data() + out.size();
    for (QChar *p = out.data(); p < end; ++p) {
        const QChar c = *p;
        if (c.isHighSurrogate() && p + 1 < end && p[1].isLowSurrogate())
            casePair(p++, first);
        else
            *p = cased(c, first);
        first = c.unicode() <= u' ' || (c.unicode() >= 0x7F && partsWords(c));
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
    s.replace("\r\n"_L1, "\n"_L1);
    s.replace(u'\r', u'\n');
    return s;
}

} // namespace text
