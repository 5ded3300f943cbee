#include "platform/work/longwork.h"

#include "platform/desktop/desktop.h"
#include "platform/text/messagetexts.h"
#include "platform/work/pieces.h"
#include "platform/work/wait.h"
#include "platform/work/workwindow.h"

#include <QApplication>
#include <thread>

namespace
{

constexpr qint64 pumpInterval = 20; // milliseconds
constexpr int windowAfter = 300;    // milliseconds; where it is known how much there is to do

std::vector<LongWork *> gWorks; // the last one began last

} // namespace

bool LongWork::mayBegin(const Form &screen)
{
    if (gWorks.empty())
        return !screen.isBusy();
    const bool own = std::any_of(gWorks.begin(), gWorks.end(),
                                 [&](const LongWork *work) { return work->mScreen == &screen; });
    if (!own)
        informationBox(text::ofKey("xBusy"));
    return false;
}

bool LongWork::any()
{
    return !gWorks.empty();
}

void LongWork::cancelAll()
{
    const auto works = gWorks;
    std::for_each(works.rbegin(), works.rend(), [](LongWork *work) { work->cancel(); });
}

LongWork::LongWork(Form &screen, const QString &what) : mScreen(&screen), mBusy(screen), mWhat(what)
{
    gWorks.push_back(this);
    mSince.start();
    mLastPump.start();
}

LongWork::~LongWork()
{
    std::erase(gWorks, this);
}

QWidget *LongWork::window() const
{
    QWidget *window = mScreen->window(); // which may still be at its load
    return window->isVisible() ? window : QApplication::activeWindow();
}

bool LongWork::step(qint64 done, qint64 all)
{
    const int percent = all > 0 ? int(done * 100 / all) : 100;
    if (percent != mPercent && showPercent)
        showPercent(percent);
    mPercent = percent;
    if (!showPercent && !mWhat.isEmpty())
        showStep();
    return step();
}

void LongWork::showStep()
{
    if (!mWindow && mSince.elapsed() >= windowAfter && !mCancelled) {
        mWindow = std::make_unique<WorkWindow>(*this);
        mWindow->show();
    }
    if (mWindow)
        mWindow->showPercent(mPercent);
}

bool LongWork::step()
{
    if (mLastPump.elapsed() >= pumpInterval) {
        Desktop::current().pump();
        mLastPump.restart();
    }
    return !mCancelled;
}

void LongWork::cancel()
{
    mCancelled = true;
    const auto waits = mWaits;
    std::for_each(waits.rbegin(), waits.rend(), [](Wait *wait) { wait->cancel(); });
}

// The thread is always awaited: it stands on values of this routine.
bool LongWork::runInThread(const std::function<void(std::stop_token)> &piece)
{
    if (mCancelled)
        return false;
    Wait wait(*this);
    std::exception_ptr failure;
    std::jthread worker([&](const std::stop_token &stop) {
        try {
            piece(stop);
        } catch (...) {
            failure = std::current_exception();
        }
        QMetaObject::invokeMethod(&wait, &Wait::done, Qt::QueuedConnection);
    });
    const bool done = wait.run();
    worker.request_stop();
    worker.join();
    if (done && failure)
        std::rethrow_exception(failure);
    return done;
}

bool LongWork::runInThreads(qsizetype count,
                            const std::function<void(qsizetype, std::stop_token)> &make,
                            const std::function<void(qsizetype)> &take)
{
    if (mCancelled || count == 0)
        return !mCancelled;
    Wait wait(*this, windowAfter);
    Pieces pieces(count, make, wait);
    const auto takeOver = [&] {
        while (const auto number = pieces.next())
            take(*number);
        const int percent = int(pieces.taken() * 100 / count);
        if (percent != std::exchange(mPercent, percent) && showPercent)
            showPercent(percent);
        wait.showPercent(percent);
    };
    return pieces.run(takeOver);
}

bool LongWork::waitUntil(const std::function<QMetaObject::Connection(const Tell &)> &connectTo)
{
    if (mCancelled)
        return false;
    Wait wait(*this);
    const auto connection = connectTo([&wait] { wait.done(); });
    const bool done = wait.run();
    QObject::disconnect(connection);
    return done;
}
