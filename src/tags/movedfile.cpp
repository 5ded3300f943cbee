#include "tags/movedfile.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "platform/files/wastebasket.h"
#include "platform/files/wholefile.h"
#include "tags/tagerrors.h"

#include <QFileInfo>
#include <cerrno>
#include <cstdio>
#include <sys/stat.h>

using namespace Qt::StringLiterals;

namespace
{

[[noreturn]] void notMoved(const QString &from, int error)
{
    const bool refused = error == EINVAL || error == EILSEQ || error == ENAMETOOLONG;
    throw Error(refused ? errNameRefused : errFileNotMoved, u"Files"_s,
                from + u": "_s + qt_error_string(error));
}

bool rename(const QString &from, const QString &to)
{
    return ::rename(nativeName(from).constData(), nativeName(to).constData()) == 0;
}

void syncNames(const QString &from, const QString &to)
{
    const QString folder = QFileInfo(to).path();
    if (!syncFolder(folder))
        notMoved(to, EIO);
    if (QFileInfo(from).path() != folder)
        syncFolder(QFileInfo(from).path());
}

[[noreturn]] void notReplaced(const char *key)
{
    throw Error(errNotReplaced, u"Files"_s, errorText(key, {}));
}

// Its name in the wastebasket.
QString putAway(const QString &path, const FileStamp &wanted)
{
    QString there = wastebasket::take(path);
    if (there.isEmpty())
        notReplaced("xNotIntoWastebasket");
    if (!stampOfName(there).isSameFile(wanted)) { // came in this moment
        wastebasket::giveBack(there, path);
        notReplaced("xNameTakenNow");
    }
    return there;
}

} // namespace

std::optional<FileStamp> findName(const QString &path)
{
    struct stat about = {};
    if (::lstat(nativeName(path).constData(), &about) != 0)
        return {};
    const qint64 modified = qint64(about.st_mtim.tv_sec) * 1'000'000'000 + about.st_mtim.tv_nsec;
    return FileStamp{about.st_dev, about.st_ino, about.st_size, modified, 0};
}

bool isStill(const QString &path, const FileStamp &stamp)
{
    const auto now = findName(path);
    if (!now || now->isSameFile(stamp))
        return now.has_value();
    const bool isAsOld = stamp.modified != 0 && now->modified == stamp.modified;
    return now->size == stamp.size && (now->inode == stamp.inode || isAsOld);
}

bool isNameTaken(const QString &path)
{
    return findName(path).has_value();
}

FileStamp stampOfName(const QString &path)
{
    const auto stamp = findName(path);
    if (!stamp)
        notMoved(path, errno);
    return *stamp;
}

void moveFile(const QString &from, const QString &to, const std::optional<FileStamp> &over)
{
    const auto there = findName(to);
    // By a link, or on a disk that makes no difference between cases.
    const bool isItself = stampOfName(from).isSameFile(there.value_or(FileStamp()));
    const bool replaces = there && !isItself;
    if (replaces && !(over && over->isSameFile(*there)))
        notReplaced("xNameTakenNow");
    const QString away = replaces && wastebasket::exists() ? putAway(to, *there) : QString();
    const bool isFree = !there || !away.isEmpty();
    if (!(isFree ? renameWhereFree(from, to) : rename(from, to))) {
        const int error = errno;
        if (!away.isEmpty())
            wastebasket::giveBack(away, to);
        if (isFree && error == EEXIST)
            notReplaced("xNameTakenNow");
        notMoved(from, error);
    }
    syncNames(from, to);
}

// Where neither is there the medium may not be: the folder is then another one, or none.
Mended mendMove(const FileChange &change)
{
    if (isStill(change.path, change.before)) // under both names by a link it is where it was
        return Mended::Old;
    if (isStill(change.other, change.before))
        return Mended::New;
    try {
        const bool isSameDisk =
            stampOf(QFileInfo(change.path).path()).device == change.before.device;
        return isSameDisk ? Mended::Foreign : Mended::NotNow;
    } catch (const Error &) {
        return Mended::NotNow;
    }
}
