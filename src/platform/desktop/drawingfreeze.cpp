#include "platform/desktop/drawingfreeze.h"

#include <QPointer>
#include <QThread>
#include <QTimer>
#include <QWidget>

namespace drawingfreeze
{

namespace
{

QPointer<QWidget> gFrozen;
int gPumps = 0;
bool gWatching = false;

void release()
{
    if (gFrozen)
        gFrozen->setUpdatesEnabled(true);
    gFrozen.clear();
}

void watch();

void lookAgain()
{
    gWatching = false;
    if (!gFrozen)
        return;
    const bool inMainLoop = gPumps == 0 && QThread::currentThread()->loopLevel() <= 1;
    if (inMainLoop)
        release();
    else
        watch();
}

void watch()
{
    if (gWatching)
        return;
    gWatching = true;
    QTimer::singleShot(gPumps == 0 ? 0 : 20, lookAgain);
}

} // namespace

void freeze(QWidget *window)
{
    release();
    if (!window)
        return;
    gFrozen = window;
    window->setUpdatesEnabled(false);
    watch();
}

Pumping::Pumping()
{
    ++gPumps;
}

Pumping::~Pumping()
{
    --gPumps;
}

} // namespace drawingfreeze
