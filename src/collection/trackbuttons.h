#pragma once

#include <QObject>

class QToolBar;
class TrackGrid;

/// The buttons of an editor's toolbar that act in its track grid, by the keys that they send to the
/// control with the focus, which need not be the grid. Some need the focus in the grid.
class TrackButtons : public QObject
{
    Q_OBJECT

public:
    TrackButtons(TrackGrid *disk, QToolBar *toolbar, QObject *parent);

    bool diskHasFocus() const { return mDiskHasFocus; }
    void setDiskHasFocus(bool has);
    void focusDisk();

    void GoToFirstTrack();
    void GoToLastTrack();

private:
    void GoToNextTrack();

    TrackGrid *mDisk;
    QToolBar *mToolbar;
    bool mDiskHasFocus = false;
};
