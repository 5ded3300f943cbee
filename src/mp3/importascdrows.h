#pragma once

#include "mp3/collectionrow.h"

#include <vector>

/// What the tags of the selected rows make: an album or a compilation.
struct DiscOfRows {
    struct Track {
        QString artist, title, partOfSet, year, genre;
    };
    std::vector<Track> tracks;
    QString title, artist; // the artist of an album
    bool isAlbum = true;   // all rows in sequence have one artist
    bool isSet = true;     // all rows in sequence tell the same number of discs
};

/// A row without artist or title: nothing is imported then.
struct RowRefused {
    int row; // its number
    bool artistMissing;
};

/// Throws RowRefused, and Error (errTypeMismatch) where a number of discs is none.
DiscOfRows discOf(const std::vector<CollectionRow> &rows, const QString &collectionTitle);

/// The disc that a part of a set names. Throws Error (errTypeMismatch).
qint64 discNumber(const QString &partOfSet);
