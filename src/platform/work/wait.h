#pragma once

#include <QEventLoop>
#include <QObject>
#include <QPointer>

class LongWork;
class WorkWindow;

/// Handles events until done() or the work's end. Waits end last in, first out: one that ends while
/// a later one still waits inside it cancels that one first.
///
/// Unless the screen shows the progress itself, nothing is let in but Cancel: for half a second, or
/// as long as is said, no input at all, then a window stands before all others.
class Wait : public QObject
{
    Q_OBJECT

public:
    explicit Wait(LongWork &work, int windowAfter = 500); // milliseconds
    ~Wait() override;

    bool run(); // false: cancelled
    void done() { end(true); }
    void cancel() { end(false); }
    void showPercent(int percent); // of what is done, where that is known

private:
    enum class State { Waiting, Done, Cancelled };
    void end(bool done);
    void runBehindWindow();

    LongWork &mWork;
    const int mWindowAfter;
    QPointer<WorkWindow> mWindow;
    int mPercent = -1;
    QEventLoop mLoop;
    State mState = State::Waiting;
};
