#pragma once

#include "catalogue/songs.h"
#include "platform/ado/rows.h"
#include "platform/desktop/desktop.h"

#include <functional>

/// Writes gImportRecords to the catalogue, track by track in one transaction: artists and tracks
/// are found or made, each CD gets its title and its links. A CD whose title is there already is
/// asked about.
class CatalogueLoad
{
public:
    enum class Outcome { Committed, Cancelled };

    /// Told before each track which one of how many it is, counted from 1; false takes everything
    /// back.
    std::function<bool(qint64 number, qint64 count)> step = [](qint64, qint64) { return true; };

    /// Asked for a CD that is there already: Yes imports it once more, No leaves it out, Cancel
    /// takes everything back.
    std::function<BoxAnswer(const QString &question)> ask;

    /// Throws Error. The transaction is then left open for the caller's handler to roll
    /// back, after it has shown what the connection says.
    Outcome run();

    /// The number of tracks that were put on a CD.
    qsizetype importedCount() const { return mImportedCount; }

private:
    struct Track;
    void takeIds(const ADODB::Rows &rows);
    bool load(const Track &track); // false: cancelled
    bool beginCd(const Track &track, qint64 artist);
    BoxAnswer answerFor(const Track &track, qint64 artist);
    qint64 findOrMakeTrack(const Track &track, qint64 artist);

    std::optional<Songs> mSongs; // of the transaction
    qint64 mTitleShift = 0, mLinkShift = 0;
    qsizetype mImportedCount = 0;
    qint64 mLastCdIndex = 0;
    BoxAnswer mCdAnswer = vbYes; // holds for the CD in work
};
