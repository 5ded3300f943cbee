#pragma once

#include <QString>
#include <array>

/// The fields of a row of a collection, in the order of the list's columns: the number is the text
/// of an item, the others are its sub-items.
enum class CollectionField {
    Volgnummer,
    FileName,
    Album,
    LeadArtist,
    Title,
    TrackPosition,
    PartOfSet,
    TrackYear,
    Genre,
    CopyrightHolder,
    Label,
    Comments,
    DoesFileExist, // "y" or "n"
    ID             // the file id of the tag
};
inline constexpr int collectionFields = 14;

/// A row as the list shows it.
struct CollectionRow {
    int index = 0; // of the item, from 1
    std::array<QString, collectionFields> texts;

    const QString &operator[](CollectionField field) const { return texts[size_t(field)]; }
    QString &operator[](CollectionField field) { return texts[size_t(field)]; }
};
