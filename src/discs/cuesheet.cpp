#include "discs/cuesheet.h"

#include "discs/candidates.h"

#include <QHash>
#include <QRegularExpression>

using namespace Qt::StringLiterals;

namespace
{

constexpr size_t mostFiles = 200;
constexpr int soundSector = 2352;   // bytes
constexpr int largestSector = 2448; // with the bytes of subchannels
constexpr qint64 betweenSessions =
    (90LL + 60 + 2) * framesPerSecond; // lead-out, lead-in, gap; in frames

// From where on a file holds sectors of a track.
struct Segment {
    qint64 position = 0; // frames from the start of the file
    int sector = soundSector;
};

struct NamedFile {
    QString name;
    LengthIn unit = LengthIn::Bytes;
    std::vector<Segment> segments;

    std::optional<qint64> frames(const LengthOfFile &lengthOf) const;
};

std::optional<qint64> NamedFile::frames(const LengthOfFile &lengthOf) const
{
    const auto length = lengthOf(name, unit);
    if (!length || unit == LengthIn::Frames || segments.empty())
        return length;
    qint64 left = *length;
    qint64 position = 0;
    int sector = segments.front().sector;
    for (const Segment &segment : segments) {
        left -= (segment.position - position) * sector;
        position = segment.position;
        sector = segment.sector;
    }
    return position + left / sector;
}

struct Track {
    int number = 0;
    int sector = soundSector;
    bool isData = false;
    qint64 before = 0, behind = 0; // frames that stand in no file
    size_t file = 0;               // of its INDEX 01
    qint64 position = -1;          // of its INDEX 01 in that file, frames
};

class CueReader
{
public:
    explicit CueReader(const LengthOfFile &lengthOf) : mLengthOf(lengthOf) {}
    void read(const QString &text);
    std::optional<DiscSheet> result();

private:
    using Command = void (CueReader::*)(const QString &rest);
    static Command commandOf(const QString &word);

    void file(const QString &rest);
    void track(const QString &rest);
    void index(const QString &rest);
    void pregap(const QString &rest);
    void postgap(const QString &rest);
    void title(const QString &rest);
    void performer(const QString &rest);
    void catalog(const QString &rest);
    void remark(const QString &rest);
    qint64 gap(const QString &rest);
    bool isComplete() const;
    bool placeFiles(std::vector<qint64> &starts);

