#include "tags/filejournal.h"

#include "platform/error/error.h"
#include "platform/files/nativename.h"
#include "tags/changeundo.h"
#include "tags/headchange.h"
#include "tags/movedfile.h"

#include <QDir>
#include <QFileInfo>
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
        if (into.batches.empty() || into.batches.back().number != batch.number)
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

// The last part alone is read: what is not done is told again where a part begins. Unless that was
// cut off.
void FileJournal::open()
{
    if (mIsOpen)
        return;
    Read read;
    bool isWhole = false;
    const auto take = [&](const QByteArray &entry, const JournalStore::Place &place) {
        QDataStream in(entry);
        in.setVersion(QDataStream::Qt_6_0);
        quint8 word = 0;
        in >> word;
        if (Word(word) == Word::Numbers) {
            in >> mLastId >> mLastBatch;
            isWhole = true;
        }
        FileJournal::take(read, entry, place);
        if (!read.entries.empty())
            mLastId = std::max(mLastId, read.entries.rbegin()->first);
    };
    mStore.openLast(take);
    if (!isWhole)
        mStore.readAll(take);
    for (const ChangeBatch &batch : read.batches)
        mLastBatch = std::max(mLastBatch, batch.number);
    std::erase_if(read.entries, [](const auto &entry) { return entry.second.isDone; });
    mPending = std::move(read.entries);
    mIsOpen = true;
    removeForgottenCopies();
}

FileJournal::Read FileJournal::readAll() const
{
    Read read;
    mStore.readAll([&](const QByteArray &entry, const JournalStore::Place &place) {
        take(read, entry, place);
    });
    return read;
}

std::vector<FileJournal::Batch> FileJournal::batches() const
{
    const Read read = readAll();
    std::map<qint64, int> files;
    for (const auto &[id, entry] : read.entries)
        files[entry.change.batch] += entry.isDone ? 1 : 0;
    std::vector<Batch> all;
    for (auto each = read.batches.rbegin(); each != read.batches.rend(); ++each) {
        if (files[each->number] > 0)
            all.push_back({*each, files[each->number]});
    }
    // The newest first: one that was taken back itself takes nothing back.
    for (auto batch = all.begin(); batch != all.end(); ++batch) {
        for (auto other = batch; !batch->isTakenBack && other != all.end(); ++other)
            other->isTakenBack |= batch->undoes != 0 && other->number == batch->undoes;
    }
    return all;
}

// Where a part is full: the next one begins with what is not done, so that it is found there. The
// numbers come last: a part that has them is whole in that.
void FileJournal::makeRoom()
{
    if (!mStore.isPartFull())
        return;
    tellDone();
    std::vector<std::pair<qint64, QByteArray>> kept;
    for (const auto &[id, entry] : mPending)
        kept.emplace_back(id, mStore.bytes(entry.place).value_or(QByteArray()));
    mStore.beginPart();
    if (mBatch.number > 0)
        mStore.append(words(Word::Batch, mBatch));
    for (const auto &[id, bytes] : kept)
        mPending[id].place = mStore.append(words(Word::Change, mPending[id].change), bytes);
    mStore.append(words(Word::Numbers, mLastId, mLastBatch));
    mStore.sync();
}

qint64 FileJournal::beginBatch(ChangeBatch batch)
{
    open();
    mend();
    makeRoom();
    batch.number = ++mLastBatch;
    mBatch = batch;
    mStore.append(words(Word::Batch, mBatch));
    return mBatch.number;
}

void FileJournal::announce(FileChange &change, const QByteArray &kept)
{
    makeRoom();
    change.id = ++mLastId;
    change.batch = mBatch.number;
    mPending[change.id] = {change, mStore.append(words(Word::Change, change), kept), false, {}};
}

void FileJournal::done(qint64 id, const FileStamp &after)
{
    Entry &entry = mPending[id];
    entry.isDone = true;
    entry.after = after;
    if (++mUntold >= toldAtOnce)
        tellDone();
}

// Nothing is lost where the journal cannot be told: the files themselves tell at the next look.
void FileJournal::tellDone()
{
    std::vector<QByteArray> told;
    for (const auto &[id, entry] : mPending) {
        if (entry.isDone)
            told.push_back(words(Word::Done, id, entry.after));
    }
    mUntold = 0;
    if (told.empty())
        return;
    try {
        mStore.append(told);
        std::erase_if(mPending, [](const auto &entry) { return entry.second.isDone; });
    } catch (const Error &) {
    }
}

void FileJournal::drop(qint64 id)
{
    try {
        makeRoom();
        mStore.append(words(Word::Dropped, id));
        mPending.erase(id);
    } catch (const Error &) {
    }
}

QString FileJournal::copyName()
{
    return mStore.folder() + "/copy-"_L1 + QString::number(mLastId + 1) + u'-' +
           QString::number(::getpid());
}

Mended FileJournal::mendOne(qint64 id, bool back)
{
    const FileChange change = mPending[id].change;
    const auto kept = mStore.bytes(mPending[id].place);
    if (change.way == FileChange::Way::InPlace && !kept) {
        drop(id); // was not synced, so nothing was begun
        return Mended::Old;
    }
    const Mended end = change.way == FileChange::Way::Move
                           ? mendMove(change)
                           : mendHead(change, kept.value_or(QByteArray()), back);
    switch (end) {
    case Mended::New:
        done(id, stampOf(change.way == FileChange::Way::Move ? change.other : change.path));
        break;
    case Mended::Old:
    case Mended::Foreign:
        drop(id);
        break;
    case Mended::NotNow:
        break;
    }
    return end;
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
    open();
    std::vector<qint64> ids;
    for (const auto &[id, entry] : mPending) {
        if (!entry.isDone)
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
    const Read read = readAll();
    ChangeUndo undo(*this, read.entries, batch);
    const auto found = std::find_if(read.batches.begin(), read.batches.end(),
                                    [batch](const ChangeBatch &b) { return b.number == batch; });
    const QString where = found == read.batches.end() ? QString() : found->where;
    return undo.run({0, when, what, where, batch}, step);
}
