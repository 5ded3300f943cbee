#include "platform/desktop/drawingfreeze.h"

#include "platform/desktop/nestedloop.h"

#include <QPointer>
#include <QTimer>
#include <QWidget>

namespace drawingfreeze
{

namespace
{

QPointer<QWidget> gFrozen;
bool gWatching = false;

void release()
{
    if (gFrozen)
        gFrozen->setUpdatesEnabled(true);
    gFrozen.clear();
}

constexpr int again = 20; // milliseconds; a modal screen may be open for long

void watch(int delay);

void lookAgain()
{
    gWatching = false;
    if (!gFrozen)
        return;
    if (NestedLoop::none())
        release();
    else
        watch(again);
}

void watch(int delay)
{
    if (gWatching)
        return;
    gWatching = true;
    QTimer::singleShot(delay, lookAgain);
}

} // namespace

void freeze(QWidget *window)
{
    release();
    if (!window)
        return;
    gFrozen = window;
    window->setUpdatesEnabled(false);
    watch(0);
}

} // namespace drawingfreeze
