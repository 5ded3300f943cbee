#include "tags/filerights.h"

#include <QByteArrayList>
#include <algorithm>
#include <cerrno>
#include <optional>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

// Nothing: they cannot be read.
std::optional<QByteArrayList> attributeNames(int file)
{
    const ssize_t size = ::flistxattr(file, nullptr, 0);
    if (size <= 0)
        return size == 0 || errno == ENOTSUP ? std::optional(QByteArrayList()) : std::nullopt;
    QByteArray names(size, Qt::Uninitialized);
    const ssize_t taken = ::flistxattr(file, names.data(), size_t(size));
    if (taken < 0)
        return {};
    names.truncate(taken);
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

// A new file may have inherited some from its folder, as an access list that lets others in.
bool takeOverAttributes(int target, int source)
{
    const auto from = attributeNames(source), to = attributeNames(target);
    if (!from || !to)
        return false;
    const auto isGone = [&](const QByteArray &name) {
        return from->contains(name) || isOfSystem(name) ||
               ::fremovexattr(target, name.constData()) == 0;
    };
    const auto isTaken = [&](const QByteArray &name) {
        return takeOverAttribute(target, source, name) || isOfSystem(name);
    };
    return std::ranges::all_of(*to, isGone) && std::ranges::all_of(*from, isTaken);
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
    constexpr mode_t rights = 07777; // behind the list: it would open what was inherited
    if (!takeOverAttributes(target, source) || ::fchmod(target, from.st_mode & rights) != 0)
        return false;
    const timespec times[] = {from.st_atim, {0, UTIME_OMIT}};
    return ::futimens(target, times) == 0;
}
