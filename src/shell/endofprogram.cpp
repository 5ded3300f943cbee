#include "shell/endofprogram.h"

#include "platform/desktop/modalloop.h"
#include "platform/desktop/nestedloop.h"
#include "platform/work/longwork.h"
#include "shell/MainScreen.h"

#include <QApplication>

namespace
{

constexpr int interval = 50;       // milliseconds
constexpr int timeToAnswer = 5000; // milliseconds

} // namespace

EndOfProgram::EndOfProgram(MainScreen &frame) : mFrame(frame)
{
    mStep.setInterval(interval);
    connect(&mStep, &QTimer::timeout, this, &EndOfProgram::step);
}

void EndOfProgram::request()
{
    if (!mStep.isActive())
        mStep.start();
}

// Comes round in nested event loops too, which is where it has something to refuse.
void EndOfProgram::step()
{
    LongWork::cancelAll();
    // Not from here: a timer does not come round while it is answered, and both may ask something.
    QMetaObject::invokeMethod(
        this, NestedLoop::none() ? &EndOfProgram::close : &EndOfProgram::refuseWhatStandsOpen,
        Qt::QueuedConnection);
}

void EndOfProgram::close()
{
    if (!NestedLoop::none())
        return;
    const bool refused = std::exchange(mAsking, true);
    if (mFrame.Unload(refused))
        mStep.stop();
}

void EndOfProgram::refuseWhatStandsOpen()
{
    QWidget *open = QApplication::activeModalWidget();
    if (open != mOpen) {
        mOpen = open;
        mOpenFor = 0;
    }
    mOpenFor += interval;
    if (open && (!mAsking || mOpenFor > timeToAnswer))
        refuseModal();
}
