#include "support/madesound.h"

#include "support/testcatalogue.h"

#include <QtEndian>

using namespace Qt::StringLiterals;

namespace
{

constexpr int frameBytes = 104; // 32 kbit/s, 44.1 kHz, mono
constexpr double frameLength = 1152 * 1000.0 / 44100;
constexpr int framesThere = 8;

QByteArray big(quint32 number)
{
    number = qToBigEndian(number);
    return {reinterpret_cast<const char *>(&number), sizeof number};
}

QByteArray frame()
{
    return QByteArray("\xFF\xFB\x10\xC0", 4) + QByteArray(frameBytes - 4, '\0');
}

// What stands behind the side information, 17 bytes in mono.
QByteArray frameThatTells(int frames)
{
    QByteArray first = frame();
    const QByteArray told =
        "Xing" + big(3) + big(quint32(frames)) + big(quint32(frames * frameBytes));
    return first.replace(4 + 17, told.size(), told);
}

QByteArray tagFrame(const QByteArray &name, const QByteArray &content)
{
    return name + big(quint32(content.size())) + QByteArray(2, '\0') + content;
}

// Sizes of tags have seven bits in each byte.
QByteArray tagOf(const QByteArray &frames)
{
    const auto size = quint32(frames.size());
    return QByteArray("ID3\3\0\0", 6) +
           big((size & 0x7F) | (size & 0x3F80) << 1 | (size & 0x1FC000) << 2) + frames;
}

} // namespace

QByteArray silentMP3(int milliseconds)
{
    const int frames = std::max(1, qRound(milliseconds / frameLength));
    return frameThatTells(frames) + frame().repeated(framesThere);
}

QByteArray id3Tag(const std::vector<std::pair<QByteArray, QString>> &frames)
{
    QByteArray all;
    for (const auto &[name, text] : frames) {
        const QByteArray utf16(reinterpret_cast<const char *>(text.utf16()), text.size() * 2);
        all += tagFrame(name, "\1\xFF\xFE" + utf16);
    }
    return tagOf(all);
}

QByteArray fileIdTag(const QByteArray &owner, const QByteArray &id)
{
    return tagOf(tagFrame("UFID", owner + '\0' + id));
}

QStringList makeSounds(const QString &folder,
                       const std::vector<std::pair<QString, int>> &namesAndMilliseconds)
{
    QStringList names;
    for (const auto &[name, milliseconds] : namesAndMilliseconds)
        names.append(writeFile(folder + u'/' + name, silentMP3(milliseconds)));
    return names;
}
