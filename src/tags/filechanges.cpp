#include "tags/filechanges.h"

#include "platform/files/filelock.h"
#include "platform/files/ordinaryfile.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"
#include "tags/tagfile.h"
#include "tags/tagsplicer.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr size_t announcedAtOnce = 100;
constexpr qint64 bytesAtOnce = 8 << 20;

[[noreturn]] void notAccessible(const QString &path)
{
    throw tagError(errTagNotAccessible, "xTagNotAccessible", path);
}

// Failures of the disk keep their words.
[[noreturn]] void notWritten(const Error &error)
{
    throw tagError(errTagNotWritten, "xTagNotWritten", error.Description);
}

// To root too a file is read-only that nobody may write.
SystemFile openedToChange(const QString &path)
{
    try {
        if (!isOrdinaryFile(path)) // a device may not even be opened
            notAccessible(path);
        SystemFile file(path, SystemFile::Mode::Write);
        if (isForWriting(file))
            return file;
    } catch (const Error &) { // told with the one number below
    }
    notAccessible(path);
}

// Nobody else of this program changes it until it is closed; where the file system knows no locks
// there is none.
SystemFile lockedToChange(const QString &path)
{
    SystemFile file = openedToChange(path);
    if (FileLock::takeFor(file.handle()) == FileLock::Outcome::Held)
        notAccessible(path);
    return file;
}

} // namespace

FileChanges::FileChanges(FileJournal &journal, About about)
    : mJournal(journal), mAbout(std::move(about))
{
}

FileChanges::~FileChanges()
{
    forgetAnnounced();
    if (mBatch != 0)
        mJournal.endBatch(mBatch);
}

// A command that changes nothing leaves no batch.
void FileChanges::begin()
{
    if (mBatch == 0)
        mBatch = mJournal.beginBatch({0, mAbout.when, mAbout.what, mAbout.where, mAbout.undoes});
}

std::optional<HeadChange> FileChanges::planned(const CddbID3Tag &tag, const SystemFile &file)
{
    const FileStamp before = file.stamp(); // what is written from now on is noticed
    const FileTag there = readTag(file);
    if (asRead(tag, there.fields) == there.fields)
        return {};
    if (!there.isWhole)
        throw tagError(errTagDamaged, "xTagDamaged", file.path());
    const SplicedTag spliced = splicedTag(there.bytes, there.fields, tag);
    return plannedHead(file, before, there.bytes, spliced.bytes);
}

// The names of the files beside and of the copies are told before they are made.
void FileChanges::tell(HeadChange &head, const SystemFile &file)
{
    FileChange &change = head.change;
    change.batch = mBatch;
    if (change.way == FileChange::Way::Beside)
        change.other = QFileInfo(change.path).path() + "/.songcase-"_L1 +
                       mJournal.copyName().section(u'-', -2) + ".tmp"_L1;
    if (change.way == FileChange::Way::Through)
        change.other = mJournal.copyName();
    prepareHead(head, file);
    try {
        mJournal.announce(change, head.kept());
    } catch (const Error &) {
        if (change.way == FileChange::Way::Through)
            QFile::remove(change.other);
        throw;
    }
}

void FileChanges::announce(const Tags &tags)
{
    mToCome = tags;
    mNext = 0;
    if (mToCome.size() > 1)
        announceSome();
}

// Gives the bytes that the journal keeps for it.
qint64 FileChanges::announceOne(const CddbID3Tag &tag, const QString &path)
{
    const QString real = realPath(path);
    const auto [place, isNew] = mAnnounced.try_emplace(real);
    if (!isNew)
        return 0;
    const SystemFile file = openedToChange(real);
    auto head = planned(tag, file);
    // A copy of a whole file is not made before its turn.
    if (!head || head->change.way == FileChange::Way::Through)
        return 0;
    begin();
    tell(*head, file);
    place->second = Prepared{*head, tag};
    return head->kept().size();
}

void FileChanges::announceSome()
{
    mJournal.tellDone();
    qint64 bytes = 0;
    const size_t end = std::min(mToCome.size(), mNext + announcedAtOnce);
    for (; mNext < end && bytes < bytesAtOnce; ++mNext) {
        const auto &[path, tag] = mToCome[mNext];
        try {
            bytes += announceOne(tag, path);
        } catch (const Error &) { // told at its turn
        }
    }
    try {
        mJournal.sync();
    } catch (const Error &) { // each save for itself tells what is wrong
        forgetAnnounced();
    }
}

