#include "tags/filechanges.h"

#include "platform/files/filelock.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"
#include "tags/tagfile.h"
#include "tags/tagsplicer.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr size_t announcedAtOnce = 100;
constexpr qint64 bytesAtOnce = 32 << 20;

[[noreturn]] void notAccessible(const QString &path)
{
    throw tagError(errTagNotAccessible, "xTagNotAccessible", path);
}

// Failures of the disk keep their words.
[[noreturn]] void notWritten(const Error &error)
{
    throw tagError(errTagNotWritten, "xTagNotWritten", error.Description);
}

FileLock lockOf(const QString &path)
{
    FileLock lock;
    if (lock.take(path) != FileLock::Outcome::Taken)
        notAccessible(path);
    return lock;
}

} // namespace

FileChanges::FileChanges(FileJournal &journal, About about)
    : mJournal(journal), mAbout(std::move(about))
{
}

FileChanges::~FileChanges()
{
    forgetAnnounced();
}

// A command that changes nothing leaves no batch.
void FileChanges::begin()
{
    if (!mBegun)
        mJournal.beginBatch({0, mAbout.when, mAbout.what, mAbout.where, mAbout.undoes});
    mBegun = true;
}

std::optional<HeadChange> FileChanges::planned(const CddbID3Tag &tag, const QString &path) const
{
    if (!isWritable(path))
        notAccessible(path);
    const SystemFile file(path, SystemFile::Mode::Read);
    const FileTag there = readTag(file);
    if (asRead(tag, there.fields) == there.fields)
        return {};
    if (!there.isWhole)
        throw tagError(errTagDamaged, "xTagDamaged", path);
    const SplicedTag spliced = splicedTag(there.bytes, there.fields, tag);
    HeadChange head = plannedHead(file, there.bytes, spliced.bytes);
    return head;
}

// The names of the files beside and of the copies are told before they are made.
void FileChanges::tell(HeadChange &head)
{
    FileChange &change = head.change;
    if (change.way == FileChange::Way::Beside)
        change.other = QFileInfo(change.path).path() + "/.songcase-"_L1 +
                       mJournal.copyName().section(u'-', -2) + ".tmp"_L1;
    if (change.way == FileChange::Way::Through) {
        change.other = mJournal.copyName();
        prepareHead(head, SystemFile(change.path, SystemFile::Mode::Read));
    }
    mJournal.announce(change, head.kept());
}

void FileChanges::announce(const Tags &tags)
{
    mToCome = tags;
    mNext = 0;
    announceSome();
}

void FileChanges::announceOne(const CddbID3Tag &tag, const QString &path)
{
    const QString real = realPath(path);
    auto head = planned(tag, real);
    // A copy of a whole file is not made before its turn.
    if (!head || head->change.way == FileChange::Way::Through || mAnnounced.contains(real))
        return;
    begin();
    tell(*head);
    mAnnounced.insert_or_assign(real, Prepared{*head, tag});
}

void FileChanges::announceSome()
{
    qint64 bytes = 0;
    const size_t end = std::min(mToCome.size(), mNext + announcedAtOnce);
    for (; mNext < end && bytes < bytesAtOnce; ++mNext) {
        const auto &[path, tag] = mToCome[mNext];
        try {
            announceOne(tag, path);
        } catch (const Error &) { // told at its turn
        }
        if (const auto found = mAnnounced.find(realPath(path)); found != mAnnounced.end())
            bytes += found->second.head.kept().size();
    }
    try {
        mJournal.sync();
    } catch (const Error &) { // each save for itself tells what is wrong
        forgetAnnounced();
    }
}

void FileChanges::forgetAnnounced()
{
    for (const auto &[path, prepared] : mAnnounced)
        mJournal.drop(prepared.head.change.id);
    mAnnounced.clear();
}

std::optional<HeadChange> FileChanges::takeAnnounced(const CddbID3Tag &tag, const QString &path)
{
    const auto found = mAnnounced.find(path);
    if (found == mAnnounced.end())
        return {};
    const Prepared prepared = std::move(found->second);
    mAnnounced.erase(found);
    if (prepared.tag == tag && isWritable(path) && stampOf(path) == prepared.head.change.before)
        return prepared.head;
    mJournal.drop(prepared.head.change.id);
    return {};
}

std::optional<HeadChange> FileChanges::findAnnounced(const CddbID3Tag &tag, const QString &path)
{
    if (!mAnnounced.contains(path) && mNext < mToCome.size())
        announceSome();
    return takeAnnounced(tag, path);
}

void FileChanges::performOrMend(const HeadChange &head)
{
    const FileChange &change = head.change;
    try {
        SystemFile file(change.path, SystemFile::Mode::Write);
        if (file.stamp() != change.before)
            notAccessible(change.path);
        performHead(head, file);
    } catch (...) {
        // The name may be there, and only its folder not be synced.
        if (mJournal.mendOne(change.id, true) != Mended::New)
            throw;
        return;
    }
    mJournal.done(change.id, stampOf(change.path));
    if (change.way == FileChange::Way::Through)
        QFile::remove(change.other);
}

void FileChanges::perform(const HeadChange &head)
{
    try {
        performOrMend(head);
    } catch (const NoWayBeside &) {
        HeadChange other = head;
        other.change.way = FileChange::Way::Through;
        tell(other);
        mJournal.sync();
        performOrMend(other);
    }
}

void FileChanges::saveTag(const CddbID3Tag &tag, const QString &path)
{
    const QString real = realPath(path);
    try {
        const FileLock lock = lockOf(real);
        auto head = findAnnounced(tag, real);
        if (!head) {
            head = planned(tag, real);
            if (!head)
                return;
            begin();
            tell(*head);
            mJournal.sync();
        }
        perform(*head);
    } catch (const Error &error) {
        if (error.Number == errFileFailed)
            notWritten(error);
        throw;
    }
}

void FileChanges::replaceHead(const QString &path, const QByteArray &before, const QByteArray &head)
{
    if (!isWritable(path))
        notAccessible(path);
    const FileLock lock = lockOf(path);
    HeadChange change = plannedHead(SystemFile(path, SystemFile::Mode::Read), before, head);
    begin();
    tell(change);
    mJournal.sync();
    perform(change);
}

void FileChanges::move(const QString &from, const QString &to)
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
        mJournal.announce(change, {});
        mJournal.sync();
    } catch (const Error &error) {
        throw Error(errChangeNotKept, error.Source, error.Description);
    }
    try {
        moveFile(from, to);
    } catch (const Error &) {
        if (mJournal.mendOne(change.id, true) != Mended::New)
            throw;
        return;
    }
    mJournal.done(change.id, stampOfName(to));
}
