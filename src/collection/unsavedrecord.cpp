#include "collection/unsavedrecord.h"

#include "catalogue/discnumber.h"

#include <QJsonArray>

using namespace Qt::StringLiterals;

namespace
{

constexpr int version = 1;

QJsonArray jsonOf(const QList<StoredTrack> &tracks)
{
    QJsonArray all;
    for (const StoredTrack &track : tracks) {
        QJsonArray one{QString::number(track.linkId)};
        for (const QString &text : track.texts)
            one.append(text);
        all.append(one);
    }
    return all;
}

QList<StoredTrack> tracksIn(const QJsonArray &all)
{
    QList<StoredTrack> tracks;
    for (const auto &value : all) {
        const QJsonArray one = value.toArray();
        StoredTrack track{one.at(0).toString().toLongLong(), {}};
        for (int field = 0; field < trackFields; ++field)
            track.texts[std::size_t(field)] = one.at(field + 1).toString();
        tracks.append(track);
    }
    return tracks;
}

} // namespace

QJsonObject UnsavedRecord::toJson() const
{
    QJsonObject others;
    for (auto other = otherDiscs.cbegin(); other != otherDiscs.cend(); ++other)
        others.insert(QString::number(other.key()), jsonOf(*other));
    return {{u"version"_s, version},
            {u"album"_s, isAlbum},
            {u"id"_s, QString::number(id)},
            {u"content"_s, QJsonArray::fromStringList(content)},
            {u"header"_s, QJsonArray{header.artist, header.title, header.genre, header.year}},
            {u"disc"_s, disc},
            {u"tracks"_s, jsonOf(tracks)},
            {u"others"_s, others}};
}

std::optional<UnsavedRecord> UnsavedRecord::fromJson(const QJsonObject &object)
{
    if (object.value("version"_L1).toInt() != version)
        return {};
    UnsavedRecord record;
    record.isAlbum = object.value("album"_L1).toBool();
    record.id = object.value("id"_L1).toString().toLongLong();
    const QJsonArray content = object.value("content"_L1).toArray();
    for (const auto &value : content)
        record.content.append(value.toString());
    const QJsonArray header = object.value("header"_L1).toArray();
    record.header = {header.at(0).toString(), header.at(1).toString(), header.at(2).toString(),
                     header.at(3).toString()};
    record.disc = qBound(1, object.value("disc"_L1).toInt(), highestDisc);
    record.tracks = tracksIn(object.value("tracks"_L1).toArray());
    const QJsonObject others = object.value("others"_L1).toObject();
    for (auto other = others.begin(); other != others.end(); ++other)
        record.otherDiscs[qBound(1, other.key().toInt(), highestDisc)] =
            tracksIn(other.value().toArray());
    return record;
}
