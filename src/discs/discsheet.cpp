#include "discs/discsheet.h"

#include "discs/candidates.h"
#include "platform/text/codepage.h"

#include <QRegularExpression>
#include <QSet>
#include <QStringConverter>

using namespace Qt::StringLiterals;

namespace discsheet
{

namespace
{

constexpr int framesPerMinute = 60 * framesPerSecond;

QSet<QString> artistsOf(const DiscRecord &disc)
{
    QSet<QString> names;
    for (const TrackRecord &track : disc.tracks)
        names.insert(track.artist.name.toCaseFolded());
    names.remove({});
    return names;
}

} // namespace

QString decoded(QByteArrayView bytes)
{
    const auto marked = QStringConverter::encodingForData(bytes);
    if (marked && *marked != QStringConverter::Utf8)
        return QStringDecoder(*marked).decode(bytes);
    const QByteArrayView content = text::withoutByteOrderMark(bytes);
    return text::decode(content, text::encodingOf(content));
}

std::optional<qint64> framesOf(const QString &minutesSecondsFrames)
{
    static const QRegularExpression form(u"^([0-9]{1,4}):([0-5]?[0-9]):([0-6]?[0-9]|7[0-4])$"_s);
    const auto match = form.match(minutesSecondsFrames);
    if (!match.hasMatch())
        return {};
    const auto part = [&](int n) { return match.captured(n).toLongLong(); };
    return part(1) * framesPerMinute + part(2) * framesPerSecond + part(3);
}

bool complete(DiscSheet &sheet)
{
    DiscRecord &disc = sheet.known;
    disc.trackCount = int(disc.tracks.size());
    if (sheet.missing.isEmpty() && !sheet.toc.isValid())
        return false;
    if (!sheet.missing.isEmpty())
        sheet.toc = {};
    const QSet<QString> artists = artistsOf(disc);
    disc.isCompilation =
        isVariousArtists(disc.artist.name) || (disc.artist.name.isEmpty() && artists.size() > 1);
    if (disc.artist.name.isEmpty() && artists.size() == 1)
        disc.artist = disc.tracks.front().artist;
    for (TrackRecord &track : disc.tracks) {
        if (track.artist.name.isEmpty())
            track.artist = disc.artist;
    }
    const std::vector<int> lengths = sheet.toc.lengths();
    for (size_t i = 0; i < lengths.size(); ++i)
        disc.tracks[i].length = lengths[i];
    return true;
}

} // namespace discsheet
