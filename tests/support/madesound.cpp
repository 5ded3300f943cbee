#include "support/madesound.h"

#include "support/madetag.h"
#include "support/testcatalogue.h"

#include <cmath>

using namespace Qt::StringLiterals;

namespace
{

constexpr int frameBytes = 104; // 32 kbit/s, 44.1 kHz, mono
constexpr int frameSamples = 1152;
constexpr int framesThere = 8;
constexpr int delay = 576; // samples before the sound

QByteArray soundFrame()
{
    return QByteArray("\xFF\xFB\x10\xC0", 4) + QByteArray(frameBytes - 4, '\0');
}

// What stands behind the side information, 17 bytes in mono.
QByteArray frameThatTells(int frames, int added)
{
    QByteArray told =
        "Xing" + tagNumber(3, 8) + tagNumber(frames, 8) + tagNumber(frames * frameBytes, 8);
    if (added > 0)
        told += "LAME3.100" + QByteArray(12, '\0') + tagNumber(delay << 12 | (added - delay), 8, 3);
    return soundFrame().replace(4 + 17, told.size(), told);
}

} // namespace

QByteArray silentMP3(int milliseconds, Added added)
{
    const double samples = milliseconds * 44.1;
    const bool told = added == Added::Told;
    const int frames = told ? int(std::ceil((samples + delay) / frameSamples))
                            : std::max(1, qRound(samples / frameSamples));
    return frameThatTells(frames, told ? frames * frameSamples - qRound(samples) : 0) +
           soundFrame().repeated(framesThere);
}

QByteArray id3Tag(const std::vector<std::pair<QByteArray, QString>> &frames)
{
    QByteArray all;
    for (const auto &[name, text] : frames) {
        const QByteArray utf16(reinterpret_cast<const char *>(text.utf16()), text.size() * 2);
        all += frame(name.constData(), "\1\xFF\xFE" + utf16);
    }
    return tagOf(all);
}

QStringList makeSounds(const QString &folder,
                       const std::vector<std::pair<QString, int>> &namesAndMilliseconds)
{
    QStringList names;
    for (const auto &[name, milliseconds] : namesAndMilliseconds)
        names.append(writeFile(folder + u'/' + name, silentMP3(milliseconds)));
    return names;
}
