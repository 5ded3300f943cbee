#pragma once

#include <QString>

/// A track on a disc as a row of a search result shows it; empty texts stand for NULL too.
struct FoundTrack {
    QString artist, title, disc, track, cdTitle, type;
};

/// The record that holds such a track.
struct FoundRecord {
    qint64 id = 0; // CDTitels.ID; 0: there is none any more
    bool isCompilation = false;
    int row = 0; // of the track on its disc, from 1
};

/// Looks the record up by what the row shows; of several equal ones the first. Throws Error.
FoundRecord findRecord(const FoundTrack &track);
