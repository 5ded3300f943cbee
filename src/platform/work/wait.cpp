#include "platform/work/wait.h"

#include "platform/desktop/nestedloop.h"
#include "platform/text/messagetexts.h"
#include "platform/text/textrules.h"
#include "platform/work/longwork.h"

#include <QProgressBar>
#include <QProgressDialog>
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
    QProgressDialog window(mWork.what(), text::ofKey("cmdCancelCaption"), 0, 0, mWork.window());
    window.setObjectName(u"WorkWindow"_s);
    mBar = new QProgressBar; // the dialog's own handles events with each value
    window.setBar(mBar);
    mBar->setRange(0, 0);
    if (mPercent >= 0)
        showPercent(mPercent);
    window.setWindowModality(Qt::ApplicationModal);
    connect(&window, &QProgressDialog::canceled, this, [this] { mWork.cancel(); });
    window.show();
    mLoop.exec();
}

void Wait::showPercent(int percent)
{
    mPercent = percent;
    if (!mBar)
        return;
    mBar->setRange(0, 100);
    mBar->setValue(percent);
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
