#pragma once

#include <QString>

/// What the name of a file of sound and that of its folder say: all that people and rippers put
/// into them. Empty, or 0, where nothing is said; without any sign of an artist the whole name is
/// the title.
struct FileNameParts {
    QString artist, title;
    int track = 0;
    QString albumArtist, album; // of the folder
    QString year;               // four digits
    bool operator==(const FileNameParts &) const = default;
};

/// "03 - Artist - Title.mp3", "03-Artist-Title", "Artist-Title", "03. Title", "1-03 Title" (of disc
/// 1), each also with underscores for blanks; folders "Artist - Album (1985)", "1985 - Album",
/// "Album", and "CD 2" below one of these.
FileNameParts filenameParts(const QString &path);
