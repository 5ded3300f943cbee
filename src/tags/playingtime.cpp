#include "tags/playingtime.h"

#include "platform/files/ordinaryfile.h"

#include <QFile>
#include <QFileInfo>
#include <QSet>
#include <fileref.h>
#include <tag.h>

using namespace Qt::StringLiterals;

namespace
{

QString text(const TagLib::String &text)
{
    return QString::fromStdWString(text.toWString()).simplified();
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
    const QByteArray path = QFile::encodeName(name);
    const TagLib::FileRef file(path.constData(), true, TagLib::AudioProperties::Average);
    if (file.isNull() || !file.audioProperties() ||
        file.audioProperties()->lengthInMilliseconds() <= 0)
        return {};
    SoundFile sound;
    sound.length = file.audioProperties()->lengthInMilliseconds();
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
