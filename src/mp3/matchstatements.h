#pragma once

#include <QString>

/// What frmMatchWithSongcase is asked for.
struct MatchQuestion {
    bool albums = false, compilations = false; // one of them at least
    QString artist, title;                     // empty: any; "%" and "_" are wild
    bool exactArtist = false, exactTitle = false;
    int numberOfTracks = -99; // of a disc; -99: any
};

/// The statements of the matching. Discs: id, naam (NULL of a compilation), titel, diskno,
/// numtracks. Tracks: artiest, titel, trackno.
QString matchingDiscs(const MatchQuestion &question);
QString tracksOfDisc(qint64 cdId, qint64 discNo);
