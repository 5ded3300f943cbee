#include "tags/soundfacts.h"

#include "platform/files/nativename.h"
#include "platform/files/ordinaryfile.h"

#include <id3v2framefactory.h>
#include <id3v2header.h>
#include <id3v2tag.h>
#include <mpegfile.h>

using namespace Qt::StringLiterals;

std::optional<SoundFacts> soundFacts(const QString &path)
{
    if (!isOrdinaryFile(path))
        return {};
    TagLib::MPEG::File file(nativeName(path).constData(), TagLib::ID3v2::FrameFactory::instance());
    if (!file.isOpen() || !file.audioProperties() ||
        file.audioProperties()->lengthInMilliseconds() <= 0)
        return {};
    SoundFacts facts{
        file.audioProperties()->lengthInMilliseconds(), file.audioProperties()->bitrate(), {}};
    if (file.hasID3v2Tag())
        facts.tagVersion = u"ID3v2."_s + QString::number(file.ID3v2Tag()->header()->majorVersion());
    return facts;
}
