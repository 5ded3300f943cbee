#include "tags/playingtime.h"

#include "platform/files/nativename.h"
#include "platform/files/ordinaryfile.h"

#include <QFileInfo>
#include <QSet>
#include <fileref.h>
#include <mpegfile.h>
#include <tag.h>

using namespace Qt::StringLiterals;

namespace
{

QString text(const TagLib::String &text)
{
    return QString::fromStdWString(text.toWString()).simplified();
}

// Encoders put silence around the sound, to fill whole frames, and the better ones say how much, in
// the frame that also tells the length: "Xing" or "Info", four fields of which flags tell, and
// behind them a name. In milliseconds; 0 where it is not told. Without it a file is as long as the
// track that it was made of.
int addedSilence(TagLib::MPEG::File &file)
{
    constexpr unsigned longestFrame = 256, samplesAt = 21;
    file.seek(std::max(file.firstFrameOffset(), 0L));
    const TagLib::ByteVector block = file.readBlock(longestFrame);
    const QByteArray frame(block.data(), qsizetype(block.size()));
    const qsizetype head = std::max(frame.indexOf("Xing"), frame.indexOf("Info"));
    const int rate = file.audioProperties()->sampleRate();
    if (head < 0 || head + 8 > frame.size() || rate <= 0)
        return 0;
    qsizetype at = head + 8;
    constexpr int sizes[] = {4, 4, 100, 4};
    for (int flag = 0; const int size : sizes)
        at += frame[head + 7] & (1 << flag++) ? size : 0;
    const QByteArray encoder = frame.mid(at, 4);
    if ((encoder != "LAME" && encoder != "Lavf" && encoder != "Lavc") ||
        at + samplesAt + 3 > frame.size())
        return 0;
    const auto byte = [&](int n) { return int(uchar(frame[at + samplesAt + n])); };
    const int before = byte(0) << 4 | byte(1) >> 4, behind = (byte(1) & 15) << 8 | byte(2);
    return qRound((before + behind) * 1000.0 / rate);
}

} // namespace

bool isSoundFile(const QString &name)
{
    static const QSet<QString> endings{
        u"mp3"_s, u"flac"_s, u"ogg"_s, u"oga"_s, u"opus"_s, u"m4a"_s, u"wav"_s, u"aif"_s, u"aiff"_s,
        u"wma"_s, u"ape"_s,  u"wv"_s,  u"mpc"_s, u"mp2"_s,  u"aac"_s, u"tta"_s, u"spx"_s};
    return endings.contains(QFileInfo(name).suffix().toLower());
}

std::optional<SoundFile> readSoundFile(const QString &name)
{
    if (!isOrdinaryFile(name))
        return {};
    const QByteArray path = nativeName(name);
    const TagLib::FileRef file(path.constData(), true, TagLib::AudioProperties::Average);
    if (file.isNull() || !file.audioProperties() ||
        file.audioProperties()->lengthInMilliseconds() <= 0)
        return {};
    SoundFile sound;
    sound.length = file.audioProperties()->lengthInMilliseconds();
    if (auto *mpeg = dynamic_cast<TagLib::MPEG::File *>(file.file()))
        sound.length -= addedSilence(*mpeg);
    if (const TagLib::Tag *tag = file.tag()) {
        sound.artist = text(tag->artist());
        sound.album = text(tag->album());
        sound.title = text(tag->title());
        sound.genre = text(tag->genre());
        sound.year = int(tag->year());
        sound.track = int(tag->track());
    }
    return sound;
}
