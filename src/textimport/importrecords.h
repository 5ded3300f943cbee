#pragma once

#include "platform/ado/recordset.h"

#include <QString>

/// The columns of gImportRecords, in their order.
namespace importfield
{
enum Column {
    ListIndex, // id of the CompactDiscs row to come
    Artist,
    TrackTitle,
    Genre,   // may be empty
    Hitjaar, // may be empty, else four characters
    MainTitle,
    MainTitleIndex, // id of the CDTitels row to come
    DiskIndex,      // from 1
    TrackIndex,     // from 1
};
} // namespace importfield

/// A recordset with these columns, open, without a row.
ADODB::RecordsetPtr newImportRecords();

/// A text of the file as the catalogue gets it: its first 255 characters, each double quote as two
/// single ones, in proper case.
QString treatedField(QStringView field);

/// Writes the tracks of a file, one after the other, behind the last row of gImportRecords, and
/// counts the ids of the rows that the load will make of them. What holds for all tracks of a CD is
/// set once. All texts come as they stand in the file.
class TrackRows
{
public:
    /// nextDiscRowId: id of the first track's CompactDiscs row; cdRunningId: of the first title.
    TrackRows(ADODB::Recordset &records, qint64 nextDiscRowId, qint64 cdRunningId);

    void setMainTitle(QStringView title) { mMainTitle = treatedField(title); }
    void setArtist(QStringView artist) { mArtist = treatedField(artist); }
    void nextCd() { setCdRunningId(mCdRunningId + 1); }
    void add(QStringView title, QStringView genre, QStringView year, int disc, int track);

private:
    void setCdRunningId(qint64 id);

    ADODB::Recordset &mRecords;
    qint64 mNextDiscRowId;
    qint64 mCdRunningId = 0;
    QString mArtist, mMainTitle, mMainTitleIndex;
};
