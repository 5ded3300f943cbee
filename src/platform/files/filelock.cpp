#include "platform/files/filelock.h"

#include "platform/files/nativename.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace
{

constexpr off_t lockedByte = off_t(1) << 62;
constexpr int betweenAttempts = 5; // milliseconds

bool isPlainFile(int handle)
{
    struct stat about = {};
    return ::fstat(handle, &about) == 0 && S_ISREG(about.st_mode);
}

} // namespace

FileLock::~FileLock()
{
    if (mHandle >= 0)
        ::close(mHandle);
}

FileLock::FileLock(FileLock &&other) noexcept : mHandle(std::exchange(other.mHandle, -1)) {}

FileLock &FileLock::operator=(FileLock &&other) noexcept
{
    std::swap(mHandle, other.mHandle);
    return *this;
}

// Of the open file, not of the process: two in one process exclude each other as well.
FileLock::Outcome FileLock::takeFor(int handle)
{
    struct flock byte = {};
    byte.l_type = F_WRLCK;
    byte.l_whence = SEEK_SET;
    byte.l_start = lockedByte;
    byte.l_len = 1;
    if (::fcntl(handle, F_OFD_SETLK, &byte) == 0)
        return Outcome::Taken;
    return errno == EAGAIN || errno == EACCES ? Outcome::Held : Outcome::Unusable;
}

FileLock::Outcome FileLock::take(const QString &file, int flags)
{
    const int handle =
        ::open(nativeName(file).constData(), O_RDWR | O_CLOEXEC | O_NONBLOCK | flags, 0600);
    if (handle < 0)
        return Outcome::Unusable;
    const Outcome outcome = isPlainFile(handle) ? takeFor(handle) : Outcome::Unusable;
    if (outcome == Outcome::Taken)
        mHandle = handle;
    else
        ::close(handle);
    return outcome;
}

bool FileLock::isOf(const QString &file) const
{
    struct stat held = {}, named = {};
    return mHandle >= 0 && ::fstat(mHandle, &held) == 0 &&
           ::stat(nativeName(file).constData(), &named) == 0 && held.st_dev == named.st_dev &&
           held.st_ino == named.st_ino;
}

FileLock::Outcome FileLock::take(const QString &file)
{
    return take(file, 0);
}

FileLock::Outcome FileLock::takeWithin(const QString &lockFile, int milliseconds)
{
    auto outcome = take(lockFile, O_CREAT);
    for (int waited = 0; outcome == Outcome::Held && waited < milliseconds;
         waited += betweenAttempts) {
        ::usleep(betweenAttempts * 1000);
        outcome = take(lockFile, O_CREAT);
    }
    return outcome;
}
