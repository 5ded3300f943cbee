#include "tags/filejournal.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "tags/changeundo.h"
#include "tags/headchange.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"

#include <QDir>
#include <QFileInfo>
#include <QScopeGuard>
#include <algorithm>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

enum class Word : quint8 {
    Numbers = 1, // behind what a part begins with: the last id and batch that were given
    Batch,
    Change, // before it happens
    Done,
    Dropped // it did not happen, or is nothing of ours any more
};

constexpr int toldAtOnce = 100;
constexpr qint64 unknownNumbers = qint64(1) << 32; // more than a part has

template <typename... Values> QByteArray words(Word word, const Values &...values)
{
    QByteArray bytes;
    QDataStream out(&bytes, QIODevice::WriteOnly);
    out.setVersion(QDataStream::Qt_6_0);
    out << quint8(word);
    (out << ... << values);
    return bytes;
}

} // namespace

FileJournal::FileJournal(const QString &folder, JournalSizes sizes) : mStore(folder, sizes) {}

void FileJournal::take(Read &into, const QByteArray &entry, const JournalStore::Place &place)
{
    QDataStream in(entry);
    in.setVersion(QDataStream::Qt_6_0);
    quint8 word = 0;
    qint64 id = 0;
    in >> word;
    switch (Word(word)) {
    case Word::Batch: {
        ChangeBatch batch;
        in >> batch;
        // It is told again where a part begins.
        if (into.numbers.insert(batch.number).second)
            into.batches.push_back(batch);
        break;
    }
    case Word::Change: {
        FileChange change;
        in >> change;
        into.entries[change.id] = {change, place, false, {}};
        break;
    }
    case Word::Done: {
        FileStamp after;
        in >> id >> after;
        if (const auto entry = into.entries.find(id); entry != into.entries.end()) {
            entry->second.isDone = true;
            entry->second.after = after;
        }
        break;
    }
    case Word::Dropped:
        in >> id;
        into.entries.erase(id);
        break;
    case Word::Numbers:
        break;
    }
}

// Two processes in one folder would write over each other's entries. Where the file system knows no
// locks there is none.
void FileJournal::requireOwn()
{
    const QString name = mStore.folder() + "/lock"_L1;
    if (mLock.isOf(name))
        return;
    mLock = FileLock(); // of a folder that has gone
    if (mLock.takeWithin(name, 0) == FileLock::Outcome::Held)
        throw makeError(errFileFailed, name);
}

// The last part alone is read: what is not done is told again where a part begins. Unless that was
// cut off, or is damaged.
void FileJournal::open()
{
    if (mIsOpen)
        return;
    Read read;
    bool hasNumbers = false;
    const auto take = [&](const QByteArray &entry, const JournalStore::Place &place) {
        QDataStream in(entry);
        in.setVersion(QDataStream::Qt_6_0);
        quint8 word = 0;
        qint64 id = 0, batch = 0;
        in >> word;
        if (Word(word) == Word::Numbers) {
            in >> id >> batch;
            hasNumbers = true;
        }
        FileJournal::take(read, entry, place);
        if (!read.entries.empty()) {
            const FileChange &last = read.entries.rbegin()->second.change;
            id = std::max(id, last.id);
            batch = std::max(batch, last.batch);
        }
        mLastId = std::max(mLastId, id);
        mLastBatch = std::max(mLastBatch, batch);
    };
    const bool isLastWhole = mStore.openLast(take);
    mIsReadWhole = (hasNumbers && isLastWhole) || mStore.readAll(take);
    if (!read.numbers.empty())
        mLastBatch = std::max(mLastBatch, *read.numbers.rbegin());
    if (!mIsReadWhole) { // nobody knows which were given
        mLastId += unknownNumbers;
        mLastBatch += unknownNumbers;
    }
    std::erase_if(read.entries, [](const auto &entry) { return entry.second.isDone; });
    mPending = std::move(read.entries);
    for (auto &[id, entry] : mPending) { // the folder may have had another name
        if (entry.change.way == FileChange::Way::Through)
            entry.change.other = mStore.folder() + u'/' + QFileInfo(entry.change.other).fileName();
    }
    mIsOpen = true;
    if (mIsReadWhole)
        removeForgottenCopies();
}

