#include "discs/opaquetoc.h"

#include "discs/recordjson.h"

#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>

using namespace Qt::StringLiterals;

namespace
{

QJsonObject fromTable(const TableOfContents &toc)
{
    QJsonArray offsets, data;
    for (const TocTrack &track : toc.tracks) {
        offsets.append(track.offset);
        data.append(track.isData);
    }
    return {{u"first"_s, toc.first},
            {u"leadOut"_s, toc.leadOut},
            {u"offsets"_s, offsets},
            {u"data"_s, data}};
}

TableOfContents toTable(const QJsonObject &object)
{
    TableOfContents toc;
    toc.first = object[u"first"_s].toInt(1);
    toc.leadOut = object[u"leadOut"_s].toInt();
    const QJsonArray offsets = object[u"offsets"_s].toArray(), data = object[u"data"_s].toArray();
    for (qsizetype i = 0; i < offsets.size(); ++i)
        toc.tracks.push_back({offsets[i].toInt(), data.at(i).toBool()});
    return toc;
}

} // namespace

QString OpaqueToc::toText() const
{
    QJsonObject object;
    if (!toc.tracks.empty())
        object[u"toc"_s] = fromTable(toc);
    if (known != DiscRecord())
        object[u"known"_s] = QString::fromUtf8(toJson({known}));
    if (!words.isEmpty())
        object[u"words"_s] = QJsonArray{words.artist, words.title, words.barcode};
    return QString::fromUtf8(QJsonDocument(object).toJson(QJsonDocument::Compact));
}

std::optional<OpaqueToc> OpaqueToc::fromText(const QString &text)
{
    const QJsonObject object = QJsonDocument::fromJson(text.toUtf8()).object();
    OpaqueToc made;
    if (object.contains(u"toc"_s))
        made.toc = toTable(object[u"toc"_s].toObject());
    if (object.contains(u"known"_s)) {
        const auto records = recordsFromJson(object[u"known"_s].toString().toUtf8());
        if (!records || records->size() != 1)
            return {};
        made.known = records->front();
    }
    const QJsonArray words = object[u"words"_s].toArray();
    made.words = {words.at(0).toString(), words.at(1).toString(), words.at(2).toString()};
    const bool hasTable = object.contains(u"toc"_s);
    if (hasTable ? !made.toc.isValid() : made.words.isEmpty())
        return {};
    return made;
}
