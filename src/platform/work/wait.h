#pragma once

#include <QEventLoop>
#include <QObject>

class LongWork;

/// Handles events until done() or the work's end. Waits end last in, first out: one that ends while
/// a later one still waits inside it cancels that one first.
///
/// Unless the screen shows the progress itself, nothing is let in but Cancel: for half a second no
/// input at all, then a window stands before all others.
class Wait : public QObject
{
    Q_OBJECT

public:
    explicit Wait(LongWork &work);
    ~Wait() override;

    bool run(); // false: cancelled
    void done() { end(true); }
    void cancel() { end(false); }

private:
    enum class State { Waiting, Done, Cancelled };
    void end(bool done);
    void runBehindWindow();

    LongWork &mWork;
    QEventLoop mLoop;
    State mState = State::Waiting;
};
