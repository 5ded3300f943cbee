#include "tags/changeundo.h"

#include "platform/files/ordinaryfile.h"
#include "tags/filechanges.h"
#include "tags/movedfile.h"
#include "tags/tagerrors.h"

using namespace Qt::StringLiterals;

namespace
{

[[noreturn]] void leave(const char *key)
{
    throw Error(errTagNotWritten, u"Files"_s, errorText(key, {}));
}

} // namespace

ChangeUndo::ChangeUndo(FileJournal &journal, const FileJournal::Entries &entries, qint64 batch)
    : mJournal(journal), mEntries(entries), mBatch(batch)
{
    for (const auto &[id, entry] : mEntries) {
        if (entry.isDone)
            mByName[{withoutLinks(entry.change.path), id}] = &entry;
    }
}

// A folder may be reached through a link.
QString ChangeUndo::withoutLinks(const QString &path) const
{
    const auto name = path.lastIndexOf(u'/') + 1;
    QString &folder = mFolders[path.first(name)];
    if (folder.isEmpty())
        folder = realPath(path.first(name)) + u'/';
    return folder + path.sliced(name);
}

std::optional<int> ChangeUndo::firstPart() const
{
    std::optional<int> first;
    for (const auto &[id, entry] : mEntries) {
        if (entry.change.batch == mBatch && entry.isDone)
            first = std::min(first.value_or(entry.place.part), entry.place.part);
    }
    return first;
}

// The change of a name behind another one; nullptr: it was the last.
const FileJournal::Entry *ChangeUndo::next(const QString &path, qint64 behind) const
{
    const QString name = withoutLinks(path);
    auto found = mByName.upper_bound({name, behind});
    while (found != mByName.end() && mTakenBack.contains(found->first.second))
        ++found;
    return found != mByName.end() && found->first.first == name ? found->second : nullptr;
}

// A file that was renamed since has its new name, and one that was written anew is another one to
// the system.
ChangeUndo::Now ChangeUndo::now(const QString &path, const FileJournal::Entry &since) const
{
    Now now{path, since.after};
    for (const auto *entry = next(path, since.change.id); entry;
         entry = next(now.name, entry->change.id)) {
        now.stamp = entry->after;
        if (entry->change.way == FileChange::Way::Move)
            now.name = entry->change.other;
    }
    if (const auto touched = mTouched.find(withoutLinks(now.name)); touched != mTouched.end())
        now.stamp = touched->second;
    return now;
}

void ChangeUndo::takeBackMove(FileChanges &changes, const FileJournal::Entry &entry) const
{
    const auto [name, stamp] = now(entry.change.other, entry);
    if (!isNameTaken(name))
        leave("xUndoGone");
    if (!isStill(name, stamp))
        leave("xUndoChanged");
    try {
        changes.move(name, entry.change.path);
    } catch (const Error &error) {
        if (error.Number == errNotReplaced)
            leave("xUndoNameTaken");
        throw;
    }
}

void ChangeUndo::takeBackHead(FileChanges &changes, const FileJournal::Entry &entry)
{
    const FileChange &change = entry.change;
    const QString name = realPath(now(change.path, entry).name);
    if (!isOrdinaryFile(name))
        leave("xUndoGone");
    const auto kept = mJournal.mStore.bytes(entry.place);
    if (!kept)
        leave("xUndoForgotten");
    const SystemFile file(name, SystemFile::Mode::Read);
    const FileStamp stamp = file.stamp();
    const QByteArray head = file.read(0, change.newHead);
    if (stamp.size != change.newSize() || headChecksum(head) != change.newHeadIs)
        leave("xUndoChanged");
    QByteArray before = *kept;
    if (change.way == FileChange::Way::InPlace)
        before =
            QByteArray(head).replace(change.from, kept->size() / 2, kept->first(kept->size() / 2));
    changes.replaceHead(name, stamp, head, before);
    mTouched[name] = stampOf(name);
}

void ChangeUndo::takeBack(FileChanges &changes, const FileJournal::Entry &entry)
{
    if (entry.change.way == FileChange::Way::Move)
        takeBackMove(changes, entry);
    else
        takeBackHead(changes, entry);
}

FileJournal::Undone ChangeUndo::run(const ChangeBatch &about,
                                    const std::function<bool(int done, int all)> &step)
{
    std::vector<const FileJournal::Entry *> all;
    for (const auto &[id, entry] : mEntries) {
        if (entry.change.batch == mBatch && entry.isDone)
            all.insert(all.begin(), &entry);
    }
    FileJournal::Undone undone;
    FileChanges changes(mJournal, {about.when, about.what, about.where, mBatch});
    for (size_t i = 0; i < all.size() && step(int(i), int(all.size())); ++i) {
        const FileChange &change = all[i]->change;
        const QString before = now(change.other, *all[i]).name;
        try {
            takeBack(changes, *all[i]);
            mTakenBack.insert(change.id);
            ++undone.files;
            if (change.way == FileChange::Way::Move)
                undone.moved.emplace_back(before, change.path);
        } catch (const Error &error) {
            const bool isMove = change.way == FileChange::Way::Move;
            const QString name = (isMove ? before : now(change.path, *all[i]).name) + u": "_s;
            const bool isNamed = error.Description.startsWith(name); // by the system's own words
            undone.left.append(isNamed ? error.Description : name + error.Description);
        }
    }
    return undone;
}