// What is done counts, told or not.
FileJournal::Read FileJournal::readAll() const
{
    Read read;
    mStore.readAll([&](const QByteArray &entry, const JournalStore::Place &place) {
        take(read, entry, place);
    });
    for (const auto &[id, entry] : mPending) {
        if (const auto found = read.entries.find(id); entry.isDone && found != read.entries.end())
            found->second = entry;
    }
    return read;
}

std::vector<FileJournal::Batch> FileJournal::batches() const
{
    const Read read = readAll();
    std::map<qint64, int> files;
    std::map<qint64, QString> first;
    for (const auto &[id, entry] : read.entries) {
        files[entry.change.batch] += entry.isDone ? 1 : 0;
        if (entry.isDone)
            first.try_emplace(entry.change.batch, entry.change.path);
    }
    std::vector<Batch> all;
    for (auto each = read.batches.rbegin(); each != read.batches.rend(); ++each) {
        if (files[each->number] > 0)
            all.push_back({*each, files[each->number], first[each->number]});
    }
    std::map<qint64, Batch *> byNumber;
    for (Batch &batch : all)
        byNumber[batch.number] = &batch;
    // The newest first: one that was taken back itself takes nothing back.
    for (const Batch &batch : all) {
        const auto undone = byNumber.find(batch.undoes);
        if (!batch.isTakenBack && undone != byNumber.end())
            undone->second->isTakenBack = true;
    }
    return all;
}

// Not while a command is at something: what it has told would be told again.
void FileJournal::makeRoom()
{
    const bool isLive = std::any_of(mPending.begin(), mPending.end(), [](const auto &entry) {
        return entry.second.isLive && !entry.second.isDone;
    });
    if (mStore.mustBegin() || (mStore.isFull() && !isLive))
        beginPart();
}

// The next part begins with what is not done, so that it is found there; the one before must tell
// what is. The numbers come last: a part that has them is whole in that.
void FileJournal::beginPart()
{
    if (!mStore.mustBegin()) {
        const Entries before = mPending;
        writeDone();
        try {
            mStore.sync();
        } catch (const Error &) {
            mPending = before;
        }
    }
    std::map<qint64, QByteArray> kept;
    for (const auto &[id, entry] : mPending) {
        if (auto bytes = mStore.bytes(entry.place))
            kept[id] = *bytes;
    }
    std::erase_if(mPending, [&](const auto &entry) { return !kept.contains(entry.first); });
    mStore.beginPart();
    for (const auto &[number, batch] : mBegun)
        mStore.append(words(Word::Batch, batch));
    for (const auto &[id, bytes] : kept)
        mPending[id].place = mStore.append(words(Word::Change, mPending[id].change), bytes);
    writeDone();
    if (mIsReadWhole)
        mStore.append(words(Word::Numbers, mLastId, mLastBatch));
    mStore.sync();
    mStore.begun();
}

qint64 FileJournal::beginBatch(ChangeBatch batch)
{
    requireOwn();
    mend();
    makeRoom();
    requireOwn(); // the folder may be new
    batch.number = ++mLastBatch;
    mStore.append(words(Word::Batch, batch));
    mBegun[batch.number] = batch;
    return batch.number;
}

void FileJournal::endBatch(qint64 number)
{
    tellDone();
    for (auto &[id, entry] : mPending)
        entry.isLive = entry.isLive && entry.change.batch != number;
    mBegun.erase(number);
}

// What follows a change of the same file says that it has happened: the journal must tell it first.
// One that could not be put right yet stands in the way.
void FileJournal::announce(FileChange &change, const QByteArray &kept)
{
    bool isDone = false;
    for (const auto &[id, entry] : mPending) {
        const bool isOfSameFile = entry.after.isSameFile(change.before) ||
                                  entry.change.before.isSameFile(change.before) ||
                                  entry.change.path == change.path ||
                                  entry.change.other == change.path;
        isDone = isDone || (isOfSameFile && entry.isDone);
        if (isOfSameFile && !entry.isDone && !entry.isLive)
            throw tagError(errTagNotAccessible, "xTagNotAccessible", change.path);
    }
    if (isDone)
        tellDone();
    makeRoom();
    change.id = ++mLastId;
    const auto place = mStore.append(words(Word::Change, change), kept);
    mPending[change.id] = {change, place, false, {}, true};
}

// Not where the folder of the journal has gone since.
bool FileJournal::holds(qint64 id) const
{
    return mPending.contains(id) && !mStore.mustBegin();
}

