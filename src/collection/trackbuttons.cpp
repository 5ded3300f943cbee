#include "collection/trackbuttons.h"

#include "controls/tracks/trackgrid.h"
#include "platform/desktop/desktop.h"

#include <QAction>
#include <QToolBar>

using namespace Qt::StringLiterals;

namespace
{

// Counted from 0.
enum Button {
    InsertTrack = 3,
    DeleteTrack,
    FirstTrack,
    LastTrack,
    NextField,
    PreviousField,
    NextTrack,
    PreviousTrack
};

void send(const char *keys)
{
    Desktop::current().sendKeys(QLatin1String(keys));
}

} // namespace

TrackButtons::TrackButtons(TrackGrid *disk, QToolBar *toolbar, QObject *parent)
    : QObject(parent), mDisk(disk), mToolbar(toolbar)
{
    connect(disk, &TrackGrid::GotFocus, this, [this] { setDiskHasFocus(true); });
    connect(disk, &TrackGrid::LostFocus, this, [this] { setDiskHasFocus(false); });
    const auto on = [&](Button button, auto routine) {
        connect(toolbar->actions().at(button), &QAction::triggered, this, routine);
    };
    on(InsertTrack, [] { send("Ins"); });
    on(DeleteTrack, [] { send("End"); });
    on(FirstTrack, [this] { GoToFirstTrack(); });
    on(LastTrack, [this] { GoToLastTrack(); });
    on(NextField, [] { send("Tab"); });
    on(PreviousField, [] { send("Shift+Tab"); });
    on(NextTrack, [this] { GoToNextTrack(); });
    on(PreviousTrack, [] { send("Up"); });
}

void TrackButtons::setDiskHasFocus(bool has)
{
    mDiskHasFocus = has;
    for (const Button button : {InsertTrack, DeleteTrack, PreviousTrack})
        mToolbar->actions().at(button)->setEnabled(has);
}

// A reason that does not stop at an empty year.
void TrackButtons::focusDisk()
{
    mDisk->setFocus(Qt::ShortcutFocusReason);
}

void TrackButtons::GoToFirstTrack()
{
    if (!mDiskHasFocus)
        focusDisk();
    send("PgUp");
}

void TrackButtons::GoToLastTrack()
{
    if (!mDiskHasFocus)
        focusDisk();
    send("PgDown");
}

// By design: without the focus in the grid this only moves it there.
void TrackButtons::GoToNextTrack()
{
    if (mDiskHasFocus)
        send("Down");
    else
        focusDisk();
}
