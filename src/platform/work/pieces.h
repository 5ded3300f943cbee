#pragma once

#include <QtGlobal>
#include <functional>
#include <memory>
#include <optional>
#include <stop_token>

class Wait;

/// Pieces of work that several threads make, for the one thread that takes them over in their
/// order. What the threads share is theirs: one that does not come back is left behind.
class Pieces
{
public:
    using Make = std::function<void(qsizetype number, std::stop_token stop)>;

    Pieces(qsizetype count, const Make &make, Wait &wait);
    ~Pieces();
    Pieces(const Pieces &) = delete;
    Pieces &operator=(const Pieces &) = delete;

    /// Calls `takeOver` in the wait whenever pieces have come, until all are taken. Throws what a
    /// piece or `takeOver` has thrown. False: cancelled.
    bool run(const std::function<void()> &takeOver);

    std::optional<qsizetype> next(); // that is made, in the order
    qsizetype taken() const;

private:
    struct Shared;
    void stop();
    static void work(const std::shared_ptr<Shared> &shared);

    std::shared_ptr<Shared> mShared;
    Wait &mWait;
};