void FileChanges::forgetAnnounced()
{
    for (const auto &[path, prepared] : mAnnounced) {
        if (prepared)
            mJournal.drop(prepared->head.change.id);
    }
    mAnnounced.clear();
}

std::optional<HeadChange> FileChanges::takeAnnounced(const CddbID3Tag &tag, const SystemFile &file)
{
    const auto found = mAnnounced.find(file.path());
    if (found == mAnnounced.end())
        return {};
    const auto prepared = std::move(found->second);
    mAnnounced.erase(found);
    if (!prepared)
        return {};
    const FileChange &change = prepared->head.change;
    if (prepared->tag == tag && file.stamp() == change.before && mJournal.holds(change.id))
        return prepared->head;
    mJournal.drop(change.id);
    return {};
}

// One for itself has nobody to share its sync with.
std::optional<HeadChange> FileChanges::findAnnounced(const CddbID3Tag &tag, const SystemFile &file)
{
    if (mToCome.size() > 1 && !mAnnounced.contains(file.path()) && mNext < mToCome.size())
        announceSome();
    return takeAnnounced(tag, file);
}

// Nothing was begun yet, so there is nothing to put right.
void FileChanges::requireUntouched(const FileChange &change)
{
    if (stampOfOrdinaryFile(change.path) == change.before)
        return;
    mJournal.drop(change.id);
    mJournal.removeCopy(change);
    notAccessible(change.path);
}

void FileChanges::performOrMend(const HeadChange &head, SystemFile &file)
{
    const FileChange &change = head.change;
    requireUntouched(change);
    try {
        performHead(head, file);
    } catch (...) {
        // The name may be there, and only its folder not be synced.
        if (mJournal.mendOne(change.id, true) != Mended::New)
            throw;
        return;
    }
    const auto after = stampOfOrdinaryFile(change.path);
    if (!after) { // gone in this moment, with its medium perhaps
        mJournal.leave(change.id);
        return;
    }
    mJournal.done(change.id, *after);
    mJournal.removeCopy(change);
}

void FileChanges::perform(const HeadChange &head, SystemFile &file)
{
    try {
        performOrMend(head, file);
    } catch (const NoWayBeside &) {
        HeadChange other = head;
        other.change.way = FileChange::Way::Through;
        tell(other, file);
        mJournal.sync();
        performOrMend(other, file);
    }
}

void FileChanges::saveTag(const CddbID3Tag &tag, const QString &path)
{
    try {
        SystemFile file = lockedToChange(realPath(path));
        auto head = findAnnounced(tag, file);
        if (!head) {
            head = planned(tag, file);
            if (!head)
                return;
            begin();
            tell(*head, file);
            mJournal.sync();
        }
        perform(*head, file);
    } catch (const Error &error) {
        if (error.Number == errFileFailed)
            notWritten(error);
        throw;
    }
}

void FileChanges::replaceHead(const QString &path, const FileStamp &stamp, const QByteArray &before,
                              const QByteArray &head)
{
    SystemFile file = lockedToChange(path);
    HeadChange change = plannedHead(file, stamp, before, head);
    begin();
    tell(change, file);
    mJournal.sync();
    perform(change, file);
}

void FileChanges::move(const QString &from, const QString &to, const std::optional<FileStamp> &over)
{
    FileChange change;
    change.way = FileChange::Way::Move;
    change.path = from;
    change.other = to;
    change.before = stampOfName(from);
    if (from == to)
        return;
    try {
        begin();
        change.batch = mBatch;
        mJournal.announce(change, {});
        mJournal.sync();
    } catch (const Error &error) {
        if (error.Number == errTagNotAccessible)
            throw;
        throw Error(errChangeNotKept, error.Source, error.Description);
    }
    try {
        moveFile(from, to, over);
    } catch (const Error &) {
        if (mJournal.mendOne(change.id, true) != Mended::New)
            throw;
        return;
    }
    mJournal.done(change.id, stampOfName(to));
    mJournal.tellDone(); // the file itself tells less of it than one with another tag
}
