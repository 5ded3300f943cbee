#include "platform/files/nativename.h"

#include <QFile>
#include <QStringDecoder>

namespace
{

constexpr char16_t firstByte = 0xEF80; // stands for 0x80; the last, 0xEFFF, for 0xFF
constexpr char16_t lastByte = 0xEFFF;

bool isByte(QChar c)
{
    return c.unicode() >= firstByte && c.unicode() <= lastByte;
}

// How many bytes a character of UTF-8 has by its first one; 0: none begins so.
qsizetype lengthBy(uchar first)
{
    constexpr uchar two = 0xC2, three = 0xE0, four = 0xF0, end = 0xF5;
    return first < 0x80                  ? 1
           : first < two || first >= end ? 0
           : first < three               ? 2
           : first < four                ? 3
                                         : 4;
}

// The character at the beginning; empty if there is no whole one, or one that stands for a byte.
QString characterOf(QByteArrayView bytes)
{
    const qsizetype length = lengthBy(uchar(bytes.front()));
    if (length == 0 || length > bytes.size())
        return {};
    QStringDecoder decode(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
    QString character = decode(bytes.first(length));
    return decode.hasError() || isByte(character.front()) ? QString() : character;
}

} // namespace

QString nameOfNative(const QByteArray &bytes)
{
    QStringDecoder decode(QStringDecoder::Utf8, QStringDecoder::Flag::Stateless);
    QString all = decode(bytes);
    if (!decode.hasError() && std::none_of(all.cbegin(), all.cend(), isByte))
        return all;
    QString name;
    for (QByteArrayView rest(bytes); !rest.isEmpty();) {
        const QString character = characterOf(rest);
        const bool isText = !character.isEmpty();
        name += isText ? character : QString(QChar(firstByte + (uchar(rest.front()) - 0x80)));
        rest = rest.sliced(isText ? lengthBy(uchar(rest.front())) : 1);
    }
    return name;
}

QByteArray nativeName(const QString &name)
{
    if (std::none_of(name.cbegin(), name.cend(), isByte))
        return QFile::encodeName(name);
    QByteArray bytes;
    for (qsizetype at = 0; at < name.size();) {
        if (isByte(name[at])) {
            bytes += char(0x80 + (name[at].unicode() - firstByte));
            ++at;
            continue;
        }
        qsizetype end = at;
        while (end < name.size() && !isByte(name[end]))
            ++end;
        bytes += QFile::encodeName(name.sliced(at, end - at));
        at = end;
    }
    return bytes;
}
