#include "discs/musicbrainzmedium.h"

#include "discs/candidates.h"
#include "discs/genretable.h"

using namespace Qt::StringLiterals;

namespace
{

// Artists that stand for none in particular.
const QString variousArtists = u"89ad4ac3-39f7-470e-963a-56509c546377"_s;
const QString dataArtist = u"33cf029c-63b0-41a0-9855-be2a3665fb3b"_s;

QJsonArray creditOf(const QJsonObject &of)
{
    return of.value("artist-credit"_L1).toArray();
}

bool credits(const QJsonArray &credit, const QString &artistId)
{
    return std::any_of(credit.begin(), credit.end(), [&](const QJsonValue &part) {
        return part["artist"_L1]["id"_L1].toString() == artistId;
    });
}

// "Bowie, David" is a person where the answer says so or where the name is these parts turned
// round: "Beatles, The" and "Earth, Wind & Fire" are none.
ArtistName personOf(const QJsonObject &credit, const QString &printed)
{
    ArtistName artist{printed, {}, {}};
    const QJsonObject known = credit.value("artist"_L1).toObject();
    const QString type = textIn(known, u"type"_s), sortName = textIn(known, u"sort-name"_s);
    const qsizetype comma = sortName.indexOf(", "_L1);
    if (comma <= 0 || (!type.isEmpty() && type != "Person"_L1))
        return artist;
    const QString last = sortName.left(comma), first = sortName.mid(comma + 2).trimmed();
    const bool turned =
        textIn(known, u"name"_s).compare(first + u' ' + last, Qt::CaseInsensitive) == 0;
    const bool article = first.compare("The"_L1, Qt::CaseInsensitive) == 0;
    if (first.isEmpty() || article || (type.isEmpty() && !turned))
        return artist;
    artist.first = first;
    artist.last = last;
    return artist;
}

// The name with the most votes.
QString genreIn(const QJsonObject &of)
{
    QString best;
    int votes = -1;
    for (const auto &genre : of.value("genres"_L1).toArray()) {
        const QString name = cleanText(genre["name"_L1].toString());
        const int count = genre["count"_L1].toInt();
        if (!name.isEmpty() && count > votes) {
            best = name;
            votes = count;
        }
    }
    return genreAsWritten(best);
}

QString genreOf(const QJsonObject &release)
{
    const QString own = genreIn(release);
    return own.isEmpty() ? genreIn(release.value("release-group"_L1).toObject()) : own;
}

// That of the music before that of this issue.
QString yearOfRelease(const QJsonObject &release)
{
    const QJsonObject group = release.value("release-group"_L1).toObject();
    const QString music = yearOf(textIn(group, u"first-release-date"_s));
    return music.isEmpty() ? yearOf(textIn(release, u"date"_s)) : music;
}

QString labelOf(const QJsonObject &release)
{
    for (const auto &info : release.value("label-info"_L1).toArray()) {
        QString name = textIn(info["label"_L1].toObject(), u"name"_s);
        if (!name.isEmpty())
            return name;
    }
    return {};
}

// What is heard of a disc: no data, and no films where there is sound beside them.
bool isHeard(const QJsonObject &track, bool withFilms)
{
    const QJsonObject recording = track.value("recording"_L1).toObject();
    const bool isData = credits(creditOf(track), dataArtist) ||
                        credits(creditOf(recording), dataArtist) ||
                        textIn(track, u"title"_s) == "[data track]"_L1;
    return !isData && (withFilms || !recording.value("video"_L1).toBool());
}

bool hasSound(const QJsonArray &tracks)
{
    return std::any_of(tracks.begin(), tracks.end(),
                       [](const QJsonValue &track) { return isHeard(track.toObject(), false); });
}

TrackRecord trackOf(const QJsonObject &track, const DiscRecord &disc)
{
    const QJsonObject recording = track.value("recording"_L1).toObject();
    TrackRecord record;
    const QString printed = textIn(track, u"title"_s);
    record.title = printed.isEmpty() ? textIn(recording, u"title"_s) : printed;
    const QJsonArray own = creditOf(track);
    record.artist = artistOfCredit(own.isEmpty() ? creditOf(recording) : own);
    if (record.artist.name.isEmpty())
        record.artist = disc.artist;
    if (disc.isCompilation)
        record.year = yearOf(textIn(recording, u"first-release-date"_s));
    const QJsonValue length = track.value("length"_L1);
    record.length = length.toInt(recording.value("length"_L1).toInt(-1));
    return record;
}

void takeTracks(DiscRecord &disc, const QJsonArray &tracks)
{
    constexpr int mostTracks = 99;
    const bool withFilms = !hasSound(tracks);
    for (const auto &track : tracks) {
        if (isHeard(track.toObject(), withFilms) && int(disc.tracks.size()) < mostTracks)
            disc.tracks.push_back(trackOf(track.toObject(), disc));
    }
}

} // namespace

QString textIn(const QJsonObject &object, const QString &name)
{
    return cleanText(object.value(name).toString());
}

ArtistName artistOfCredit(const QJsonArray &credit)
{
    QString printed;
    for (const auto &part : credit)
        printed += part["name"_L1].toString() + part["joinphrase"_L1].toString();
    printed = cleanText(printed);
    return credit.size() == 1 ? personOf(credit.first().toObject(), printed)
                              : ArtistName{printed, {}, {}};
}

DiscRecord recordOfMedium(const QJsonObject &release, const QJsonObject &medium, int position)
{
    DiscRecord disc;
    const QJsonArray credit = creditOf(release);
    disc.title = textIn(release, u"title"_s);
    disc.artist = artistOfCredit(credit);
    disc.isCompilation = credits(credit, variousArtists);
    disc.year = yearOfRelease(release);
    disc.genre = genreOf(release);
    const qsizetype media = release.value("media"_L1).toArray().size();
    disc.numberInSet = QString::number(position);
    disc.totalInSet = QString::number(std::max<qsizetype>(media, position));
    disc.notes = textIn(medium, u"title"_s);
    disc.label = labelOf(release);
    disc.country = textIn(release, u"country"_s);
    disc.barcode = textIn(release, u"barcode"_s);
    takeTracks(disc, medium.value("tracks"_L1).toArray());
    disc.trackCount =
        disc.tracks.empty() ? medium.value("track-count"_L1).toInt() : int(disc.tracks.size());
    QString &keyA = disc.tracks.empty() ? disc.keyA : disc.fromA;
    QString &keyB = disc.tracks.empty() ? disc.keyB : disc.fromB;
    keyA = textIn(release, u"id"_s);
    keyB = disc.numberInSet;
    return disc;
}
