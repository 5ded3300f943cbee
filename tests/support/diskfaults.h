#pragma once

#include <QFile>
#include <QFileInfo>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <dlfcn.h>
#include <fcntl.h>
#include <functional>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

/// Makes one call to the disk fail, whichever part of the program or of its libraries makes it:
/// the test program's own write(), fsync(), rename() and so on stand before those of the system. To
/// be included once in a program. Only what concerns files below one folder is counted.
namespace diskfaults
{

enum class Kind {
    Full,   // that call and all writes behind it find no room; a write takes a part first
    Broken, // that call alone fails
    Killed  // the process ends there, a write half done
};
constexpr int killed = 77; // how such a process ends

/// Counts the calls below a folder from now on and lets the n-th fail; 0: none.
class Fault
{
public:
    Fault(const QString &folder, Kind kind, int n);
    ~Fault();
    Fault(const Fault &) = delete;
    Fault &operator=(const Fault &) = delete;

    bool came() const; // whether there were as many calls
};

} // namespace diskfaults

namespace diskfaults
{

struct State {
    std::string folder;
    Kind kind = Kind::Full;
    int failing = 0, calls = 0;
};
State *gState = nullptr;
std::function<void()> gAtRename; // called once, before the next file gets another name

void beforeRename()
{
    if (gAtRename)
        std::exchange(gAtRename, nullptr)();
}

bool concerns(const char *path)
{
    return gState && std::string(path).compare(0, gState->folder.size(), gState->folder) == 0;
}

bool concerns(int handle)
{
    char path[4096];
    const std::string link = "/proc/self/fd/" + std::to_string(handle);
    const auto size = gState ? ::readlink(link.c_str(), path, sizeof path - 1) : -1;
    return size > 0 && concerns((path[size] = 0, path));
}

// Whether this call is the one to fail, or comes behind it on a full disk.
template <typename File> bool fails(File file, bool needsRoom, bool isWrite = false)
{
    if (!concerns(file))
        return false;
    const int call = ++gState->calls;
    if (gState->kind == diskfaults::Kind::Killed && call == gState->failing && !isWrite)
        ::_exit(diskfaults::killed);
    const bool full = gState->kind == diskfaults::Kind::Full;
    const bool now = full ? needsRoom && gState->failing > 0 && call >= gState->failing
                          : call == gState->failing;
    errno = now ? (full ? ENOSPC : EIO) : errno;
    return now;
}

// A write. The one that fills the disk takes what there is room for, as one does in which the
// process ends; a system takes whole sectors.
template <typename Write> ssize_t part(int handle, size_t size, off_t at, const Write &write)
{
    constexpr off_t sector = 512;
    const int before = gState ? gState->calls : 0;
    if (!fails(handle, true, true))
        return write(size);
    const bool isFirst = before + 1 == gState->failing;
    const off_t room = (at + off_t(size / 2)) / sector * sector - at;
    const bool takes = gState->kind != diskfaults::Kind::Broken && isFirst && room > 0;
    const ssize_t taken = takes ? write(size_t(room)) : -1;
    if (gState->kind == diskfaults::Kind::Killed)
        ::_exit(diskfaults::killed);
    return taken;
}

template <typename Function> Function *next(Function *, const char *name)
{
    return reinterpret_cast<Function *>(::dlsym(RTLD_NEXT, name));
}

int openAs(const char *name, const char *path, int flags, unsigned mode)
{
    if ((flags & (O_CREAT | O_WRONLY | O_RDWR | O_DIRECTORY)) && fails(path, flags & O_CREAT))
        return -1;
    return reinterpret_cast<int (*)(const char *, int, ...)>(::dlsym(RTLD_NEXT, name))(path, flags,
                                                                                       mode);
}

unsigned modeOf(int flags, va_list rest)
{
    return flags & (O_CREAT | O_TMPFILE) ? va_arg(rest, unsigned) : 0;
}

extern "C" {

int open(const char *path, int flags, ...)
{
    va_list rest;
    va_start(rest, flags);
    const unsigned mode = modeOf(flags, rest);
    va_end(rest);
    return openAs("open", path, flags, mode);
}

int open64(const char *path, int flags, ...)
{
    va_list rest;
    va_start(rest, flags);
    const unsigned mode = modeOf(flags, rest);
    va_end(rest);
    return openAs("open64", path, flags, mode);
}

ssize_t write(int handle, const void *data, size_t size)
{
    static const auto system = next(&::write, "write");
    return part(handle, size, 0, [&](size_t some) { return system(handle, data, some); });
}

ssize_t pwrite(int handle, const void *data, size_t size, off_t at)
{
    static const auto system = next(&::pwrite, "pwrite");
    return part(handle, size, at, [&](size_t some) { return system(handle, data, some, at); });
}

ssize_t pwrite64(int handle, const void *data, size_t size, off64_t at)
{
    static const auto system = next(&::pwrite64, "pwrite64");
    return part(handle, size, at, [&](size_t some) { return system(handle, data, some, at); });
}

ssize_t copy_file_range(int from, off64_t *fromAt, int to, off64_t *toAt, size_t size,
                        unsigned flags)
{
    static const auto system = next(&::copy_file_range, "copy_file_range");
    return part(to, size, toAt ? *toAt : 0,
                [&](size_t some) { return system(from, fromAt, to, toAt, some, flags); });
}

int posix_fallocate(int handle, off_t at, off_t size)
{
    static const auto system = next(&::posix_fallocate, "posix_fallocate");
    return fails(handle, true) ? errno : system(handle, at, size);
}

int posix_fallocate64(int handle, off64_t at, off64_t size)
{
    static const auto system = next(&::posix_fallocate64, "posix_fallocate64");
    return fails(handle, true) ? errno : system(handle, at, size);
}

int ftruncate(int handle, off_t size) noexcept
{
    static const auto system = next(&::ftruncate, "ftruncate");
    return fails(handle, false) ? -1 : system(handle, size);
}

int ftruncate64(int handle, off64_t size) noexcept
{
    static const auto system = next(&::ftruncate64, "ftruncate64");
    return fails(handle, false) ? -1 : system(handle, size);
}

int fsync(int handle)
{
    static const auto system = next(&::fsync, "fsync");
    return fails(handle, false) ? -1 : system(handle);
}

int fdatasync(int handle)
{
    static const auto system = next(&::fdatasync, "fdatasync");
    return fails(handle, false) ? -1 : system(handle);
}

int rename(const char *from, const char *to) noexcept
{
    static const auto system = next(&::rename, "rename");
    beforeRename();
    return fails(to, false) ? -1 : system(from, to);
}

int renameat2(int fromFolder, const char *from, int toFolder, const char *to,
              unsigned flags) noexcept
{
    static const auto system = next(&::renameat2, "renameat2");
    beforeRename();
    return fails(to, false) ? -1 : system(fromFolder, from, toFolder, to, flags);
}

int mkdir(const char *path, mode_t mode) noexcept
{
    static const auto system = next(&::mkdir, "mkdir");
    return fails(path, true) ? -1 : system(path, mode);
}

} // extern "C"

Fault::Fault(const QString &folder, Kind kind, int n)
{
    gState = new State{QFile::encodeName(QFileInfo(folder).canonicalFilePath()).toStdString(), kind,
                       n, 0};
}

Fault::~Fault()
{
    delete gState;
    gState = nullptr;
}

bool Fault::came() const
{
    return gState->calls >= gState->failing;
}

} // namespace diskfaults
