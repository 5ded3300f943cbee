#include "discs/candidates.h"
#include "discs/discid.h"
#include "discs/partofset.h"
#include "discs/xmcd.h"

#include <QRegularExpression>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype longestLine = 256; // bytes, with the line end

QByteArray escaped(const QString &text)
{
    return cleanText(text).replace(u'\\', u"\\\\"_s).toUtf8();
}

// How many bytes stand together at a place: a letter of UTF-8, or a sign and its escape.
qsizetype unitAt(const QByteArray &text, qsizetype at)
{
    qsizetype end = at + 1;
    if (text[at] == '\\')
        return 2;
    while (end < text.size() && (uchar(text[end]) & 0xC0) == 0x80)
        ++end;
    return end - at;
}

qsizetype fittingFrom(const QByteArray &text, qsizetype from, qsizetype room)
{
    qsizetype end = from;
    while (end < text.size() && end + unitAt(text, end) - from <= room)
        end += unitAt(text, end);
    return end - from;
}

void add(QByteArray &record, const QByteArray &key, const QString &text)
{
    const QByteArray value = escaped(text);
    const qsizetype room = longestLine - key.size() - 2;
    qsizetype from = 0;
    do {
        const qsizetype length = fittingFrom(value, from, room);
        record += key + '=' + value.mid(from, length) + '\n';
        from += length;
    } while (from < value.size());
}

// A name in front of " / " must not hold that sign itself: "A / B" goes as "A/B".
QString withoutSeparator(const QString &name)
{
    QString plain = cleanText(name).replace(u" / "_s, u"/"_s);
    if (plain.endsWith(u" /"))
        plain.replace(plain.size() - 2, 2, u"/"_s);
    return plain;
}

// The remark on the set that was taken out of the title when it was read.
QString titleWithPart(const DiscRecord &disc)
{
    const bool isOne = disc.totalInSet.toInt() <= 1;
    if (isOne || partOfSet(disc.title, disc.notes).number == disc.numberInSet)
        return disc.title;
    const QString total =
        disc.numberInSet == disc.totalInSet ? QString() : u" of "_s + disc.totalInSet;
    return disc.title + u" (Disc "_s + disc.numberInSet + total + u')';
}

QString discTitle(const DiscRecord &disc)
{
    const bool isNameless = disc.isCompilation && disc.artist.name.trimmed().isEmpty();
    const QString artist = isNameless ? u"Various"_s : withoutSeparator(disc.artist.name);
    return artist + u" / "_s + cleanText(titleWithPart(disc));
}

QString trackTitle(const DiscRecord &disc, const TrackRecord &track)
{
    if (!disc.isCompilation)
        return track.title;
    const bool isNameless =
        track.artist.name.trimmed().isEmpty() || isVariousArtists(track.artist.name);
    if (isNameless)
        return withoutSeparator(track.title);
    return withoutSeparator(track.artist.name) + u" / "_s + cleanText(track.title);
}

QString idsOf(const DiscRecord &disc, const TableOfContents &toc)
{
    QStringList ids = disc.discIds;
    if (!ids.contains(cddbId(toc), Qt::CaseInsensitive))
        ids.prepend(cddbId(toc));
    return ids.join(u',');
}

QByteArray comments(const DiscRecord &disc, const TableOfContents &toc, const QString &sender)
{
    QByteArray text = "# xmcd\n#\n# Track frame offsets:\n";
    for (const TocTrack &track : toc.tracks)
        text += "#\t" + QByteArray::number(track.offset) + '\n';
    text += "#\n# Disc length: " + QByteArray::number(toc.seconds()) + " seconds\n#\n";
    text += "# Revision: " + QByteArray::number(std::max(disc.revision, 0)) + '\n';
    return text + "# Submitted via: " + cleanText(sender).toUtf8() + "\n#\n";
}

void addNumbered(QByteArray &record, const char *key, std::size_t number, const QString &text)
{
    add(record, key + QByteArray::number(qulonglong(number)), text);
}

// "", "Track 1", "Titel 03", "Audio track 7", "12".
bool isUntitled(const TrackRecord &track)
{
    static const QRegularExpression pattern(
        u"^(audio\\s?)?(track|title|titel|nummer|piste|plage|spur|stück|song|untitled|"
        "unknown|onbekend|unbekannt|\\[untitled\\])?\\W{0,3}\\d{0,3}$"_s,
        QRegularExpression::CaseInsensitiveOption | QRegularExpression::UseUnicodePropertiesOption);
    return pattern.match(cleanText(track.title)).hasMatch();
}

bool isMostlyUntitled(const DiscRecord &disc)
{
    const auto untitled = std::ranges::count_if(disc.tracks, isUntitled);
    return untitled * 2 > std::ranges::ssize(disc.tracks);
}

} // namespace

QByteArray writeXmcd(const DiscRecord &disc, const TableOfContents &toc, const QString &client,
                     const QString &version)
{
    static const TrackRecord none;
    const auto track = [&](std::size_t i) -> const TrackRecord & {
        return i < disc.tracks.size() ? disc.tracks[i] : none;
    };
    QByteArray record = comments(disc, toc, client + u' ' + version);
    add(record, "DISCID", idsOf(disc, toc));
    add(record, "DTITLE", discTitle(disc));
    add(record, "DYEAR", yearOf(disc.year));
    add(record, "DGENRE", disc.genre);
    for (std::size_t i = 0; i < toc.tracks.size(); ++i)
        addNumbered(record, "TTITLE", i, trackTitle(disc, track(i)));
    add(record, "EXTD", disc.notes);
    for (std::size_t i = 0; i < toc.tracks.size(); ++i)
        addNumbered(record, "EXTT", i, track(i).notes);
    return record + "PLAYORDER=\n";
}

const char *notToBeSent(const DiscRecord &disc, const TableOfContents &toc)
{
    if (disc.tracks.size() != toc.tracks.size())
        return "xNotSentTracks";
    if (cleanText(disc.title).isEmpty())
        return "xNotSentTitle";
    if (!disc.isCompilation && cleanText(disc.artist.name).isEmpty())
        return "xNotSentArtist";
    return isMostlyUntitled(disc) ? "xNotSentUntitled" : nullptr;
}
