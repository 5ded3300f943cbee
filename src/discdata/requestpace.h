#pragma once

#include <QHash>
#include <QString>
#include <functional>

class LongWork;

/// Keeps the requests to a server apart, those of other windows and copies of the program included:
/// each reserves its moment in a small file that all of them share. Where that file cannot be used
/// the requests of this object alone are kept apart.
class RequestPace
{
public:
    /// Lets time go by; false: cancelled.
    using Pause = std::function<bool(int milliseconds, LongWork &work)>;
    static bool pauseFor(int milliseconds, LongWork &work);

    /// `folder` empty: the one that the system gives this user for such things.
    RequestPace(const QString &folder, int interval, Pause pause = pauseFor);

    /// Waits for the turn of a request. False: cancelled.
    bool await(const QString &host, LongWork &work);

    bool pause(int milliseconds, LongWork &work) const { return mPause(milliseconds, work); }
    int interval() const { return mInterval; }

private:
    int reserve(const QString &host);
    qint64 nextAfter(qint64 last, qint64 now) const;

    QString mFolder;
    int mInterval;
    Pause mPause;
    QHash<QString, qint64> mLast; // by host, milliseconds since 1970
};
