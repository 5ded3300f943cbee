#include "platform/text/normalform.h"

#include <algorithm>

namespace text
{

QByteArray nfc(QStringView s)
{
    const auto inNfc = [](QChar c) { return c.unicode() < 0x300; };
    if (std::all_of(s.begin(), s.end(), inNfc))
        return s.toUtf8();
    return s.toString().normalized(QString::NormalizationForm_C).toUtf8();
}

bool surelyNfc(std::string_view utf8)
{
    constexpr unsigned char firstByteOfU0300 = 0xCC;
    return std::all_of(utf8.begin(), utf8.end(),
                       [](unsigned char byte) { return byte < firstByteOfU0300; });
}

QString fromUtf8(std::string_view utf8)
{
    const QString text = QString::fromUtf8(utf8.data(), qsizetype(utf8.size()));
    return utf8.starts_with("\xEF\xBB\xBF") ? QChar(QChar::ByteOrderMark) + text : text;
}

} // namespace text
