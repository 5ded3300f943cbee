#include "discs/discid.h"

#include <QCryptographicHash>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

// Between the last track of sound and a session of data behind it: lead-out, lead-in and pause.
constexpr int sessionGap = 11400;
constexpr int mostTracks = 99;

int digitSum(int number)
{
    int sum = 0;
    for (; number > 0; number /= 10)
        sum += number % 10;
    return sum;
}

QString hex(int number, int width)
{
    return u"%1"_s.arg(uint(number), width, 16, QChar(u'0'));
}

// The offsets with blanks between, a blank in front of each.
QString offsetsOf(const TableOfContents &toc)
{
    QString all;
    for (const TocTrack &track : toc.tracks)
        all += u' ' + QString::number(track.offset);
    return all;
}

} // namespace

QString cddbId(const TableOfContents &toc)
{
    if (toc.tracks.empty())
        return {};
    int sum = 0;
    for (const TocTrack &track : toc.tracks)
        sum += digitSum(track.offset / framesPerSecond);
    const int playing = toc.seconds() - toc.tracks.front().offset / framesPerSecond;
    return hex(sum % 0xFF, 2) + hex(playing & 0xFFFF, 4) + hex(int(toc.tracks.size()) & 0xFF, 2);
}

QString cddbQuery(const TableOfContents &toc)
{
    return cddbId(toc) + u' ' + QString::number(toc.tracks.size()) + offsetsOf(toc) + u' ' +
           QString::number(toc.seconds());
}

int tracksOfCddbId(const QString &id)
{
    static const QRegularExpression form(u"^[0-9A-Fa-f]{8}$"_s);
    return form.match(id).hasMatch() ? id.right(2).toInt(nullptr, 16) : 0;
}

QString cddbQueryOfId(const QString &id)
{
    const int tracks = tracksOfCddbId(id), playing = id.mid(2, 4).toInt(nullptr, 16);
    QString all = id + u' ' + QString::number(tracks);
    for (int track = 0; track < tracks; ++track)
        all += u' ' + QString::number(firstFrame + playing * framesPerSecond / tracks * track);
    return all + u' ' + QString::number(playing + firstFrame / framesPerSecond);
}

TableOfContents withoutDataBehind(TableOfContents toc)
{
    const auto drop = [&] {
        toc.leadOut = toc.tracks.back().offset - sessionGap;
        toc.tracks.pop_back();
    };
    const bool hasData = !toc.tracks.empty() && toc.tracks.back().isData;
    while (toc.tracks.size() > 1 && toc.tracks.back().isData)
        drop();
    // Copy-protected discs tell offsets that cannot be.
    while (hasData && toc.tracks.size() > 1 && toc.leadOut < toc.tracks.back().offset)
        drop();
    return toc;
}

QString musicBrainzId(const TableOfContents &toc)
{
    const TableOfContents counted = withoutDataBehind(toc);
    if (counted.tracks.empty())
        return {};
    QString text = hex(counted.first, 2) + hex(counted.first + int(counted.tracks.size()) - 1, 2) +
                   hex(counted.leadOut, 8);
    for (int number = 1; number <= mostTracks; ++number) {
        const auto at = std::size_t(number - counted.first);
        text += hex(at < counted.tracks.size() ? counted.tracks[at].offset : 0, 8);
    }
    const QByteArray sum =
        QCryptographicHash::hash(text.toUpper().toLatin1(), QCryptographicHash::Sha1);
    return QString::fromLatin1(
        sum.toBase64().replace('+', '.').replace('/', '_').replace('=', '-'));
}

QString musicBrainzToc(const TableOfContents &toc)
{
    const TableOfContents counted = withoutDataBehind(toc);
    return QString::number(counted.first) + u' ' +
           QString::number(counted.first + int(counted.tracks.size()) - 1) + u' ' +
           QString::number(counted.leadOut) + offsetsOf(counted);
}
