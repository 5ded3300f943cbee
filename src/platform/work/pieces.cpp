#include "platform/work/pieces.h"

#include "platform/work/wait.h"

#include <algorithm>
#include <atomic>
#include <exception>
#include <mutex>
#include <thread>
#include <vector>

namespace
{

constexpr unsigned mostThreads = 4; // more would only wait for the disk

} // namespace

struct Pieces::Shared {
    Shared(qsizetype pieces, Make make) : make(std::move(make)), done(std::size_t(pieces)) {}

    const Make make;
    std::atomic<std::size_t> begun = 0;
    std::stop_source stop;

    std::mutex mutex; // of all below
    std::vector<bool> done;
    std::exception_ptr failure;
    std::function<void()> tell; // empty once nobody listens

    void finish(std::size_t piece, std::exception_ptr with)
    {
        const std::lock_guard lock(mutex);
        done[piece] = true;
        if (with && !failure)
            failure = std::move(with);
        if (tell)
            tell();
    }
};

Pieces::Pieces(qsizetype count, const Make &make, Wait &wait)
    : mShared(std::make_shared<Shared>(count, make)), mWait(wait)
{
}

Pieces::~Pieces()
{
    mShared->stop.request_stop();
    const std::lock_guard lock(mShared->mutex);
    mShared->tell = nullptr;
}

void Pieces::work(const std::shared_ptr<Shared> &shared)
{
    const std::size_t count = shared->done.size();
    for (std::size_t piece; (piece = shared->begun++) < count;) {
        std::exception_ptr failure;
        try {
            if (shared->stop.stop_requested())
                return;
            shared->make(qsizetype(piece), shared->stop.get_token());
        } catch (...) {
            failure = std::current_exception();
        }
        shared->finish(piece, failure);
    }
}

bool Pieces::run(const std::function<void()> &takeOver)
{
    std::exception_ptr failure;
    const auto come = [&] {
        try {
            takeOver();
        } catch (...) {
            failure = std::current_exception();
        }
        const std::lock_guard lock(mShared->mutex);
        if (!failure)
            failure = mShared->failure;
        if (failure || std::size_t(mTaken) == mShared->done.size())
            mWait.done();
    };
    mShared->tell = [this, &come] {
        QMetaObject::invokeMethod(&mWait, come, Qt::QueuedConnection);
    };
    const auto threads = std::clamp(std::thread::hardware_concurrency(), 1U, mostThreads);
    for (std::size_t i = 0; i < std::min<std::size_t>(threads, mShared->done.size()); ++i)
        std::thread(work, mShared).detach();
    const bool done = mWait.run();
    if (done && failure)
        std::rethrow_exception(failure);
    return done;
}

std::optional<qsizetype> Pieces::next()
{
    const std::lock_guard lock(mShared->mutex);
    const bool made = !mShared->failure && std::size_t(mTaken) < mShared->done.size() &&
                      mShared->done[std::size_t(mTaken)];
    return made ? std::optional(mTaken++) : std::nullopt;
}
