#pragma once

#include <QByteArray>
#include <QString>
#include <utility>
#include <vector>

/// Whether an encoder says how much silence it has put around the sound, to fill whole frames.
enum class Added { NotTold, Told };

/// Silence of this length as an MP3 stream: a first frame that tells the whole length, as encoders
/// write it, and some frames behind it. True to a frame, 26 ms, or to a sample.
QByteArray silentMP3(int milliseconds, Added added = Added::NotTold);

/// A tag of version 2.3 with these text frames ("TIT2", "Title").
QByteArray id3Tag(const std::vector<std::pair<QByteArray, QString>> &frames);

/// A folder's silent MP3 files, one for each name; gives their full names.
QStringList makeSounds(const QString &folder,
                       const std::vector<std::pair<QString, int>> &namesAndMilliseconds);
