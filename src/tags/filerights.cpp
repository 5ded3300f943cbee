#include "tags/filerights.h"

#include <QByteArrayList>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

QByteArrayList attributeNames(int file)
{
    const ssize_t size = ::flistxattr(file, nullptr, 0);
    if (size <= 0)
        return {};
    QByteArray names(size, Qt::Uninitialized);
    names.truncate(std::max<ssize_t>(::flistxattr(file, names.data(), size_t(size)), 0));
    QByteArrayList all = names.split('\0');
    all.removeAll({});
    return all;
}

bool takeOverAttribute(int target, int source, const QByteArray &name)
{
    const ssize_t size = ::fgetxattr(source, name.constData(), nullptr, 0);
    QByteArray value(std::max<ssize_t>(size, 0), Qt::Uninitialized);
    const bool isRead = size >= 0 && ::fgetxattr(source, name.constData(), value.data(),
                                                 size_t(value.size())) == size;
    return isRead &&
           ::fsetxattr(target, name.constData(), value.constData(), size_t(value.size()), 0) == 0;
}

// Those are the system's own to give.
bool isOfSystem(const QByteArray &name)
{
    return name.startsWith("security.") || name.startsWith("trusted.");
}

} // namespace

bool takeOverRights(int target, int source)
{
    struct stat from = {}, to = {};
    if (::fstat(source, &from) != 0 || ::fstat(target, &to) != 0)
        return false;
    const bool hasOwner = from.st_uid == to.st_uid && from.st_gid == to.st_gid;
    if (!hasOwner && ::fchown(target, from.st_uid, from.st_gid) != 0)
        return false;
    constexpr mode_t rights = 07777;
    if (::fchmod(target, from.st_mode & rights) != 0)
        return false;
    for (const QByteArray &name : attributeNames(source)) {
        if (!takeOverAttribute(target, source, name) && !isOfSystem(name))
            return false;
    }
    const timespec times[] = {from.st_atim, {0, UTIME_OMIT}};
    return ::futimens(target, times) == 0;
}
