#include "tags/movedfile.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "platform/files/wholefile.h"
#include "tags/tagerrors.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QStandardPaths>
#include <cerrno>
#include <cstdio>
#include <fcntl.h>
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

bool find(const QString &path, struct stat &about)
{
    return ::lstat(nativeName(path).constData(), &about) == 0;
}

// Where the desktop has no wastebasket the toolkit would take the current folder for it. So the
// one of the user has to be there first; on another disk it may still use one of that disk.
bool hasWastebasket()
{
    const QString data = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
    const QString wastebasket = data + u"/Trash"_s;
    if (!QFileInfo::exists(wastebasket) && QDir().mkpath(data) && QDir().mkdir(wastebasket))
        QFile::setPermissions(wastebasket, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    return !data.isEmpty() && QFileInfo(wastebasket).isDir();
}

} // namespace

bool isNameTaken(const QString &path)
{
    struct stat about = {};
    return find(path, about);
}

FileStamp stampOfName(const QString &path)
{
    struct stat about = {};
    if (!find(path, about))
        notMoved(path, errno);
    return {about.st_dev, about.st_ino, about.st_size, 0, 0};
}

void moveFile(const QString &from, const QString &to)
{
    const FileStamp moved = stampOfName(from);
    QString inWastebasket;
    if (isNameTaken(to) && !stampOfName(to).isSameFile(moved) && hasWastebasket())
        QFile::moveToTrash(to, &inWastebasket);
    if (!rename(from, to)) {
        const int error = errno;
        if (!inWastebasket.isEmpty() && !isNameTaken(to))
            rename(inWastebasket, to);
        notMoved(from, error);
    }
    syncNames(from, to);
}

void moveBack(const QString &from, const QString &to)
{
    const QByteArray one = nativeName(from), other = nativeName(to);
    const int result =
        ::renameat2(AT_FDCWD, one.constData(), AT_FDCWD, other.constData(), RENAME_NOREPLACE);
    // Not every disk knows how to look and rename in one.
    const bool isUnknown = result != 0 && (errno == EINVAL || errno == ENOSYS);
    if (isUnknown && isNameTaken(to))
        notMoved(to, EEXIST);
    if (result != 0 && !(isUnknown && rename(from, to)))
        notMoved(from, errno);
    syncNames(from, to);
}

Mended mendMove(const FileChange &change)
{
    const auto isIt = [&](const QString &path) {
        return isNameTaken(path) && stampOfName(path).isSameFile(change.before);
    };
    if (isIt(change.path)) // under both names by a link it is where it was
        return Mended::Old;
    if (isIt(change.other))
        return Mended::New;
    return isNameTaken(QFileInfo(change.path).path()) ? Mended::Foreign : Mended::NotNow;
}