    const LengthOfFile &mLengthOf;
    DiscSheet mSheet;
    std::vector<NamedFile> mFiles;
    std::vector<Track> mTracks;
    qint64 mBeforeNext = 0;
    bool mDamaged = false;
};

// Quoted or not; a quotation mark inside is part of the text: TITLE "Blue 12" Mix".
QString argument(const QString &rest)
{
    QString trimmed = rest.trimmed();
    if (!trimmed.startsWith(u'"'))
        return trimmed;
    const qsizetype last = trimmed.lastIndexOf(u'"');
    return last > 0 ? trimmed.mid(1, last - 1) : trimmed.mid(1);
}

// Cuts the word behind a name off; empty where there is none.
QString takeType(QString &rest)
{
    const qsizetype end = std::max(rest.lastIndexOf(u'"'), rest.lastIndexOf(u' '));
    const QString word = end < 0 ? QString() : rest.mid(end + 1);
    rest.chop(word.size());
    return word.toUpper();
}

void CueReader::file(const QString &rest)
{
    QString name = rest.trimmed();
    const QString type = takeType(name);
    name = argument(name);
    if (!mFiles.empty() && mFiles.back().name == name)
        return; // named once for each track
    const bool raw = type.isEmpty() || type == "BINARY"_L1 || type == "MOTOROLA"_L1;
    if (mFiles.size() == mostFiles)
        mDamaged = true;
    else
        mFiles.push_back({name, raw ? LengthIn::Bytes : LengthIn::Frames, {}});
}

void CueReader::track(const QString &rest)
{
    static const QRegularExpression form(u"^([0-9]{1,2})\\s+([A-Z0-9]+)(?:/([0-9]{4}))?$"_s,
                                         QRegularExpression::CaseInsensitiveOption);
    const auto match = form.match(rest.trimmed());
    Track track;
    track.number = match.captured(1).toInt();
    const QString kind = match.captured(2).toUpper();
    track.isData = kind != "AUDIO"_L1 && kind != "CDG"_L1;
    if (!match.captured(3).isEmpty())
        track.sector = match.captured(3).toInt();
    else if (kind == "CDG"_L1)
        track.sector = largestSector;
    track.before = std::exchange(mBeforeNext, 0);
    const bool follows = mTracks.empty() || track.number == mTracks.back().number + 1;
    if (!match.hasMatch() || !follows || track.sector < 1 || track.sector > largestSector)
        mDamaged = true;
    mTracks.push_back(track);
    mSheet.known.tracks.emplace_back();
}

void CueReader::index(const QString &rest)
{
    const QStringList words = rest.simplified().split(u' ');
    const auto position = discsheet::framesOf(words.last());
    if (mTracks.empty() || mFiles.empty() || words.size() != 2 || !position) {
        mDamaged = true;
        return;
    }
    std::vector<Segment> &segments = mFiles.back().segments;
    if (!segments.empty() && *position < segments.back().position)
        mDamaged = true;
    segments.push_back({*position, mTracks.back().sector});
    if (words.first().toInt() == 1) {
        mTracks.back().file = mFiles.size() - 1;
        mTracks.back().position = *position;
    }
}

qint64 CueReader::gap(const QString &rest)
{
    const auto frames = discsheet::framesOf(rest.trimmed());
    if (mTracks.empty() || !frames)
        mDamaged = true;
    return frames.value_or(0);
}

void CueReader::pregap(const QString &rest)
{
    if (const qint64 frames = gap(rest); !mTracks.empty())
        mTracks.back().before += frames;
}

void CueReader::postgap(const QString &rest)
{
    if (const qint64 frames = gap(rest); !mTracks.empty())
        mTracks.back().behind += frames;
}

void CueReader::title(const QString &rest)
{
    DiscRecord &disc = mSheet.known;
    QString &title = disc.tracks.empty() ? disc.title : disc.tracks.back().title;
    title = cleanText(argument(rest));
}

void CueReader::performer(const QString &rest)
{
    DiscRecord &disc = mSheet.known;
    ArtistName &artist = disc.tracks.empty() ? disc.artist : disc.tracks.back().artist;
    artist.name = cleanText(argument(rest));
}

void CueReader::catalog(const QString &rest)
{
    const QString number = argument(rest);
    if (number.count(u'0') < number.size())
        mSheet.known.barcode = cleanText(number);
}

void CueReader::remark(const QString &rest)
{
    const QString key = rest.trimmed().section(u' ', 0, 0).toUpper();
    const QString value = cleanText(argument(rest.trimmed().mid(key.size())));
    DiscRecord &disc = mSheet.known;
    if (key == "DATE"_L1)
        disc.year = yearOf(value);
    else if (key == "GENRE"_L1)
        disc.genre = value;
    else if (key == "DISCNUMBER"_L1 && value.toInt() > 0)
        disc.numberInSet = QString::number(value.toInt());
    else if (key == "TOTALDISCS"_L1 && value.toInt() > 0)
        disc.totalInSet = QString::number(value.toInt());
    else if (key == "SESSION"_L1 && value.toInt() > 1)
        mBeforeNext = betweenSessions;
}

CueReader::Command CueReader::commandOf(const QString &word)
{
    static const QHash<QString, Command> commands{
        {u"FILE"_s, &CueReader::file},       {u"TRACK"_s, &CueReader::track},
        {u"INDEX"_s, &CueReader::index},     {u"PREGAP"_s, &CueReader::pregap},
        {u"POSTGAP"_s, &CueReader::postgap}, {u"TITLE"_s, &CueReader::title},
        {u"REM"_s, &CueReader::remark},      {u"PERFORMER"_s, &CueReader::performer},
        {u"CATALOG"_s, &CueReader::catalog},
    };
    return commands.value(word.toUpper(), nullptr);
}

void CueReader::read(const QString &text)
{
    static const QRegularExpression lineEnd(u"[\r\n]+"_s);
    static const QRegularExpression blank(u"[\t\\x{A0}]"_s);
    for (QString line : text.split(lineEnd, Qt::SkipEmptyParts)) {
        line = line.replace(blank, u" "_s).trimmed();
        const QString word = line.section(u' ', 0, 0);
        if (const Command command = commandOf(word))
            (this->*command)(line.mid(word.size()));
    }
}

// Where each file begins on the disc, and behind them where the last one ends. False: not all
// could be measured.
bool CueReader::placeFiles(std::vector<qint64> &starts)
{
    qint64 start = firstFrame;
    for (const NamedFile &file : mFiles) {
        starts.push_back(start);
        const auto frames = file.frames(mLengthOf);
        if (!frames) {
            mSheet.missing = file.name;
            return false;
        }
        start += *frames;
    }
    starts.push_back(start);
    return true;
}

bool CueReader::isComplete() const
{
    return !mDamaged && !mTracks.empty() &&
           std::ranges::all_of(mTracks, [](const Track &track) { return track.position >= 0; });
}

std::optional<DiscSheet> CueReader::result()
{
    if (!isComplete())
        return {};
    mSheet.toc.first = mTracks.front().number;
    std::vector<qint64> starts;
    qint64 between = 0;
    if (placeFiles(starts)) {
        for (const Track &track : mTracks) {
            between += track.before;
            const qint64 offset = starts[track.file] + track.position + between;
            mSheet.toc.tracks.push_back({int(std::min<qint64>(offset, INT_MAX)), track.isData});
            between += track.behind;
        }
        mSheet.toc.leadOut = int(std::min<qint64>(starts.back() + between, INT_MAX));
    }
    return discsheet::complete(mSheet) ? std::optional(mSheet) : std::nullopt;
}

} // namespace

std::optional<DiscSheet> readCueSheet(QByteArrayView bytes, const LengthOfFile &lengthOf)
{
    CueReader reader(lengthOf);
    reader.read(discsheet::decoded(bytes));
    return reader.result();
}
