#include "tags/headchange.h"

#include "platform/error/error.h"
#include "platform/files/filelock.h"
#include "platform/files/nativename.h"
#include "platform/files/ordinaryfile.h"
#include "platform/files/wholefile.h"
#include "tags/filerights.h"

#include <QFileInfo>
#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

constexpr qint64 piece = qint64(64) << 10; // bytes that are compared or copied at once
constexpr qint64 sector = 512;             // bytes that a disk writes whole

// The bytes between the first and the last that differ.
HeadChange inPlace(FileChange change, const QByteArray &oldHead, const QByteArray &newHead)
{
    const auto [first, unused] = std::mismatch(oldHead.begin(), oldHead.end(), newHead.begin());
    const qsizetype from = first - oldHead.begin();
    qsizetype to = oldHead.size();
    while (to > from && oldHead[to - 1] == newHead[to - 1])
        --to;
    change.from = from;
    return {change, oldHead.sliced(from, to - from), newHead.sliced(from, to - from)};
}

bool mayMakeFilesIn(const QString &folder)
{
    return ::faccessat(AT_FDCWD, nativeName(folder).constData(), W_OK | X_OK, AT_EACCESS) == 0;
}

bool isThere(const QString &path)
{
    return ::access(nativeName(path).constData(), F_OK) == 0;
}

struct stat aboutFile(const SystemFile &file)
{
    struct stat about = {};
    if (::fstat(file.handle(), &about) != 0)
        file.fail();
    return about;
}

QString folderOf(const QString &path)
{
    return QFileInfo(path).path();
}

// The new file, all of it; `oldHead` bytes of the old one have made room.
void writeNew(SystemFile &target, const HeadChange &head, const SystemFile &file)
{
    target.write(0, head.newBytes);
    target.append(file, head.change.oldHead, head.change.before.size - head.change.oldHead);
}

[[noreturn]] void failWith(int error, const SystemFile &file)
{
    errno = error;
    file.fail();
}

// What was written is what was meant: the new head and the sound behind it.
void readBack(const SystemFile &target, const HeadChange &head, const SystemFile &file)
{
    const FileChange &change = head.change;
    if (target.size() != change.newSize() || target.read(0, change.newHead) != head.newBytes)
        failWith(EIO, target);
    for (qint64 at = change.oldHead; at < change.before.size; at += piece) {
        if (target.read(at - change.oldHead + change.newHead, piece) != file.read(at, piece))
            failWith(EIO, target);
    }
}

void requireUntouched(const SystemFile &file, const FileStamp &before)
{
    if (file.stamp() != before || stampOf(file.path()) != before)
        failWith(EBUSY, file);
}

void beside(const HeadChange &head, const SystemFile &file)
{
    const QByteArray name = nativeName(head.change.other);
    try {
        SystemFile target(head.change.other, SystemFile::Mode::Create);
        writeNew(target, head, file);
        // The disk is busy with it while it is read back.
        ::sync_file_range(target.handle(), 0, 0, SYNC_FILE_RANGE_WRITE);
        if (!takeOverRights(target.handle(), file.handle()))
            throw NoWayBeside();
        readBack(target, head, file);
        target.sync();
        requireUntouched(file, head.change.before);
        if (::rename(name.constData(), nativeName(file.path()).constData()) != 0)
            file.fail();
    } catch (...) {
        ::unlink(name.constData());
        throw;
    }
    if (!syncFolder(folderOf(file.path())))
        failWith(EIO, file);
}

// From the copy that stands in the folder of the journal.
void through(const FileChange &change, SystemFile &file)
{
    const SystemFile copy(change.other, SystemFile::Mode::Read);
    if (copy.size() != change.newSize())
        failWith(EIO, copy);
    if (file.size() < copy.size())
        file.resize(copy.size());
    for (qint64 at = 0; at < copy.size(); at += piece)
        file.write(at, copy.read(at, piece));
    file.sync(); // before what it had behind that goes
    file.resize(copy.size());
    file.sync();
}

// A write of ours that fell short ends anywhere; one that the end of the program or of the power
// cut off, between two sectors.
bool isBegun(QByteArrayView part, QByteArrayView oldPart, QByteArrayView newPart)
{
    const auto written = std::mismatch(part.begin(), part.end(), newPart.begin()).first;
    const auto done = written - part.begin();
    return part.sliced(done) == oldPart.sliced(done);
}

