#include "discs/xmcd.h"

#include "discs/candidates.h"
#include "discs/genretable.h"
#include "discs/notunderstood.h"
#include "discs/partofset.h"
#include "discs/samplertracks.h"
#include "platform/text/codepage.h"

#include <QRegularExpression>

#include <algorithm>
#include <map>

using namespace Qt::StringLiterals;

namespace
{

constexpr std::size_t mostTracks = 99;
constexpr int millisecondsPerSecond = 1000;

// The lines of a record by key, those of one key joined: a break may stand inside a letter.
struct Lines {
    std::map<QByteArray, QByteArray, std::less<>> disc;
    std::vector<QByteArray> titles, notes;
    std::vector<int> offsets;
    int seconds = 0, revision = 0;
    bool inOffsets = false;
    bool isTooLong = false;
    text::Encoding encoding = text::Encoding::Utf8;

    QString valueOf(const QByteArray &bytes) const;
    QString valueOf(const char *key) const;
};

// The text of a value: decoded, then "\n", "\t" and "\\" undone.
QString unescaped(const QString &text)
{
    if (!text.contains(u'\\'))
        return text;
    QString plain;
    plain.reserve(text.size());
    for (qsizetype at = 0; at < text.size(); ++at) {
        const QChar next = text[at] == u'\\' && at + 1 < text.size() ? text[at + 1] : QChar();
        if (next == u'n' || next == u't')
            plain += u' ';
        else if (next == u'\\')
            plain += u'\\';
        else {
            plain += text[at];
            continue;
        }
        ++at;
    }
    return plain;
}

QString Lines::valueOf(const QByteArray &bytes) const
{
    return unescaped(text::decode(bytes, encoding));
}

QString Lines::valueOf(const char *key) const
{
    const auto found = disc.find(key);
    return found == disc.end() ? QString() : valueOf(found->second);
}

// The number at the start of a text; -1 without one.
int numberIn(QByteArrayView text)
{
    const QByteArrayView trimmed = text.trimmed();
    qsizetype digits = 0;
    while (digits < trimmed.size() && trimmed[digits] >= '0' && trimmed[digits] <= '9')
        ++digits;
    bool isNumber = false;
    const int number = trimmed.first(digits).toInt(&isNumber);
    return isNumber ? number : -1;
}

bool isNumberAlone(QByteArrayView text)
{
    return !text.isEmpty() &&
           std::ranges::all_of(text, [](char c) { return c >= '0' && c <= '9'; });
}

void takeOffset(QByteArrayView comment, Lines &lines)
{
    if (!isNumberAlone(comment)) {
        lines.inOffsets = comment.isEmpty() && lines.offsets.empty();
        return;
    }
    if (lines.offsets.size() <= mostTracks)
        lines.offsets.push_back(numberIn(comment));
}

void takeComment(QByteArrayView comment, Lines &lines)
{
    const auto valueBehind = [&](const char *label) {
        return numberIn(comment.sliced(qsizetype(qstrlen(label))));
    };
    if (comment.startsWith("Track frame offsets"))
        lines.inOffsets = true;
    else if (comment.startsWith("Disc length:"))
        lines.seconds = std::max(valueBehind("Disc length:"), 0);
    else if (comment.startsWith("Revision:"))
        lines.revision = std::max(valueBehind("Revision:"), 0);
    else if (lines.inOffsets)
        takeOffset(comment, lines);
}

// The value of a numbered key; nullptr above the most tracks that a disc can have.
QByteArray *placeOf(std::vector<QByteArray> &values, QByteArrayView number)
{
    const int index = isNumberAlone(number) ? numberIn(number) : -1;
    if (index < 0 || std::size_t(index) >= mostTracks)
        return nullptr;
    if (values.size() <= std::size_t(index))
        values.resize(std::size_t(index) + 1);
    return &values[std::size_t(index)];
}

void takeData(QByteArrayView key, QByteArrayView value, Lines &lines)
{
    static const QByteArrayView title("TTITLE"), notes("EXTT");
    QByteArray *place = nullptr;
    if (key.startsWith(title)) {
        place = placeOf(lines.titles, key.sliced(title.size()));
        lines.isTooLong |= !place && isNumberAlone(key.sliced(title.size()));
    } else if (key.startsWith(notes)) {
        place = placeOf(lines.notes, key.sliced(notes.size()));
    } else if (key == "DISCID" || key == "DTITLE" || key == "DYEAR" || key == "DGENRE" ||
               key == "EXTD") {
        place = &lines.disc[key.toByteArray()];
    }
    if (place)
        place->append(value);
}

void takeLine(QByteArrayView line, Lines &lines)
{
    if (line.startsWith('#'))
        return takeComment(line.sliced(1).trimmed(), lines);
    const auto sign = line.indexOf('=');
    if (sign > 0)
        takeData(line.first(sign), line.sliced(sign + 1), lines);
}

text::Encoding encodingOf(const Lines &lines)
{
    const auto isUtf8 = [](const QByteArray &value) {
        return text::encodingOf(value) == text::Encoding::Utf8;
    };
    const bool isAll =
        std::ranges::all_of(lines.disc, [&](const auto &entry) { return isUtf8(entry.second); }) &&
        std::ranges::all_of(lines.titles, isUtf8) && std::ranges::all_of(lines.notes, isUtf8);
    return isAll ? text::Encoding::Utf8 : text::Encoding::Windows1252;
}

Lines linesOf(QByteArrayView bytes)
{
    Lines lines;
    while (!bytes.isEmpty()) {
        const auto end = bytes.indexOf('\n');
        QByteArrayView line = end < 0 ? bytes : bytes.first(end);
        bytes = end < 0 ? QByteArrayView() : bytes.sliced(end + 1);
        if (line.endsWith('\r'))
            line.chop(1);
        takeLine(line, lines);
    }
    lines.encoding = encodingOf(lines);
    return lines;
}

void dropImpossible(std::vector<int> &offsets)
{
    const bool rises = std::ranges::adjacent_find(offsets, std::greater_equal()) == offsets.end();
    if (!rises || offsets.size() > mostTracks || (!offsets.empty() && offsets.front() < 0))
        offsets.clear();
}

void takeLengths(XmcdRecord &record)
{
    auto &tracks = record.disc.tracks;
    const auto &offsets = record.offsets;
    for (size_t i = 0; i < tracks.size() && offsets.size() == tracks.size(); ++i) {
        const qint64 end =
            i + 1 < offsets.size() ? offsets[i + 1] : qint64(record.seconds) * framesPerSecond;
        const qint64 length = (end - offsets[i]) * millisecondsPerSecond / framesPerSecond;
        tracks[i].length = length > 0 && length <= INT_MAX ? int(length) : -1;
    }
}

// Without " / " artist and title are the same.
void takeTitle(const QString &text, DiscRecord &disc)
{
    const SplitTitle split = splitTitle(text);
    disc.artist.name = cleanText(split.isSplit ? split.artist : split.title);
    disc.title = cleanText(split.title);
}

// Old records have year and genre in the notes: " YEAR: 1978 ID3G: 17".
void takeYearAndGenre(const Lines &lines, DiscRecord &disc)
{
    static const QRegularExpression year(u"\\bYEAR:\\s{0,9}(\\d{4})\\b"_s);
    static const QRegularExpression genre(u"\\bID3G:\\s{0,9}(\\d{1,3})\\b"_s);
    disc.year = yearOf(cleanText(lines.valueOf("DYEAR")));
    if (disc.year.isEmpty())
        disc.year = yearOf(year.match(disc.notes).capturedView(1));
    disc.genre = cleanText(lines.valueOf("DGENRE"));
    const QString number = genre.match(disc.notes).captured(1);
    if (disc.genre.isEmpty() && !number.isEmpty())
        disc.genre = id3GenreName(number.toInt());
}

void takeTracks(const Lines &lines, DiscRecord &disc, std::size_t count)
{
    for (size_t i = 0; i < count; ++i) {
        TrackRecord track;
        if (i < lines.titles.size())
            track.title = cleanText(lines.valueOf(lines.titles[i]));
        if (i < lines.notes.size())
            track.notes = cleanText(lines.valueOf(lines.notes[i]));
        disc.tracks.push_back(track);
    }
    disc.trackCount = int(count);
}

void takePartOfSet(DiscRecord &disc)
{
    const PartOfSet part = partOfSet(disc.title, disc.notes);
    disc.title = part.title;
    disc.numberInSet = part.number;
    disc.totalInSet = part.total;
}

QStringList discIdsOf(const Lines &lines)
{
    QStringList ids;
    for (const QString &id : lines.valueOf("DISCID").split(u',', Qt::SkipEmptyParts)) {
        if (!cleanText(id).isEmpty())
            ids << cleanText(id);
    }
    return ids;
}

void takeDisc(const Lines &lines, XmcdRecord &record)
{
    DiscRecord &disc = record.disc;
    disc.service = u"cddb"_s;
    disc.revision = lines.revision;
    disc.discIds = discIdsOf(lines);
    disc.notes = cleanText(lines.valueOf("EXTD"));
    takeTitle(lines.valueOf("DTITLE"), disc);
    takeYearAndGenre(lines, disc);
    takePartOfSet(disc);
    takeTracks(lines, disc, std::max(lines.titles.size(), record.offsets.size()));
    findCompilation(disc);
}

bool isRecord(const Lines &lines)
{
    const auto isFilled = [](const QByteArray &value) { return !value.isEmpty(); };
    return lines.disc.contains("DTITLE") || std::ranges::any_of(lines.titles, isFilled);
}

} // namespace

XmcdRecord readXmcd(const QByteArray &bytes)
{
    Lines lines = linesOf(text::withoutByteOrderMark(bytes));
    if (!isRecord(lines) || lines.isTooLong)
        throw notUnderstood("xNotADiscRecord");
    XmcdRecord record;
    record.seconds = lines.seconds;
    record.offsets = lines.offsets;
    dropImpossible(record.offsets);
    takeDisc(lines, record);
    takeLengths(record);
    return record;
}
