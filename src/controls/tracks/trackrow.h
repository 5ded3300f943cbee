#pragma once

#include <QList>
#include <QString>
#include <array>

/// What a track says, in the order in which the grids show it. An album's grid leaves the artist
/// out.
enum TrackField { ArtistField, TitleField, GenreField, YearField, trackFields };
using TrackTexts = std::array<QString, trackFields>;

/// A row of the catalogue that holds a track of a disc.
struct StoredTrack {
    qint64 linkId = 0; // of its row in CompactDiscs
    TrackTexts texts;  // NULL as the empty text
};

/// A track of the grid on its way to the catalogue, in the place that it is to have there.
struct TrackToSave {
    qint64 linkId = 0;    // 0: a new one
    bool changed = false; // since it was loaded or saved
    TrackTexts texts;
    TrackTexts was; // as loaded or saved
};