// Whether each sector is that of the old or of the new bytes.
bool isMixture(QByteArrayView bytes, qint64 from, QByteArrayView oldBytes, QByteArrayView newBytes,
               bool ofThisRun)
{
    if (bytes.size() != oldBytes.size())
        return false;
    for (qsizetype at = 0; at < bytes.size();) {
        const qsizetype size =
            std::min<qsizetype>(bytes.size() - at, sector - (from + at) % sector);
        const QByteArrayView now = bytes.sliced(at, size), before = oldBytes.sliced(at, size),
                             after = newBytes.sliced(at, size);
        if (now != before && now != after && !(ofThisRun && isBegun(now, before, after)))
            return false;
        at += size;
    }
    return true;
}

// Who changes the file now has it; `ofThisRun` that is who asks.
bool isTaken(const SystemFile &file, bool ofThisRun)
{
    return !ofThisRun && FileLock::takeFor(file.handle()) == FileLock::Outcome::Held;
}

Mended mendInPlace(const FileChange &change, const QByteArray &kept, bool back)
{
    SystemFile file(change.path, SystemFile::Mode::Write);
    if (isTaken(file, back))
        return Mended::NotNow;
    const QByteArray oldBytes = kept.first(kept.size() / 2),
                     newBytes = kept.sliced(kept.size() / 2);
    const QByteArray bytes = file.read(change.from, oldBytes.size());
    if (file.size() != change.before.size ||
        !isMixture(bytes, change.from, oldBytes, newBytes, back))
        return Mended::Foreign;
    if (bytes == oldBytes && !back) // nobody has begun
        return Mended::Old;
    // Once more, since the disk may not have taken what is read now.
    const bool isNew = bytes == newBytes && !back;
    file.write(change.from, isNew ? newBytes : oldBytes);
    file.sync();
    return isNew ? Mended::New : Mended::Old;
}

bool hasNewHead(const SystemFile &file, const FileChange &change)
{
    return file.size() == change.newSize() &&
           headChecksum(file.read(0, change.newHead)) == change.newHeadIs;
}

Mended mendBeside(const FileChange &change)
{
    ::unlink(nativeName(change.other).constData());
    const SystemFile file(change.path, SystemFile::Mode::Read);
    if (hasNewHead(file, change))
        return Mended::New;
    return file.stamp().isSameFile(change.before) && file.size() == change.before.size
               ? Mended::Old
               : Mended::Foreign;
}

// What a file that goes through a copy held before: its head was kept, the rest is in the copy.
QByteArray oldPiece(const FileChange &change, const QByteArray &kept, const SystemFile &copy,
                    qint64 at, qint64 count)
{
    QByteArray bytes = kept.mid(at, count);
    const qint64 rest = std::min(count, change.before.size - at) - bytes.size();
    if (rest > 0)
        bytes += copy.read(at + bytes.size() - change.oldHead + change.newHead, rest);
    return bytes.leftJustified(count, '\0'); // the room behind it
}

struct Progress {
    bool hasNew = false, hasOther = false; // sectors that are new and not old, or neither
};

// The sectors of the file beside those of the old and of the new one.
Progress progressOf(const SystemFile &file, const SystemFile &copy, const FileChange &change,
                    const QByteArray &kept)
{
    Progress progress;
    const qint64 size = file.size();
    for (qint64 at = 0; at < size; at += piece) {
        const QByteArray now = file.read(at, piece),
                         before = oldPiece(change, kept, copy, at, now.size()),
                         after = copy.read(at, now.size()).leftJustified(now.size(), '\0');
        for (qsizetype i = 0; i < now.size(); i += sector) {
            const qsizetype count = std::min<qsizetype>(sector, now.size() - i);
            const auto is = [&](QByteArrayView bytes) {
                return QByteArrayView(now).sliced(i, count) == bytes.sliced(i, count);
            };
            const bool isOld = is(before), isNew = is(after);
            progress.hasNew |= isNew && !isOld;
            progress.hasOther |= !isNew && !isOld;
        }
    }
    return progress;
}

// Whether the file has all of the sound somewhere that it can be: behind the old head or the new
// one, or as its end, perhaps before an old tag that was put behind it.
bool hasSound(const SystemFile &file, const SystemFile &copy, const FileChange &change)
{
    constexpr qint64 endTag = 128;
    const qint64 sound = change.before.size - change.oldHead, size = file.size();
    const auto isAt = [&](qint64 from) {
        bool isThere = from >= 0 && from + sound <= size;
        for (qint64 at = 0; isThere && at < sound; at += piece) {
            const qint64 count = std::min(piece, sound - at);
            isThere = file.read(from + at, count) == copy.read(change.newHead + at, count);
        }
        return isThere;
    };
    return isAt(change.newHead) || isAt(change.oldHead) || isAt(size - sound) ||
           isAt(size - sound - endTag);
}

