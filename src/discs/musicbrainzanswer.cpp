#include "discs/musicbrainzanswer.h"

#include "discs/candidates.h"
#include "discs/discid.h"
#include "discs/musicbrainzmedium.h"
#include "discs/notunderstood.h"

#include <QJsonDocument>
#include <algorithm>
#include <limits>

using namespace Qt::StringLiterals;

namespace
{

constexpr int farOff = 10'000; // milliseconds: a track of another disc
constexpr int unknown = std::numeric_limits<int>::max();

QJsonObject objectIn(const QByteArray &json)
{
    const QJsonDocument document = QJsonDocument::fromJson(json);
    if (!document.isObject())
        throw notUnderstood("xNotAMusicBrainzAnswer");
    return document.object();
}

QJsonArray listIn(const QJsonObject &answer, const QString &name)
{
    const QJsonValue list = answer.value(name);
    if (!list.isArray())
        throw notUnderstood("xNotAMusicBrainzAnswer", textIn(answer, u"error"_s));
    return list.toArray();
}

struct Medium {
    QJsonObject of; // the release
    QJsonObject medium;
    int position = 0; // from 1
};

std::vector<Medium> mediaOf(const QJsonObject &release)
{
    std::vector<Medium> media;
    for (const auto &value : release.value("media"_L1).toArray()) {
        const QJsonObject medium = value.toObject();
        const int place = int(media.size()) + 1;
        media.push_back({release, medium, std::max(medium.value("position"_L1).toInt(place), 1)});
    }
    return media;
}

DiscRecord recordOf(const Medium &medium)
{
    return recordOfMedium(medium.of, medium.medium, medium.position);
}

bool hasDiscId(const Medium &medium, const QString &id)
{
    const QJsonArray discs = medium.medium.value("discs"_L1).toArray();
    return std::any_of(discs.begin(), discs.end(),
                       [&](const QJsonValue &disc) { return disc["id"_L1].toString() == id; });
}

// By how many milliseconds the track furthest off differs from that of the disc; `unknown` where
// the numbers of tracks differ.
int worstLength(const QJsonArray &tracks, const std::vector<int> &lengths)
{
    if (tracks.size() != qsizetype(lengths.size()))
        return unknown;
    int worst = 0;
    for (size_t i = 0; i < lengths.size(); ++i) {
        const QJsonObject track = tracks.at(qsizetype(i)).toObject();
        const int recorded = track.value("recording"_L1).toObject().value("length"_L1).toInt(-1);
        const int length = track.value("length"_L1).toInt(recorded);
        if (length >= 0) // many a track has none
            worst = std::max(worst, std::abs(length - lengths[i]));
    }
    return worst;
}

// The same by the tables of contents that the answer knows of the medium.
int worstOfTables(const QJsonArray &discs, const std::vector<int> &lengths)
{
    int best = unknown;
    for (const auto &disc : discs) {
        TableOfContents toc;
        for (const auto &offset : disc["offsets"_L1].toArray())
            toc.tracks.push_back({offset.toInt()});
        toc.leadOut = disc["sectors"_L1].toInt();
        if (!toc.isValid() || toc.tracks.size() != lengths.size())
            continue;
        const std::vector<int> theirs = toc.lengths();
        int worst = 0;
        for (size_t i = 0; i < lengths.size(); ++i)
            worst = std::max(worst, std::abs(theirs[i] - lengths[i]));
        best = std::min(best, worst);
    }
    return best;
}

int distance(const Medium &medium, const std::vector<int> &lengths)
{
    const QJsonArray tracks = medium.medium.value("tracks"_L1).toArray();
    const int byTracks = tracks.isEmpty() ? unknown : worstLength(tracks, lengths);
    return std::min(byTracks, worstOfTables(medium.medium.value("discs"_L1).toArray(), lengths));
}

bool fits(const Medium &medium, size_t tracks)
{
    return medium.medium.value("track-count"_L1).toInt() == int(tracks);
}

QJsonArray releasesOf(const QByteArrayList &pages)
{
    QJsonArray all;
    for (const QByteArray &page : pages) {
        for (const auto &release : listIn(objectIn(page), u"releases"_s))
            all.append(release);
    }
    return all;
}

// The medium in the drive; the one with as many tracks where none has the id.
void addMediumOfId(std::vector<DiscRecord> &records, const QJsonObject &release, const QString &id,
                   size_t tracks)
{
    const auto media = mediaOf(release);
    auto own = std::ranges::find_if(media, [&](const Medium &m) { return hasDiscId(m, id); });
    if (own == media.end())
        own = std::ranges::find_if(media, [&](const Medium &m) { return fits(m, tracks); });
    if (own != media.end())
        records.push_back(recordOf(*own));
}

std::vector<DiscRecord> nearest(const QJsonArray &releases, const std::vector<int> &lengths)
{
    std::vector<std::pair<int, DiscRecord>> found;
    for (const auto &release : releases) {
        for (const Medium &medium : mediaOf(release.toObject())) {
            const int off = distance(medium, lengths);
            if (off <= farOff)
                found.emplace_back(off, recordOf(medium));
        }
    }
    std::ranges::stable_sort(found, {}, [](const auto &pair) { return pair.first; });
    std::vector<DiscRecord> records;
    records.reserve(found.size());
    for (auto &pair : found)
        records.push_back(std::move(pair.second));
    return records;
}

// One track alone is listed, that of the recording. The credit is left out where it is the same.
void addMediaWith(std::vector<DiscRecord> &records, QJsonObject release,
                  const QJsonObject &recording)
{
    if (!release.contains("artist-credit"_L1))
        release["artist-credit"_L1] = recording.value("artist-credit"_L1);
    for (Medium medium : mediaOf(release)) {
        const int offset = medium.medium.value("track-offset"_L1).toInt(-1);
        medium.medium.remove("tracks"_L1);
        records.push_back(recordOf(medium));
        constexpr int mostTracks = 99;
        if (offset >= 0 && offset < mostTracks)
            records.back().soughtTrack = offset + 1;
    }
}

// A disc that somebody has typed in and nobody has looked at: texts alone.
DiscRecord recordOfStub(const QJsonObject &stub)
{
    DiscRecord disc;
    disc.title = textIn(stub, u"title"_s);
    disc.artist.name = textIn(stub, u"artist"_s);
    disc.barcode = textIn(stub, u"barcode"_s);
    disc.isCompilation = isVariousArtists(disc.artist.name);
    for (const auto &value : stub.value("tracks"_L1).toArray()) {
        const QJsonObject track = value.toObject();
        TrackRecord record;
        record.title = textIn(track, u"title"_s);
        record.artist.name = textIn(track, u"artist"_s);
        if (record.artist.name.isEmpty() && !disc.isCompilation)
            record.artist = disc.artist;
        record.length = track.value("length"_L1).toInt(-1);
        disc.tracks.push_back(record);
    }
    disc.trackCount = int(disc.tracks.size());
    return disc;
}

} // namespace