void FileJournal::done(qint64 id, const FileStamp &after)
{
    const auto found = mPending.find(id);
    if (found == mPending.end())
        return;
    found->second.isDone = true;
    found->second.after = after;
    if (++mUntold >= toldAtOnce)
        tellDone();
}

// Nothing is lost where the journal cannot be told: the files themselves tell at the next look.
void FileJournal::tellDone()
{
    if (mUntold == 0)
        return;
    try {
        makeRoom();
        writeDone();
    } catch (const Error &) {
    }
}

void FileJournal::writeDone()
{
    std::vector<QByteArray> told;
    for (const auto &[id, entry] : mPending) {
        if (entry.isDone)
            told.push_back(words(Word::Done, id, entry.after));
    }
    if (told.empty())
        return;
    mStore.append(told);
    mUntold = 0;
    std::erase_if(mPending, [](const auto &entry) { return entry.second.isDone; });
}

void FileJournal::drop(qint64 id)
{
    leave(id);
    try {
        makeRoom();
        mStore.append(words(Word::Dropped, id));
        mPending.erase(id);
    } catch (const Error &) {
    }
}

void FileJournal::leave(qint64 id)
{
    if (const auto found = mPending.find(id); found != mPending.end())
        found->second.isLive = false;
}

QString FileJournal::copyName()
{
    return mStore.folder() + "/copy-"_L1 + QString::number(mLastId + 1) + u'-' +
           QString::number(::getpid());
}

Mended FileJournal::mendOne(qint64 id, bool back)
{
    const auto found = mPending.find(id);
    if (found == mPending.end())
        return Mended::NotNow;
    const FileChange change = found->second.change;
    const auto kept = mStore.bytes(found->second.place);
    if (change.way == FileChange::Way::InPlace && !kept) {
        drop(id); // was not synced, so nothing was begun
        return Mended::Old;
    }
    const Mended end = change.way == FileChange::Way::Move
                           ? mendMove(change)
                           : mendHead(change, kept.value_or(QByteArray()), back);
    switch (end) {
    case Mended::New:
        done(id, change.way == FileChange::Way::Move ? stampOfName(change.other)
                                                     : stampOf(change.path));
        break;
    case Mended::Old:
    case Mended::Foreign:
        drop(id);
        break;
    case Mended::NotNow:
        leave(id);
        break;
    }
    if (end != Mended::NotNow)
        removeCopy(change);
    return end;
}

// Not before the disk knows that it is not needed any more: it can be the only place with all of
// the sound.
void FileJournal::removeCopy(const FileChange &change)
{
    if (change.way != FileChange::Way::Through)
        return;
    tellDone();
    if (mPending.contains(change.id))
        return;
    try {
        mStore.sync();
        QFile::remove(change.other);
    } catch (const Error &) { // at the next start
    }
}

// A program that ended had made them, and not told the journal yet.
void FileJournal::removeForgottenCopies() const
{
    QDir folder(mStore.folder());
    for (const QString &name : folder.entryList({u"copy-*"_s}, QDir::Files)) {
        const QString copy = folder.filePath(name);
        if (std::none_of(mPending.begin(), mPending.end(),
                         [&](const auto &entry) { return entry.second.change.other == copy; }))
            folder.remove(name);
    }
}

void FileJournal::mend()
{
    try {
        requireOwn();
    } catch (const Error &) { // whose they are now
        return;
    }
    open();
    std::vector<qint64> ids;
    for (const auto &[id, entry] : mPending) {
        if (!entry.isDone && !entry.isLive)
            ids.push_back(id);
    }
    std::reverse(ids.begin(), ids.end());
    for (const qint64 id : ids) {
        try {
            mendOne(id, false);
        } catch (const Error &) { // at the next look
        }
    }
    tellDone();
}

FileJournal::Undone FileJournal::undo(qint64 batch, const QDateTime &when, const QString &what,
                                      const std::function<bool(int done, int all)> &step)
{
    mend();
    const Read read = readAll();
    ChangeUndo undo(*this, read.entries, batch);
    const auto found = std::find_if(read.batches.begin(), read.batches.end(),
                                    [batch](const ChangeBatch &b) { return b.number == batch; });
    const QString where = found == read.batches.end() ? QString() : found->where;
    mStore.keepFrom(undo.firstPart());
    const auto free = qScopeGuard([this] { mStore.keepFrom({}); });
    return undo.run({0, when, what, where, batch}, step);
}
