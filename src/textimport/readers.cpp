#include "textimport/readers.h"

#include "catalogue/discnumber.h"
#include "platform/error/error.h"
#include "platform/text/textrules.h"
#include "services/messages.h"

#include <algorithm>
#include <cmath>
#include <limits>

using namespace Qt::StringLiterals;

QString ImportLines::next(FilePart part)
{
    QString line = ReadTextLine(mFile);
    ++mNumber;
    if (mTold)
        mTold(mNumber, part);
    return line;
}

void ImportLines::refuse(const char *key) const
{
    refuseWith(GetMessage(key));
}

namespace
{

constexpr qsizetype yearLength = 4;

void requireTitle(const ImportLines &lines, QStringView title)
{
    if (title.isEmpty())
        lines.refuse("EmptyLineFoundTitle");
}

void requireArtist(const ImportLines &lines, QStringView artist)
{
    if (artist.isEmpty())
        lines.refuse("EmptyLineFoundArtist");
}

// Four plain digits compare as text as they do by value.
bool reachesFirstYear(QStringView year)
{
    const bool plain =
        std::all_of(year.begin(), year.end(), [](QChar c) { return c >= u'0' && c <= u'9'; });
    return plain ? year >= QStringView(u"1901") : year.toDouble() >= 1901;
}

// Any number of four characters will do, "2e03" as well: it is judged by its value.
void requireYear(const ImportLines &lines, QStringView year)
{
    if (year.isEmpty())
        return;
    const bool numeric = year.size() == yearLength && text::isNumeric(year);
    if (!numeric || !reachesFirstYear(year))
        lines.refuse("InvalidYearFound");
}

// ---- One field per row

QString titleLine(ImportLines &lines, FilePart part)
{
    QString title = lines.next(part);
    requireTitle(lines, title);
    return title;
}

QString artistLine(ImportLines &lines, FilePart part)
{
    QString artist = lines.next(part);
    requireArtist(lines, artist);
    return artist;
}

// "*" says that there is no value, as the empty line does.
QString lineOrStar(ImportLines &lines)
{
    const QString line = lines.next(FilePart::Tracks);
    return line == u"*" ? QString() : line;
}

constexpr int mostTracks = std::numeric_limits<int>::max();

int countLine(ImportLines &lines, int most)
{
    const QString line = lines.next(FilePart::Head);
    if (!text::isNumeric(line))
        lines.refuse("NumberNotFound");
    const double count = std::nearbyint(line.trimmed().toDouble()); // a half to the even number
    if (count > most)
        lines.refuse("xNumberTooLarge");
    return int(std::max(count, 0.0));
}

void readCountedTrack(ImportLines &lines, TrackRows &rows, int disc, int track)
{
    const QString title = titleLine(lines, FilePart::Tracks);
    const QString genre = lineOrStar(lines);
    const QString year = lineOrStar(lines);
    requireYear(lines, year);
    rows.add(title, genre, year, disc, track);
}

// By design: the first disc is read whatever the count of discs says, 0 as well; only a disc of no
// tracks is passed over.
template <typename ReadTrack> void readDiscs(ImportLines &lines, ReadTrack readTrack)
{
    const int discs = countLine(lines, highestDisc);
    int disc = 1;
    do {
        const int tracks = countLine(lines, mostTracks);
        for (int track = 1; track <= tracks; ++track)
            readTrack(disc, track);
    } while (disc++ < discs);
}

// ---- One track per row

/// Where a file of track rows stands: the CD changes with the first track behind another title, and
/// with nothing else.
class MarkedPlace
{
public:
    QString main; // title of the CD, as in the file
    int disc = 1, track = 1;

    void endDisc()
    {
        disc = std::min(disc + 1, highestDisc + 1);
        track = 0;
    }

    void beginTrack(const ImportLines &lines, TrackRows &rows)
    {
        if (main == mPrevious) {
            if (disc > highestDisc)
                lines.refuse("xNumberTooLarge");
            ++track;
            return;
        }
        mPrevious = main;
        rows.setMainTitle(main);
        rows.nextCd();
        disc = track = 1;
    }

private:
    QString mPrevious;
};

// The text before the first star; the rest is left.
QStringView beforeStar(QStringView &rest)
{
    const auto star = rest.indexOf(u'*');
    if (star < 0)
        throw makeError(errTypeMismatch, rest.toString());
    const QStringView field = rest.first(star);
    rest = rest.sliced(star + 1);
    return field;
}

template <typename ReadTrack, typename ReadHead>
void readMarked(ImportLines &lines, MarkedPlace &place, ReadTrack readTrack, ReadHead readHead)
{
    while (!lines.atEnd()) {
        const QString line = lines.next(FilePart::Tracks);
        if (line.isEmpty() || line == u"*")
            place.endDisc();
        else if (line.contains(u'*'))
            readTrack(line);
        else
            readHead(line);
    }
}

} // namespace

void ReadCompilationNested(ImportLines &lines, TrackRows &rows)
{
    while (!lines.atEnd()) {
        rows.setMainTitle(titleLine(lines, FilePart::Head));
        readDiscs(lines, [&](int disc, int track) {
            rows.setArtist(artistLine(lines, FilePart::Tracks));
            readCountedTrack(lines, rows, disc, track);
        });
        rows.nextCd();
    }
}

void ReadAlbumNested(ImportLines &lines, TrackRows &rows)
{
    while (!lines.atEnd()) {
        rows.setArtist(artistLine(lines, FilePart::Head));
        rows.setMainTitle(titleLine(lines, FilePart::Head));
        readDiscs(lines, [&](int disc, int track) { readCountedTrack(lines, rows, disc, track); });
        rows.nextCd();
    }
}

void ReadCompilationFlat(ImportLines &lines, TrackRows &rows)
{
    MarkedPlace place;
    const auto readTrack = [&](QStringView rest) {
        const QStringView artist = beforeStar(rest);
        const QStringView title = beforeStar(rest);
        const QStringView genre = beforeStar(rest);
        requireArtist(lines, artist);
        requireTitle(lines, place.main);
        requireTitle(lines, title);
        requireYear(lines, rest);
        place.beginTrack(lines, rows);
        rows.setArtist(artist);
        rows.add(title, genre, rest, place.disc, place.track);
    };
    readMarked(lines, place, readTrack, [&](const QString &line) { place.main = line; });
}

void ReadAlbumFlat(ImportLines &lines, TrackRows &rows)
{
    MarkedPlace place;
    QString artist;
    const auto readTrack = [&](QStringView rest) {
        const QStringView title = beforeStar(rest);
        const QStringView genre = beforeStar(rest);
        requireArtist(lines, artist);
        requireTitle(lines, place.main);
        requireTitle(lines, title);
        requireYear(lines, rest);
        place.beginTrack(lines, rows);
        rows.add(title, genre, rest, place.disc, place.track);
    };
    const auto readHead = [&](const QString &line) {
        artist = line;
        rows.setArtist(artist);
        place.main = lines.next(FilePart::Tracks);
        // By design: Dutch in both languages.
        if (place.main.contains(u'*'))
            lines.refuseWith(u"Hoofdtitel mag het teken * niet bevatten!"_s);
    };
    readMarked(lines, place, readTrack, readHead);
}
