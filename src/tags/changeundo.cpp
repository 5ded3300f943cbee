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

// A file that was renamed since has its new name.
QString ChangeUndo::nowAt(const QString &path, qint64 sinceId) const
{
    QString name = path;
    for (auto entry = mEntries.upper_bound(sinceId); entry != mEntries.end(); ++entry) {
        const FileChange &change = entry->second.change;
        if (change.way == FileChange::Way::Move && entry->second.isDone && change.path == name)
            name = change.other;
    }
    return name;
}

void ChangeUndo::takeBackMove(FileChanges &changes, const FileJournal::Entry &entry) const
{
    const QString now = nowAt(entry.change.other, entry.change.id);
    if (!isNameTaken(now))
        leave("xUndoGone");
    if (!stampOfName(now).isSameFile(entry.change.before))
        leave("xUndoChanged");
    if (isNameTaken(entry.change.path) &&
        !stampOfName(entry.change.path).isSameFile(entry.change.before))
        leave("xUndoNameTaken");
    changes.move(now, entry.change.path);
}

void ChangeUndo::takeBackHead(FileChanges &changes, const FileJournal::Entry &entry) const
{
    const FileChange &change = entry.change;
    const QString now = realPath(nowAt(change.path, change.id));
    if (!isOrdinaryFile(now))
        leave("xUndoGone");
    const auto kept = mJournal.mStore.bytes(entry.place);
    if (!kept)
        leave("xUndoForgotten");
    const SystemFile file(now, SystemFile::Mode::Read);
    QByteArray head = file.read(0, change.newHead);
    if (file.size() != change.newSize() || headChecksum(head) != change.newHeadIs)
        leave("xUndoChanged");
    QByteArray before = *kept;
    if (change.way == FileChange::Way::InPlace)
        before =
            QByteArray(head).replace(change.from, kept->size() / 2, kept->first(kept->size() / 2));
    changes.replaceHead(now, head, before);
}

void ChangeUndo::takeBack(FileChanges &changes, const FileJournal::Entry &entry) const
{
    if (entry.change.way == FileChange::Way::Move)
        takeBackMove(changes, entry);
    else
        takeBackHead(changes, entry);
}

FileJournal::Undone ChangeUndo::run(ChangeBatch about,
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
        const QString now = nowAt(change.other, change.id);
        try {
            takeBack(changes, *all[i]);
            ++undone.files;
            if (change.way == FileChange::Way::Move)
                undone.moved.emplace_back(now, change.path);
        } catch (const Error &error) {
            undone.left.append(nowAt(all[i]->change.path, all[i]->change.id) + u": "_s +
                               error.Description);
        }
    }
    return undone;
}
