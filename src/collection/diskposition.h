#pragma once

#include <QPoint>
#include <QString>
#include <optional>

class TrackGrid;

/// Where the cursor of a grid stood before a routine of its screen ran, to be put back once.
class DiskPosition
{
public:
    void setDisk(TrackGrid *disk) { mDisk = disk; }
    void remember();
    void forget() { mWaiting.reset(); }

    /// Nothing if nothing is remembered.
    void restore();

    /// " ( column - row)" as last remembered, for messages.
    QString text() const;

private:
    TrackGrid *mDisk = nullptr;
    QPoint mLast;                   // column, row
    std::optional<QPoint> mWaiting; // to be put back
};
