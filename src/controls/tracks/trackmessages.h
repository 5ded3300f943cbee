#pragma once

#include "controls/tracks/trackstore.h"

#include <optional>

/// What a track grid says about a save: why it refuses one, and what the catalogue did not take.
class TrackMessages
{
public:
    TrackMessages(bool withArtist, int language) : mWithArtist(withArtist), mLanguage(language) {}

    struct Refusal {
        qsizetype track = 0; // in the list, from 0
        TrackField field = TitleField;
        QString text;
    };

    /// The first track that cannot be written. Those that are as the catalogue has them can.
    std::optional<Refusal> refusal(const QList<TrackToSave> &tracks) const;

    /// Empty if all was taken. Lines break at CR.
    QString kept(const QList<TrackToSave> &tracks, const TrackStore::Outcome &outcome) const;

private:
    std::optional<Refusal> refusalOf(const TrackToSave &track) const;
    QString paragraph(const char *key, const QList<TrackToSave> &tracks,
                      const QList<qsizetype> &which) const;
    QString message(const char *key) const;

    const bool mWithArtist;
    const int mLanguage;
};
