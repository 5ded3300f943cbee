#include "platform/text/codepage.h"

#include <QUtf8StringView>

namespace text
{

namespace
{

// The bytes 0x80 to 0x9F of Windows-1252; all others are Latin-1.
constexpr char16_t high1252[32] = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178,
};

QString decode1252(QByteArrayView bytes)
{
    QString out = QString::fromLatin1(bytes);
    for (QChar &c : out) {
        if (c.unicode() >= 0x80 && c.unicode() < 0xA0)
            c = QChar(high1252[c.unicode() - 0x80]);
    }
    return out;
}

} // namespace

Encoding encodingOf(QByteArrayView bytes)
{
    return QUtf8StringView(bytes.data(), bytes.size()).isValidUtf8() ? Encoding::Utf8
                                                                     : Encoding::Windows1252;
}

QString decode(QByteArrayView bytes, Encoding encoding)
{
    return encoding == Encoding::Utf8 ? QString::fromUtf8(bytes) : decode1252(bytes);
}

QByteArrayView withoutByteOrderMark(QByteArrayView bytes)
{
    return bytes.startsWith("\xEF\xBB\xBF") ? bytes.sliced(3) : bytes;
}

} // namespace text
