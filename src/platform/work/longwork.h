#pragma once

#include "platform/desktop/form.h"

#include <QElapsedTimer>
#include <functional>
#include <memory>
#include <optional>
#include <stop_token>
#include <vector>

class Wait;
class WorkWindow;

/// One long work of a screen, for as long as this object lives: a text load, an export, a save, a
/// print, a look-up. The screen is busy meanwhile, so it refuses to close. The work handles events
/// now and then, no more often than a person can see, and knows whether it was cancelled.
///
/// A command of the user begins one only where mayBegin() says so: then there is one at a time, and
/// nothing changes the data below it. What a work does may begin others inside it.
class LongWork
{
public:
    /// Whether a command of this screen may begin something long, or change data. While another
    /// screen works the user is told, in one sentence; while this one does nothing happens.
    static bool mayBegin(const Form &screen);
    static bool any();

    /// Cancels all, the last first: at the end of the program.
    static void cancelAll();

    /// `what` is shown where the screen shows no progress of its own.
    explicit LongWork(Form &screen, const QString &what = {});
    ~LongWork();
    LongWork(const LongWork &) = delete;
    LongWork &operator=(const LongWork &) = delete;

    /// The screen's own progress: told the whole per cent of what is done whenever that changes.
    std::function<void(int percent)> showPercent;

    /// To be called after each step, however small. False: cancelled. Where the screen shows no
    /// progress and it is known what the work is, a window does after a moment.
    bool step(qint64 done, qint64 all);
    bool step(); // where no size is known, or somebody else counts

    void cancel();
    bool isCancelled() const { return mCancelled; }

    /// What `make` gives, made in a thread of its own; nothing if the work was cancelled. It takes
    /// and gives values alone (nothing of the catalogue, the messages, the desktop) and ends soon
    /// after a stop is requested. What it throws is thrown here.
    template <typename Value>
    std::optional<Value> valueOf(const std::function<Value(std::stop_token)> &make)
    {
        std::optional<Value> value;
        const bool done = runInThread([&](std::stop_token stop) { value = make(stop); });
        return done ? std::move(value) : std::nullopt;
    }

    /// What `make` gives for each number below `count`, made by several threads and taken over in
    /// this one, in the order of the numbers. `make` is held to what valueOf() asks of its piece,
    /// and owns all that it stands on: one that hangs on a dead medium is left behind when the work
    /// is cancelled. `take` handles no events. False: cancelled; what was taken until then stays.
    template <typename Value>
    bool eachOf(qsizetype count, const std::function<Value(qsizetype, std::stop_token)> &make,
                const std::function<void(qsizetype, Value &&)> &take)
    {
        using Batch = std::vector<Value>;
        const auto made = std::make_shared<std::vector<Batch>>((count + batch - 1) / batch);
        const auto makeBatch = [made, make, count](qsizetype number, const std::stop_token &stop) {
            Batch values;
            const qsizetype end = std::min(count, (number + 1) * batch);
            for (qsizetype i = number * batch; i < end && !stop.stop_requested(); ++i)
                values.push_back(make(i, stop));
            (*made)[std::size_t(number)] = std::move(values);
        };
        return runInThreads(qsizetype(made->size()), makeBatch, [&](qsizetype number) {
            Batch values = std::move((*made)[std::size_t(number)]);
            for (std::size_t i = 0; i < values.size(); ++i)
                take(number * batch + qsizetype(i), std::move(values[i]));
        });
    }

    /// Waits until an object of this thread, as a reply of the network, gives a signal. False: the
    /// work was cancelled, and `abort` was called.
    template <typename Sender, typename Signal, typename Abort>
    bool waitFor(Sender *sender, Signal signal, const Abort &abort)
    {
        const bool done = waitUntil([&](auto tell) {
            return QObject::connect(sender, signal, sender, [tell] { tell(); });
        });
        if (!done)
            abort();
        return done;
    }

    QString what() const { return mWhat; }
    QWidget *window() const;

private:
    friend class Wait;
    using Tell = std::function<void()>;
    void showStep();
    static constexpr qsizetype batch = 32; // what a thread does before it tells of it
    bool runInThread(const std::function<void(std::stop_token)> &piece);
    bool runInThreads(qsizetype count, const std::function<void(qsizetype, std::stop_token)> &make,
                      const std::function<void(qsizetype)> &take);
    bool waitUntil(const std::function<QMetaObject::Connection(const Tell &)> &connectTo);

    Form *mScreen;
    Form::Busy mBusy;
    QString mWhat;
    std::vector<Wait *> mWaits;
    std::unique_ptr<WorkWindow> mWindow; // of steps
    QElapsedTimer mSince, mLastPump;
    int mPercent = -1;
    bool mCancelled = false;
};
