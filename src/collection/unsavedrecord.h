#pragma once

#include "collection/headerfields.h"
#include "controls/tracks/trackrow.h"

#include <QJsonObject>
#include <QMap>
#include <QStringList>
#include <optional>

/// What an editor holds and the catalogue does not: enough to open it again as it was.
struct UnsavedRecord {
    bool isAlbum = false;
    qint64 id = 0;       // of CDTitels; 0: not in the catalogue
    QStringList content; // what the row says, see HeldRecord
    Header header;
    int disc = 1;                             // the one that shows
    QList<StoredTrack> tracks;                // of that disc; link 0: a new one
    QMap<int, QList<StoredTrack>> otherDiscs; // that went with a record deleted meanwhile

    QJsonObject toJson() const;
    static std::optional<UnsavedRecord> fromJson(const QJsonObject &object); // nothing: not one
};
