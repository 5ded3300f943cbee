#include "platform/files/wastebasket.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "platform/files/systemfile.h"
#include "platform/files/wholefile.h"

#include <QDateTime>
#include <QDir>
#include <QFileInfo>
#include <QRandomGenerator>
#include <QStandardPaths>
#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <optional>
#include <sys/stat.h>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype longestName = 200; // bytes; more is added to it
constexpr quint32 mostInARow = 20;     // names that are tried one after the other

void makeFolder(const QString &path)
{
    if (::mkdir(nativeName(path).constData(), 0700) == 0)
        syncFolder(QFileInfo(path).path());
}

void makeFolders(const QString &path)
{
    const QString above = QFileInfo(path).path();
    if (QFileInfo(path).isDir() || above == path)
        return;
    makeFolders(above);
    makeFolder(path);
}

std::optional<struct stat> find(const QString &path)
{
    struct stat about = {};
    if (::lstat(nativeName(path).constData(), &about) != 0)
        return {};
    return about;
}

dev_t diskOf(const QString &folder)
{
    struct stat about = {};
    return ::stat(nativeName(folder).constData(), &about) == 0 ? about.st_dev : 0;
}

QString ownFolder()
{
    const QString data = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation);
    return data.isEmpty() ? QString() : data + u"/Trash"_s;
}

// The folder that a disk begins with.
QString topOf(const QString &folder)
{
    QString top = folder;
    for (QString above = QFileInfo(top).path(); above != top && diskOf(above) == diskOf(folder);
         above = QFileInfo(top).path())
        top = above;
    return top;
}

// The one of the user on another disk; empty: it is somebody else's, or no folder.
QString folderOnDisk(const QString &top)
{
    QString folder = QDir(top).filePath(u".Trash-"_s + QString::number(::getuid()));
    makeFolder(folder);
    const auto about = find(folder);
    const bool isOwn = about && S_ISDIR(about->st_mode) && about->st_uid == ::getuid();
    return isOwn ? folder : QString();
}

// What tells of a file there where it was.
QString originOf(const QString &there)
{
    const QFileInfo file(there);
    return QFileInfo(file.path()).path() + u"/info/"_s + file.fileName() + u".trashinfo"_s;
}

QString freeNameIn(const QString &folder, const QString &path)
{
    const QByteArray name = nativeName(QFileInfo(path).fileName()).right(longestName);
    const QString files = folder + u"/files/"_s;
    QString there = files + nameOfNative(name);
    for (quint32 n = 2; find(there) || find(originOf(there)); ++n) {
        const quint32 number = n <= mostInARow ? n : QRandomGenerator::global()->generate();
        there = files + nameOfNative(QByteArray::number(number) + '-' + name);
    }
    return there;
}

void forgetOrigin(const QString &there)
{
    ::unlink(nativeName(originOf(there)).constData());
}

bool writeOrigin(const QString &there, const QString &origin)
{
    const QString now = QDateTime::currentDateTime().toString(u"yyyy-MM-ddThh:mm:ss"_s);
    bool isMade = false;
    try {
        SystemFile file(originOf(there), SystemFile::Mode::Create);
        isMade = true;
        file.write(0, "[Trash Info]\nPath=" + nativeName(origin).toPercentEncoding("/") +
                          "\nDeletionDate=" + now.toLatin1() + '\n');
        file.sync();
    } catch (const Error &) {
        if (isMade)
            forgetOrigin(there);
        return false;
    }
    return true;
}

QString takeInto(const QString &folder, const QString &path, const QString &origin)
{
    makeFolder(folder + u"/files"_s);
    makeFolder(folder + u"/info"_s);
    QString there = freeNameIn(folder, path);
    if (!writeOrigin(there, origin))
        return {};
    if (!renameWhereFree(path, there)) {
        forgetOrigin(there);
        return {};
    }
    // A disk that cannot sync has taken the file all the same.
    syncFolder(folder + u"/files"_s);
    syncFolder(folder + u"/info"_s);
    return there;
}

} // namespace

// A folder that cannot be made or entered now may be on a disk that is full, away or read-only.
// Only where a file stands in place of a folder above it can there be none.
bool wastebasket::exists()
{
    const QString folder = ownFolder();
    makeFolders(folder);
    struct stat about = {};
    return !folder.isEmpty() &&
           (::lstat(nativeName(folder).constData(), &about) == 0 || errno != ENOTDIR);
}

// Not by the toolkit: it knows no names that are no UTF-8, and tries without an end where the disk
// is full.
QString wastebasket::take(const QString &path)
{
    const QFileInfo file(path);
    const QString in = realPath(file.path()), real = QDir(in).filePath(file.fileName());
    const dev_t ownDisk = diskOf(ownFolder());
    if (ownDisk == 0 || ownDisk == diskOf(in))
        return takeInto(ownFolder(), real, real);
    const QString top = topOf(in), folder = folderOnDisk(top);
    return folder.isEmpty() ? QString() : takeInto(folder, real, QDir(top).relativeFilePath(real));
}

void wastebasket::giveBack(const QString &there, const QString &path)
{
    if (renameWhereFree(there, path))
        forgetOrigin(there);
}

bool renameWhereFree(const QString &from, const QString &to)
{
    const QByteArray one = nativeName(from), other = nativeName(to);
    if (::renameat2(AT_FDCWD, one.constData(), AT_FDCWD, other.constData(), RENAME_NOREPLACE) == 0)
        return true;
    // Not every disk knows how to look and rename in one.
    if (errno != EINVAL && errno != ENOSYS)
        return false;
    if (find(to)) {
        errno = EEXIST;
        return false;
    }
    return ::rename(one.constData(), other.constData()) == 0;
}
