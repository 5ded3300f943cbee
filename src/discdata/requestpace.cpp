#include "discdata/requestpace.h"

#include "platform/desktop/desktop.h"
#include "platform/files/filelock.h"
#include "platform/work/longwork.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QStandardPaths>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

constexpr int lockWithin = 100;    // milliseconds; it is held for the time of a read and a write
constexpr qint64 farthest = 60000; // no queue is longer: a clock has been set back

QString ownFolder()
{
    const QString own = QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
    return own.isEmpty() ? QDir::tempPath() : own;
}

QString fileFor(const QString &folder, const QString &host)
{
    const QByteArray hash = QCryptographicHash::hash(host.toUtf8(), QCryptographicHash::Sha1);
    return folder + u"/songcase-pace-"_s + QString::fromLatin1(hash.toHex().left(16));
}

qint64 readMoment(const QString &name)
{
    QFile file(name);
    return file.open(QIODevice::ReadOnly) ? file.read(20).toLongLong() : 0;
}

// In place, since the file is the lock as well. Half of it is only a moment long gone.
void writeMoment(const QString &name, qint64 moment)
{
    QFile file(name);
    if (file.open(QIODevice::ReadWrite))
        file.write(QByteArray::number(moment));
}

} // namespace

bool RequestPace::pauseFor(int milliseconds, LongWork &work)
{
    if (milliseconds <= 0)
        return !work.isCancelled();
    QTimer timer;
    timer.setTimerType(Qt::PreciseTimer);
    timer.setSingleShot(true);
    timer.start(milliseconds);
    return work.waitFor(&timer, &QTimer::timeout, [] {});
}

RequestPace::RequestPace(const QString &folder, int interval, Pause pause)
    : mFolder(folder.isEmpty() ? ownFolder() : folder),
      mInterval(interval),
      mPause(std::move(pause))
{
}

bool RequestPace::await(const QString &host, LongWork &work)
{
    const int wait = mInterval > 0 ? reserve(host) : 0;
    return wait > 0 ? mPause(wait, work) : !work.isCancelled();
}

// The moment is taken before it has come: of two that wait each has its own.
int RequestPace::reserve(const QString &host)
{
    const QString file = fileFor(mFolder, host);
    FileLock lock;
    const bool shared = lock.takeWithin(file, lockWithin) == FileLock::Outcome::Taken;
    const qint64 now = Desktop::current().now().toMSecsSinceEpoch();
    qint64 moment = nextAfter(mLast.value(host), now);
    if (shared)
        moment = qMax(moment, nextAfter(readMoment(file), now));
    mLast[host] = moment;
    if (shared)
        writeMoment(file, moment);
    return int(moment - now);
}

qint64 RequestPace::nextAfter(qint64 last, qint64 now) const
{
    return last > now + farthest ? now : qMax(now, last + mInterval);
}
