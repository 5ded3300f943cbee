#include "platform/work/pieces.h"

#include "platform/work/wait.h"

#include <algorithm>
#include <condition_variable>
#include <exception>
#include <mutex>
#include <thread>
#include <vector>

namespace
{

constexpr unsigned mostThreads = 4; // more would only wait for the disk
constexpr qsizetype mostAhead = 64; // pieces that are made and not yet taken over

} // namespace

struct Pieces::Shared {
    Shared(qsizetype pieces, Make make) : make(std::move(make)), done(std::size_t(pieces)) {}

    const Make make;
    std::stop_source stop;

    std::mutex mutex; // of all below
    std::condition_variable_any room;
    qsizetype begun = 0, taken = 0;
    std::vector<bool> done;
    std::exception_ptr failure;
    std::function<void()> tell; // empty once nobody listens

    // The next one to make; nothing when there are no more.
    std::optional<qsizetype> begin()
    {
        std::unique_lock lock(mutex);
        const bool mayGoOn =
            room.wait(lock, stop.get_token(), [this] { return begun < taken + mostAhead; });
        if (!mayGoOn || begun == qsizetype(done.size()))
            return {};
        return begun++;
    }

    void finish(qsizetype piece, std::exception_ptr with)
    {
        const std::lock_guard lock(mutex);
        done[std::size_t(piece)] = true;
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

qsizetype Pieces::taken() const
{
    const std::lock_guard lock(mShared->mutex);
    return mShared->taken;
}

Pieces::~Pieces()
{
    stop();
}

// Nothing more is begun, and nobody is told of what ends.
void Pieces::stop()
{
    mShared->stop.request_stop();
    const std::lock_guard lock(mShared->mutex);
    mShared->tell = nullptr;
}

void Pieces::work(const std::shared_ptr<Shared> &shared)
{
    while (const auto piece = shared->begin()) {
        std::exception_ptr failure;
        try {
            shared->make(*piece, shared->stop.get_token());
        } catch (...) {
            failure = std::current_exception();
        }
        shared->finish(*piece, failure);
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
        if (failure || mShared->taken == qsizetype(mShared->done.size()))
            mWait.done();
    };
    mShared->tell = [this, &come] {
        QMetaObject::invokeMethod(&mWait, come, Qt::QueuedConnection);
    };
    const auto threads = std::clamp(std::thread::hardware_concurrency(), 1U, mostThreads);
    for (std::size_t i = 0; i < std::min<std::size_t>(threads, mShared->done.size()); ++i)
        std::thread(work, mShared).detach();
    const bool done = mWait.run();
    stop(); // before what is told to goes
    if (done && failure)
        std::rethrow_exception(failure);
    return done;
}

std::optional<qsizetype> Pieces::next()
{
    const std::lock_guard lock(mShared->mutex);
    const auto next = mShared->taken;
    const bool made = !mShared->failure && next < qsizetype(mShared->done.size()) &&
                      mShared->done[std::size_t(next)];
    if (!made)
        return {};
    mShared->room.notify_all();
    return mShared->taken++;
}
