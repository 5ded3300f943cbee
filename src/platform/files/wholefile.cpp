#include "platform/files/wholefile.h"

#include "platform/files/nativename.h"

#include <QFileInfo>
#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

// A disk that is nearly full takes a part and reports no error, not before the next attempt.
qint64 WholeFile::writeData(const char *data, qint64 size)
{
    qint64 written = 0;
    while (written < size) {
        const qint64 part = QSaveFile::writeData(data + written, size - written);
        if (part <= 0) {
            mReason = mReason.isEmpty() ? errorString() : mReason;
            return written > 0 ? written : part;
        }
        written += part;
    }
    return written;
}

// The base class overlooks a write that fell short, and an error of its sync. One that falls short
// leaves no error of the system's: the disk took what there was room for.
bool WholeFile::reachesTheDisk()
{
    errno = 0;
    if (mReason.isEmpty() && (!flush() || error() != QFileDevice::NoError))
        mReason = qt_error_string(errno != 0 ? errno : ENOSPC);
    if (mReason.isEmpty() && ::fsync(handle()) != 0)
        mReason = qt_error_string();
    return mReason.isEmpty();
}

bool WholeFile::commit()
{
    if (!isOpen())
        return false;
    if (!reachesTheDisk())
        cancelWriting();
    if (!QSaveFile::commit()) {
        mReason = mReason.isEmpty() ? errorString() : mReason;
        return false;
    }
    const bool named = syncFolder(QFileInfo(fileName()).canonicalPath());
    if (!named)
        mReason = qt_error_string();
    return named;
}

bool syncFolder(const QString &folder)
{
    const int handle = ::open(nativeName(folder).constData(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    if (handle < 0)
        return errno == EACCES; // a folder may be written and not read
    const bool synced = ::fsync(handle) == 0 || errno == EINVAL || errno == EROFS;
    ::close(handle);
    return synced;
}
