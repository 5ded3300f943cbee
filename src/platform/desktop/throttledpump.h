#pragma once

#include "platform/desktop/desktop.h"

#include <QElapsedTimer>

/// Handles what is waiting for the program, but no more often than a person can see: it may be
/// called after every line of a long file.
class ThrottledPump
{
public:
    ThrottledPump() { mLast.start(); }

    void operator()()
    {
        if (mLast.elapsed() < interval)
            return;
        Desktop::current().pump();
        mLast.restart();
    }

private:
    static constexpr qint64 interval = 20; // milliseconds

    QElapsedTimer mLast;
};
