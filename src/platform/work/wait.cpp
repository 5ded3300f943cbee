#include "platform/work/wait.h"

#include "platform/desktop/nestedloop.h"
#include "platform/text/textrules.h"
#include "platform/work/longwork.h"
#include "platform/work/workwindow.h"

#include <QTimer>
#include <vector>

using namespace Qt::StringLiterals;

namespace
{

std::vector<Wait *> gWaits; // the last one began last

} // namespace

Wait::Wait(LongWork &work, int windowAfter) : mWork(work), mWindowAfter(windowAfter)
{
    gWaits.push_back(this);
    work.mWaits.push_back(this);
}

Wait::~Wait()
{
    std::erase(gWaits, this);
    std::erase(mWork.mWaits, this);
}

bool Wait::run()
{
    const NestedLoop nested;
    if (mState == State::Waiting && mWork.showPercent)
        mLoop.exec();
    else if (mState == State::Waiting)
        runBehindWindow();
    return mState == State::Done;
}

void Wait::runBehindWindow()
{
    QTimer::singleShot(mWindowAfter, &mLoop, &QEventLoop::quit);
    mLoop.exec(QEventLoop::ExcludeUserInputEvents);
    if (mState != State::Waiting)
        return;
    WorkWindow window(mWork);
    mWindow = &window;
    if (mPercent >= 0)
        showPercent(mPercent);
    window.show();
    mLoop.exec();
}

void Wait::showPercent(int percent)
{
    mPercent = percent;
    if (mWindow)
        mWindow->showPercent(percent);
}

// Those that began later stand on the stack above: their loops must return before this one can.
void Wait::end(bool done)
{
    if (mState != State::Waiting)
        return;
    mState = done ? State::Done : State::Cancelled;
    while (gWaits.back() != this && gWaits.back()->mState == State::Waiting)
        gWaits.back()->cancel();
    mLoop.quit();
}
