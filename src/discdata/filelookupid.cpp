#include "discdata/filelookupid.h"

#include "discs/cddbanswer.h"
#include "discs/discid.h"
#include "tags/CddbID3Tag.h"

#include <QStringList>
#include <QUuid>

using namespace Qt::StringLiterals;

namespace
{

constexpr int mostTracks = 99;
constexpr auto ownerOfMusicBrainz = "http://musicbrainz.org"_L1;

bool isId(const QString &text)
{
    return !QUuid::fromString(text).isNull() && text.size() == 36;
}

bool isNumber(const QString &text, int most)
{
    const int number = text.toInt();
    return number >= 1 && number <= most && text == QString::number(number);
}

bool areKeys(const DiscRecord &record)
{
    if (record.service == "musicbrainz"_L1)
        return isId(record.keyA) && isNumber(record.keyB, 999);
    return record.service == "cddb"_L1 && cddbCategories().contains(record.keyA) &&
           tracksOfCddbId(record.keyB) > 0;
}

// "service:key:key:track"
std::optional<TrackOfFileId> ownTrack(const QString &text)
{
    const QStringList parts = text.split(u':');
    if (parts.size() != 4 || !isNumber(parts[3], mostTracks))
        return {};
    TrackOfFileId id;
    id.record.service = parts[0];
    id.record.keyA = parts[1];
    id.record.keyB = parts[2];
    id.track = parts[3].toInt();
    return areKeys(id.record) ? std::optional(id) : std::nullopt;
}

} // namespace

std::optional<TrackOfFileId> trackOfFileId(const QString &fileId)
{
    const qsizetype sign = fileId.lastIndexOf(u'=');
    const QString owner = fileId.left(sign < 0 ? 0 : sign);
    const QByteArray hex = fileId.mid(sign + 1).toLatin1();
    const QString text = QString::fromLatin1(QByteArray::fromHex(hex));
    if (owner == QLatin1String(ownFileIdOwner))
        return ownTrack(text);
    if (owner != ownerOfMusicBrainz || !isId(text))
        return {};
    TrackOfFileId id;
    id.recording = text.toLower();
    return id;
}

QString fileIdOf(const DiscRecord &disc, int track)
{
    if (disc.fromA.isEmpty() || disc.fromB.isEmpty())
        return {};
    const QStringList parts{disc.service, disc.fromA, disc.fromB, QString::number(track)};
    return QLatin1String(ownFileIdOwner) + u'=' +
           QString::fromLatin1(parts.join(u':').toUtf8().toHex());
}
