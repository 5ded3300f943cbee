#pragma once

#include <QString>
#include <optional>

/// What a file of sound says of itself: its length, and the names in its tags as hints.
struct SoundFile {
    int length = 0; // milliseconds
    QString artist, album, title, genre;
    int year = 0, track = 0; // 0: not told
};

/// Whether a name is that of a file of sound whose length can be told.
bool isSoundFile(const QString &name);

/// Reads headers and tags, not the sound. Nothing where there is no such file, where it is no
/// ordinary file, or no sound. It may take long on a slow disk: for a worker.
std::optional<SoundFile> readSoundFile(const QString &name);
