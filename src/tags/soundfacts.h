#pragma once

#include <QString>
#include <optional>

/// What a person asks of an MP3 file beside its tag.
struct SoundFacts {
    int length = 0;     // milliseconds
    int bitRate = 0;    // kbit/s; the mean of a variable one
    QString tagVersion; // "ID3v2.3"; empty without such a tag
};

/// Nothing where there is no such file, or no sound in it.
std::optional<SoundFacts> soundFacts(const QString &path);
