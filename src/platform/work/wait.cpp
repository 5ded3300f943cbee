#include "platform/work/wait.h"

#include "platform/desktop/nestedloop.h"
#include "platform/text/messagetexts.h"
#include "platform/text/textrules.h"
#include "platform/work/longwork.h"

#include <QProgressDialog>
#include <QTimer>
#include <vector>

using namespace Qt::StringLiterals;

namespace
{

constexpr int windowAfter = 500; // milliseconds

std::vector<Wait *> gWaits; // the last one began last

} // namespace

Wait::Wait(LongWork &work) : mWork(work)
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
    QTimer::singleShot(windowAfter, &mLoop, &QEventLoop::quit);
    mLoop.exec(QEventLoop::ExcludeUserInputEvents);
    if (mState != State::Waiting)
        return;
    QProgressDialog window(mWork.what(), text::ofKey("cmdCancelCaption"), 0, 0, mWork.window());
    window.setObjectName(u"WorkWindow"_s);
    window.setWindowModality(Qt::ApplicationModal);
    connect(&window, &QProgressDialog::canceled, this, [this] { mWork.cancel(); });
    window.show();
    mLoop.exec();
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
