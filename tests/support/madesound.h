#pragma once

#include <QByteArray>
#include <QString>
#include <utility>
#include <vector>

/// Silence of this length as an MP3 stream: a first frame that tells the whole length, as encoders
/// write it, and some frames behind it. True to a frame, 26 ms.
QByteArray silentMP3(int milliseconds);

/// A tag of version 2.3 with these text frames ("TIT2", "Title").
QByteArray id3Tag(const std::vector<std::pair<QByteArray, QString>> &frames);

/// A tag that holds one file identifier, and its frame alone.
QByteArray fileIdTag(const QByteArray &owner, const QByteArray &id);

/// A folder's silent MP3 files, one for each name; gives their full names.
QStringList makeSounds(const QString &folder,
                       const std::vector<std::pair<QString, int>> &namesAndMilliseconds);
