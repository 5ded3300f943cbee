#include "discs/recordjson.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

using namespace Qt::StringLiterals;

namespace
{

constexpr int version = 1;

// Each field once, for both ways: `each` is called with the name and the member.
template <typename Artist, typename Each> void artistFields(Artist &artist, Each each)
{
    each(u"name"_s, artist.name);
    each(u"first"_s, artist.first);
    each(u"last"_s, artist.last);
}

template <typename Track, typename Each> void trackFields(Track &track, Each each)
{
    each(u"title"_s, track.title);
    each(u"artist"_s, track.artist);
    each(u"year"_s, track.year);
    each(u"genre"_s, track.genre);
    each(u"notes"_s, track.notes);
    each(u"length"_s, track.length);
}

template <typename Disc, typename Each> void discFields(Disc &disc, Each each)
{
    each(u"title"_s, disc.title);
    each(u"artist"_s, disc.artist);
    each(u"year"_s, disc.year);
    each(u"genre"_s, disc.genre);
    each(u"numberInSet"_s, disc.numberInSet);
    each(u"totalInSet"_s, disc.totalInSet);
    each(u"isCompilation"_s, disc.isCompilation);
    each(u"tracks"_s, disc.tracks);
    each(u"notes"_s, disc.notes);
    each(u"label"_s, disc.label);
    each(u"country"_s, disc.country);
    each(u"barcode"_s, disc.barcode);
    each(u"trackCount"_s, disc.trackCount);
    each(u"service"_s, disc.service);
    each(u"keyA"_s, disc.keyA);
    each(u"keyB"_s, disc.keyB);
    each(u"fromA"_s, disc.fromA);
    each(u"fromB"_s, disc.fromB);
    each(u"soughtTrack"_s, disc.soughtTrack);
    each(u"category"_s, disc.category);
    each(u"discIds"_s, disc.discIds);
    each(u"revision"_s, disc.revision);
}

struct Writer {
    QJsonObject object;

    void operator()(const QString &name, const QString &text) { object[name] = text; }
    void operator()(const QString &name, int number) { object[name] = number; }
    void operator()(const QString &name, bool flag) { object[name] = flag; }
    void operator()(const QString &name, const QStringList &texts)
    {
        object[name] = QJsonArray::fromStringList(texts);
    }
    void operator()(const QString &name, const ArtistName &artist)
    {
        Writer writer;
        artistFields(artist, [&](const QString &n, const auto &v) { writer(n, v); });
        object[name] = writer.object;
    }
    void operator()(const QString &name, const std::vector<TrackRecord> &tracks)
    {
        QJsonArray list;
        for (const TrackRecord &track : tracks) {
            Writer writer;
            trackFields(track, [&](const QString &n, const auto &v) { writer(n, v); });
            list.append(writer.object);
        }
        object[name] = list;
    }
};

// `whole` becomes false where a field is missing or of another type, a part of a number as well.
struct Reader {
    const QJsonObject object;
    bool &whole;

    QJsonValue take(const QString &name, QJsonValue::Type type) const
    {
        QJsonValue value = object.value(name);
        whole = whole && value.type() == type;
        return value;
    }
    void operator()(const QString &name, QString &text) const
    {
        text = take(name, QJsonValue::String).toString();
    }
    void operator()(const QString &name, int &number) const
    {
        const double value = take(name, QJsonValue::Double).toDouble();
        number = QJsonValue(value).toInt();
        whole = whole && number == value;
    }
    void operator()(const QString &name, bool &flag) const
    {
        flag = take(name, QJsonValue::Bool).toBool();
    }
    void operator()(const QString &name, QStringList &texts) const
    {
        texts.clear();
        for (const auto &text : take(name, QJsonValue::Array).toArray()) {
            whole = whole && text.isString();
            texts.append(text.toString());
        }
    }
    void operator()(const QString &name, ArtistName &artist) const
    {
        const Reader reader{take(name, QJsonValue::Object).toObject(), whole};
        artistFields(artist, [&](const QString &n, auto &v) { reader(n, v); });
    }
    void operator()(const QString &name, std::vector<TrackRecord> &tracks) const
    {
        for (const auto &value : take(name, QJsonValue::Array).toArray()) {
            const Reader reader{value.toObject(), whole};
            trackFields(tracks.emplace_back(), [&](const QString &n, auto &v) { reader(n, v); });
        }
    }
};

} // namespace

QByteArray toJson(const std::vector<DiscRecord> &records)
{
    QJsonArray list;
    for (const DiscRecord &disc : records) {
        Writer writer;
        discFields(disc, [&](const QString &n, const auto &v) { writer(n, v); });
        list.append(writer.object);
    }
    return QJsonDocument(QJsonObject{{u"version"_s, version}, {u"discs"_s, list}})
        .toJson(QJsonDocument::Compact);
}

std::optional<std::vector<DiscRecord>> recordsFromJson(const QByteArray &json)
{
    const QJsonObject file = QJsonDocument::fromJson(json).object();
    bool whole = file.value("version"_L1).toInt() == version && file.value("discs"_L1).isArray();
    std::vector<DiscRecord> records;
    for (const auto &value : file.value("discs"_L1).toArray()) {
        const Reader reader{value.toObject(), whole};
        discFields(records.emplace_back(), [&](const QString &n, auto &v) { reader(n, v); });
    }
    return whole ? std::optional(std::move(records)) : std::nullopt;
}
