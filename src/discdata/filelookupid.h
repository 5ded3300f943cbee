#pragma once

#include "discs/discrecord.h"

#include <optional>

/// What the file identifier in a tag says of the track, written "owner=hexadecimal" as a tag gives
/// it: where its record is to be had again, or which recording it is.
struct TrackOfFileId {
    DiscRecord record; // of ours: service and keys alone
    int track = 0;     // of ours, from 1

    QString recording; // of MusicBrainz, as other programs write it
};

/// Nothing from an identifier of anybody else, and from one that makes no sense.
std::optional<TrackOfFileId> trackOfFileId(const QString &fileId);

/// Empty where there is no way back to the record, as to one that the user has typed.
QString fileIdOf(const DiscRecord &disc, int track);
