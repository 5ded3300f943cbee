#include "tags/tagtexts.h"

#include <QStringDecoder>
#include <QStringEncoder>
#include <algorithm>
#include <id3v1genres.h>

using namespace Qt::StringLiterals;

namespace
{

enum Encoding : char { latin1 = 0, utf16 = 1, utf16BigEndian = 2, utf8 = 3 };

bool isWide(char encoding)
{
    return encoding == utf16 || encoding == utf16BigEndian;
}

// Where the zero stands that ends a text; the end of the bytes if none does.
qsizetype endOfText(QByteArrayView bytes, qsizetype from, bool wide)
{
    if (!wide)
        return std::find(bytes.begin() + from, bytes.end(), '\0') - bytes.begin();
    qsizetype at = from;
    while (at + 1 < bytes.size() && (bytes[at] != 0 || bytes[at + 1] != 0))
        at += 2;
    return at + 1 < bytes.size() ? at : bytes.size();
}

// The order of bytes holds for the texts behind it that tell none.
QString decoded(QByteArrayView bytes, char encoding, QStringConverter::Encoding &order)
{
    if (encoding == latin1)
        return QString::fromLatin1(bytes);
    if (encoding == utf8)
        return QString::fromUtf8(bytes);
    if (bytes.startsWith("\xFF\xFE"_ba))
        order = QStringConverter::Utf16LE;
    else if (bytes.startsWith("\xFE\xFF"_ba))
        order = QStringConverter::Utf16BE;
    QStringDecoder decode(order, QStringConverter::Flag::Stateless);
    return decode(bytes);
}

QString genreOfNumber(const QString &number)
{
    if (number == "RX"_L1)
        return u"Remix"_s;
    if (number == "CR"_L1)
        return u"Cover"_s;
    bool isNumber = false;
    const int index = number.toInt(&isNumber);
    if (!isNumber)
        return {};
    const TagLib::String name = TagLib::ID3v1::genre(index);
    return QString::fromUtf8(QByteArray::fromStdString(name.to8Bit(true)));
}

} // namespace

QString withoutFilling(const QString &text)
{
    const auto isFilling = [](QChar c) { return c.isNull() || c.isSpace(); };
    qsizetype from = 0, to = text.size();
    while (to > from && isFilling(text[to - 1]))
        --to;
    while (from < to && isFilling(text[from]))
        ++from;
    return text.sliced(from, to - from);
}

QStringList frameTexts(const QByteArray &content)
{
    QStringList texts;
    if (content.isEmpty() || content[0] < latin1 || content[0] > utf8)
        return texts;
    const char encoding = content[0];
    const bool wide = isWide(encoding);
    auto order = encoding == utf16BigEndian ? QStringConverter::Utf16BE : QStringConverter::Utf16LE;
    for (qsizetype from = 1; from < content.size();) {
        const qsizetype end = endOfText(content, from, wide);
        texts.append(decoded(QByteArrayView(content).sliced(from, end - from), encoding, order));
        from = end + (wide ? 2 : 1);
    }
    return texts;
}

QByteArray behindTexts(const QByteArray &content, int count)
{
    if (content.isEmpty())
        return {};
    const bool wide = isWide(content[0]);
    qsizetype from = 1;
    for (int i = 0; i < count; ++i)
        from = std::min(endOfText(content, from, wide) + (wide ? 2 : 1), content.size());
    return content.first(1) + content.mid(from);
}

QByteArray encodedText(const QString &text, int version)
{
    const auto fits = [&](char16_t last) {
        return std::all_of(text.begin(), text.end(), [last](QChar c) {
            return c.unicode() <= last && (c.unicode() < 0x80 || c.unicode() >= 0xA0);
        });
    };
    if (fits(version == 4 ? 0x7F : 0xFF))
        return char(latin1) + text.toLatin1();
    if (version == 4) // never holds the byte FF, which sound begins with
        return char(utf8) + text.toUtf8();
    QStringEncoder encode(QStringConverter::Utf16LE, QStringConverter::Flag::WriteBom);
    return char(utf16) + QByteArray(encode(text));
}

QString withoutZeros(const QString &numbers)
{
    QStringList parts = numbers.split(u'/');
    for (QString &part : parts) {
        while (part.size() > 1 && part.startsWith(u'0') && part[1].isDigit())
            part.remove(0, 1);
    }
    return parts.join(u'/');
}

QStringList genreNames(const QString &genre)
{
    QStringList names;
    QString rest = genre;
    while (rest.startsWith(u'(') && !rest.startsWith("(("_L1)) {
        const qsizetype end = rest.indexOf(u')');
        const QString name = end < 0 ? QString() : genreOfNumber(rest.mid(1, end - 1));
        if (name.isEmpty())
            break;
        names.append(name);
        rest = withoutFilling(rest.mid(end + 1));
    }
    if (rest.startsWith("(("_L1))
        rest.remove(0, 1);
    const QString name = genreOfNumber(rest);
    rest = name.isEmpty() ? rest : name;
    if (!rest.isEmpty())
        names.append(rest);
    return names;
}