std::vector<DiscRecord> musicBrainzDiscs(const QByteArrayList &pages, const TableOfContents &toc)
{
    const QJsonObject answer = objectIn(pages.value(0));
    const bool isStub = !answer.contains("releases"_L1) && answer.value("tracks"_L1).isArray();
    if (isStub)
        return {recordOfStub(answer)};
    const QJsonArray releases = releasesOf(pages);
    const TableOfContents counted = withoutDataBehind(toc);
    if (!answer.contains("id"_L1))
        return nearest(releases, counted.lengths());
    std::vector<DiscRecord> records;
    for (const auto &release : releases)
        addMediumOfId(records, release.toObject(), answer.value("id"_L1).toString(),
                      counted.tracks.size());
    return records;
}

MusicBrainzPage musicBrainzPage(const QByteArray &json)
{
    const QJsonObject answer = QJsonDocument::fromJson(json).object();
    const QJsonArray releases = answer.value("releases"_L1).toArray();
    return {int(releases.size()), answer.value("release-count"_L1).toInt(-1),
            releases.first()["id"_L1].toString()};
}

DiscRecord musicBrainzRelease(const QByteArray &json, int medium)
{
    const QJsonObject release = objectIn(json);
    for (const Medium &each : mediaOf(release)) {
        if (each.position == medium)
            return recordOf(each);
    }
    throw notUnderstood("xNotAMusicBrainzAnswer", textIn(release, u"error"_s));
}

std::vector<DiscRecord> musicBrainzSearch(const QByteArray &json)
{
    std::vector<DiscRecord> records;
    for (const auto &value : listIn(objectIn(json), u"releases"_s)) {
        for (const Medium &medium : mediaOf(value.toObject()))
            records.push_back(recordOf(medium));
    }
    return records;
}

std::vector<DiscRecord> musicBrainzRecordings(const QByteArray &json)
{
    const QJsonObject answer = objectIn(json);
    const bool isOne = !answer.contains("recordings"_L1);
    const QJsonArray recordings = isOne ? QJsonArray{answer} : listIn(answer, u"recordings"_s);
    std::vector<DiscRecord> records;
    for (const auto &recording : recordings) {
        for (const auto &release : listIn(recording.toObject(), u"releases"_s))
            addMediaWith(records, release.toObject(), recording.toObject());
    }
    return records;
}

QString musicBrainzError(const QByteArray &json)
{
    return textIn(QJsonDocument::fromJson(json).object(), u"error"_s);
}

QString musicBrainzQuery(const SearchWords &words)
{
    const auto phrase = [](const QString &field, const QString &text) {
        QString inside = cleanText(text);
        inside.replace(u'\\', "\\\\"_L1).replace(u'"', "\\\""_L1);
        return inside.isEmpty() ? QString() : field + u":\""_s + inside + u'"';
    };
    QStringList parts{phrase(u"barcode"_s, words.barcode), phrase(u"recording"_s, words.track),
                      phrase(u"artist"_s, words.artist), phrase(u"release"_s, words.title)};
    parts.removeAll(QString());
    return parts.join(" AND "_L1);
}
