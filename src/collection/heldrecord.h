#pragma once

#include "controls/tracks/trackstore.h"

#include <QMap>

/// The row of CDTitels that an editor holds on to. An id alone says little: that of a row which has
/// gone is given again. So each write first compares what the row says with what was last read or
/// written here, in its transaction; and who deletes a record tells its editor, which keeps what it
/// does not show. All functions on gConnection throw Error.
class HeldRecord
{
public:
    enum class State {
        New,    // not in the catalogue yet
        Stored, // there, as far as is known
        Swept,  // saved without tracks, so it went again: the next save makes a new row
        Lost    // deleted by somebody else, or another record has its id
    };
    State state() const { return mState; }
    bool isStored() const { return mState == State::Stored; }

    void begin() { *this = {}; }

    /// The row says now what it shall be known by: it was read or written just now. The state is
    /// Stored, or Swept if there is no such row.
    void know(qint64 id);

    /// Whether the row still says so. To be asked in the transaction of a write.
    bool isThere(qint64 id) const;

    void setLost() { mState = State::Lost; }

    /// Before it is deleted: its discs are kept, to be saved anew.
    void keepDiscs(qint64 id, TrackStore::Artists artists);

    QStringList content() const { return mContent; }
    const QMap<int, QList<StoredTrack>> &keptDiscs() const { return mDiscs; }

    /// A record that was held in an earlier run, to be entered anew.
    void beginAnew(const QMap<int, QList<StoredTrack>> &discs);

    /// Writes the kept discs but the one that an editor shows, as those of a new row.
    void writeKeptDiscs(qint64 id, int shown, TrackStore::Artists artists) const;

private:
    QStringList mContent;
    QMap<int, QList<StoredTrack>> mDiscs;
    State mState = State::New;
};
