#include "platform/files/systemfile.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdlib>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

using namespace Qt::StringLiterals;

namespace
{

qint64 nanoseconds(const timespec &time)
{
    return qint64(time.tv_sec) * 1'000'000'000 + time.tv_nsec;
}

FileStamp stampFrom(const struct stat &about)
{
    return {about.st_dev, about.st_ino, about.st_size, nanoseconds(about.st_mtim),
            nanoseconds(about.st_ctim)};
}

[[noreturn]] void failed(const QString &path)
{
    throw makeError(errFileFailed, path + u": "_s + qt_error_string(errno));
}

int flagsOf(SystemFile::Mode mode)
{
    constexpr int always = O_CLOEXEC | O_NONBLOCK; // a pipe would wait for somebody
    switch (mode) {
    case SystemFile::Mode::Read:
        return always | O_RDONLY;
    case SystemFile::Mode::Write:
        return always | O_RDWR;
    case SystemFile::Mode::Create:
        break;
    }
    return always | O_RDWR | O_CREAT | O_EXCL;
}

int opened(const QByteArray &name, SystemFile::Mode mode)
{
    // Only who owns the file may ask for that.
    const int quiet = ::open(name.constData(), flagsOf(mode) | O_NOATIME, 0600);
    return quiet >= 0 || errno != EPERM ? quiet : ::open(name.constData(), flagsOf(mode), 0600);
}

// Calls again after an interruption.
template <typename Call> auto again(const Call &call)
{
    auto result = call();
    while (result < 0 && errno == EINTR)
        result = call();
    return result;
}

} // namespace

SystemFile::SystemFile(const QString &path, Mode mode)
    : mPath(path), mHandle(opened(nativeName(path), mode))
{
    struct stat about = {};
    if (mHandle >= 0 && ::fstat(mHandle, &about) == 0 && S_ISREG(about.st_mode))
        return;
    const int error = mHandle >= 0 ? EINVAL : errno;
    if (mHandle >= 0)
        ::close(mHandle);
    errno = error;
    failed(path);
}

SystemFile::SystemFile(SystemFile &&other) noexcept
    : mPath(std::move(other.mPath)), mHandle(std::exchange(other.mHandle, -1))
{
}

SystemFile::~SystemFile()
{
    if (mHandle >= 0)
        ::close(mHandle);
}

void SystemFile::fail() const
{
    failed(mPath);
}

FileStamp SystemFile::stamp() const
{
    struct stat about = {};
    if (::fstat(mHandle, &about) != 0)
        fail();
    return stampFrom(about);
}

QByteArray SystemFile::read(qint64 from, qint64 count) const
{
    QByteArray bytes(count, Qt::Uninitialized);
    qint64 done = 0;
    while (done < count) {
        const auto size = again([&] {
            return ::pread(mHandle, bytes.data() + done, size_t(count - done), from + done);
        });
        if (size < 0)
            fail();
        if (size == 0)
            break;
        done += size;
    }
    bytes.truncate(done);
    return bytes;
}

void SystemFile::write(qint64 from, const QByteArray &bytes)
{
    for (qint64 done = 0; done < bytes.size();) {
        const auto size = again([&] {
            return ::pwrite(mHandle, bytes.data() + done, size_t(bytes.size() - done), from + done);
        });
        if (size <= 0)
            fail();
        done += size;
    }
}

void SystemFile::resize(qint64 size)
{
    const qint64 before = this->size();
    if (size > before) {
        // Where the system cannot promise room the write itself will tell.
        const int error = ::posix_fallocate(mHandle, before, size - before);
        if (error != 0 && error != EOPNOTSUPP && error != EINVAL) {
            [[maybe_unused]] const int back = ::ftruncate(mHandle, before);
            errno = error;
            fail();
        }
        return;
    }
    if (::ftruncate(mHandle, size) != 0)
        fail();
}

void SystemFile::sync()
{
    if (again([&] { return ::fsync(mHandle); }) != 0)
        fail();
}

void SystemFile::append(const SystemFile &other, qint64 from, qint64 count)
{
    constexpr qint64 piece = qint64(256) << 10; // bytes
    off64_t source = from, target = size();
    bool byKernel = true;
    while (count > 0) {
        if (byKernel) {
            const auto size = again([&] {
                return ::copy_file_range(other.mHandle, &source, mHandle, &target, size_t(count),
                                         0);
            });
            byKernel = size > 0;
            if (size < 0 && (errno == ENOSPC || errno == EIO || errno == EDQUOT || errno == EFBIG))
                fail();
            count -= std::max<qint64>(size, 0);
            continue;
        }
        const QByteArray bytes = other.read(source, std::min(piece, count));
        if (bytes.isEmpty()) { // shorter than it was
            errno = EIO;
            other.fail();
        }
        write(target, bytes);
        source += bytes.size();
        target += bytes.size();
        count -= bytes.size();
    }
}

FileStamp stampOf(const QString &path)
{
    struct stat about = {};
    if (::stat(nativeName(path).constData(), &about) != 0)
        failed(path);
    return stampFrom(about);
}

std::optional<FileStamp> stampOfOrdinaryFile(const QString &path)
{
    struct stat about = {};
    const bool isFile = stat(nativeName(path).constData(), &about) == 0 && S_ISREG(about.st_mode);
    return isFile ? std::optional(stampFrom(about)) : std::nullopt;
}

QString realPath(const QString &path)
{
    char *real = ::realpath(nativeName(path).constData(), nullptr);
    if (!real)
        return path;
    QString result = nameOfNative(real);
    std::free(real); // NOLINT: the system's own allocation
    return result;
}
