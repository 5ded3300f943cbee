#include "discdata/cddbobjects.h"

CddbTracks CddbDisc::Tracks() const
{
    CddbTracks tracks;
    for (const TrackRecord &track : record.tracks)
        tracks.push_back({track, mGenres->idOf(track.genre)});
    return tracks;
}