// The copy is the only place where the sound stands for sure: it goes, once this is New, Old or
// Foreign, and that needs a file with all of it.
Mended mendFromCopy(const FileChange &change, const QByteArray &kept, SystemFile &file, bool back)
{
    const SystemFile copy(change.other, SystemFile::Mode::Read);
    const qint64 before = change.before.size, after = change.newSize(), size = file.size();
    if (copy.size() != after || kept.size() != change.oldHead)
        return Mended::NotNow;
    const bool isBetween = size >= std::min(before, after) && size <= std::max(before, after);
    const Progress progress = isBetween ? progressOf(file, copy, change, kept) : Progress();
    if (!isBetween || (progress.hasOther && !back))
        return hasSound(file, copy, change) ? Mended::Foreign : Mended::NotNow;
    if (!progress.hasNew && !progress.hasOther && size >= before) {
        file.resize(before);
        file.sync();
        return Mended::Old;
    }
    through(change, file);
    return Mended::New;
}

Mended mendThrough(const FileChange &change, const QByteArray &kept, bool back)
{
    if (!isThere(change.path) && isThere(change.other))
        return Mended::NotNow; // it may have another name now
    SystemFile file(change.path, SystemFile::Mode::Write);
    if (isTaken(file, back))
        return Mended::NotNow;
    if (isThere(change.other))
        return mendFromCopy(change, kept, file, back);
    return hasNewHead(file, change) ? Mended::New : Mended::Foreign;
}

// Not so where its medium is not there: the folder is then another one, or empty.
bool isGone(const FileChange &change)
{
    struct stat folder = {};
    return ::stat(nativeName(folderOf(change.path)).constData(), &folder) == 0 &&
           folder.st_dev == change.before.device && !isThere(change.path);
}

} // namespace

bool isForWriting(const SystemFile &file)
{
    constexpr mode_t anybody = S_IWUSR | S_IWGRP | S_IWOTH;
    return (aboutFile(file).st_mode & anybody) != 0;
}

QByteArray HeadChange::kept() const
{
    return change.way == FileChange::Way::InPlace ? oldBytes + newBytes : oldBytes;
}

HeadChange plannedHead(const SystemFile &file, const FileStamp &before, const QByteArray &oldHead,
                       const QByteArray &newHead)
{
    FileChange change;
    change.path = file.path();
    change.before = before;
    change.oldHead = oldHead.size();
    change.newHead = newHead.size();
    change.newHeadIs = headChecksum(newHead);
    if (oldHead.size() == newHead.size())
        return inPlace(change, oldHead, newHead);
    const bool hasRoomBeside =
        aboutFile(file).st_nlink == 1 && mayMakeFilesIn(folderOf(file.path()));
    change.way = hasRoomBeside ? FileChange::Way::Beside : FileChange::Way::Through;
    return {change, oldHead, newHead};
}

void prepareHead(const HeadChange &head, const SystemFile &file)
{
    if (head.change.way != FileChange::Way::Through)
        return;
    SystemFile copy(head.change.other, SystemFile::Mode::Create);
    try {
        writeNew(copy, head, file);
        readBack(copy, head, file);
        copy.sync();
        requireUntouched(file, head.change.before);
        if (!syncFolder(folderOf(head.change.other)))
            failWith(EIO, file);
    } catch (...) {
        ::unlink(nativeName(head.change.other).constData());
        throw;
    }
}

void performHead(const HeadChange &head, SystemFile &file)
{
    switch (head.change.way) {
    case FileChange::Way::InPlace:
        file.write(head.change.from, head.newBytes);
        file.sync();
        break;
    case FileChange::Way::Beside:
        beside(head, file);
        break;
    default:
        through(head.change, file);
    }
}

Mended mendHead(const FileChange &change, const QByteArray &kept, bool back)
{
    try {
        switch (change.way) {
        case FileChange::Way::InPlace:
            return mendInPlace(change, kept, back);
        case FileChange::Way::Beside:
            return mendBeside(change);
        default:
            return mendThrough(change, kept, back);
        }
    } catch (const Error &) {
        // A file that was deleted needs nothing; a medium that is not there comes back.
        return isGone(change) ? Mended::Foreign : Mended::NotNow;
    }
}
