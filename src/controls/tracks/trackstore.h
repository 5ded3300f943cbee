#pragma once

#include "catalogue/songs.h"
#include "controls/tracks/trackrow.h"

#include <QHash>
#include <QSet>

/// The tracks of one disc in the catalogue: how they are read, written and removed. A Tracks row is
/// shared by all discs that hold the song, so a track that is changed is looked for anew, and the
/// row found is written to only if no other disc holds it. All functions throw Error.
class TrackStore
{
public:
    /// Tracks have artists of their own, or all of them that of the title.
    enum class Artists { OfTracks, OfTitle };

    TrackStore(ADODB::Connection &connection, qint64 cdId, int discNo, Artists artists)
        : mConnection(connection), mCdId(cdId), mDiscNo(discNo), mArtists(artists)
    {
    }

    QList<StoredTrack> load() const;

    struct Outcome {
        bool refused = false;  // the title is gone, or has no artist: nothing was written
        QList<qint64> linkIds; // of the tracks

        // The tracks, by their place in the list, whose genre, year or spelling the catalogue kept
        // as it was, and those whose artist it spells otherwise.
        QList<qsizetype> keptValues, keptArtists;
    };

    /// Makes these the tracks of the disc, numbered from 1. Links of `was` that are not among them
    /// go; those of tracks that are as they were stay as they are, but for their number. The caller
    /// has begun the transaction, and has seen to it that each track that changed has artist (if
    /// they have their own) and title.
    Outcome save(const QList<TrackToSave> &tracks, const QList<qint64> &was);

    /// Deletes the disc and closes the gap in the numbers of those behind it, in one transaction.
    void remove();

private:
    struct Link {
        qint64 trackNo = 0, trackId = 0;
    };
    using Links = QHash<qint64, Link>; // by their ids

    ADODB::Recordset run(std::string_view statement,
                         std::initializer_list<ADODB::Parameter> values) const;
    Links readLinks() const;
    bool readTitle();
    void deleteLinks(const QList<TrackToSave> &tracks, const QList<qint64> &was,
                     const Links &links);
    qint64 write(const TrackToSave &track, qsizetype place, const Links &links, Outcome &outcome);
    qint64 artistOf(const TrackTexts &texts, bool &otherSpelling);
    qint64 trackOf(qint64 artistId, const TrackToSave &track, bool &keptValues);
    qint64 addTrack(qint64 artistId, const TrackTexts &texts);
    TrackTexts readTrack(qint64 id) const;
    bool heldElsewhere(qint64 trackId) const;

    ADODB::Connection &mConnection;
    const qint64 mCdId;
    const int mDiscNo;
    const Artists mArtists;
    qint64 mTitleArtist = 0;
    std::optional<Songs> mSongs; // of a save
    QSet<qint64> mSettled;       // rows of Tracks about which a track of this save has had its say
};
