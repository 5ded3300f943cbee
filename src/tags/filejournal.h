#pragma once

#include "platform/files/filelock.h"
#include "tags/headchange.h"
#include "tags/journalstore.h"

#include <functional>
#include <map>
#include <set>
#include <vector>

/// What the program has changed in files of the user, kept in a folder of its own from before a
/// byte changes: it puts right what a crash has left, and takes changes back. By batch: one command
/// of the user. The oldest go when there are more than 200 MB.
class FileJournal
{
public:
    explicit FileJournal(const QString &folder, JournalSizes sizes = {});

    struct Batch : ChangeBatch {
        int files = 0;            // that were changed
        QString first;            // path of the one that was changed first, as it was then
        bool isTakenBack = false; // by a later one that was not taken back itself
    };
    std::vector<Batch> batches() const; // newest first

    struct Undone {
        int files = 0;
        QStringList left; // "path: why" of those that were left as they are
        std::vector<std::pair<QString, QString>> moved; // names before it and behind it
    };
    /// Takes the changes of a batch back, the last first, as a batch of its own. A file that
    /// something else has changed since is left. `step` is told how far it is and ends it with
    /// false.
    Undone undo(qint64 batch, const QDateTime &when, const QString &what,
                const std::function<bool(int done, int all)> &step);

    /// Puts right what a crash, or a medium that was taken away, has left. At the start of the
    /// program, and before files are changed; next to nothing to do where nothing is left, and
    /// nothing where another process has the journal.
    void mend();

private:
    friend class FileChanges;
    friend class ChangeUndo;

    struct Entry {
        FileChange change;
        JournalStore::Place place;
        bool isDone = false;
        FileStamp after;
        bool isLive = false; // a command of this run is at it
    };
    using Entries = std::map<qint64, Entry>; // by id
    struct Read {
        std::vector<ChangeBatch> batches;
        std::set<qint64> numbers; // of those
        Entries entries;          // those that were dropped left out
    };

    void open();
    Read readAll() const;
    static void take(Read &into, const QByteArray &words, const JournalStore::Place &place);

    // Several can be begun at a time.
    qint64 beginBatch(ChangeBatch batch);
    void endBatch(qint64 number);
    void announce(FileChange &change, const QByteArray &kept); // gives it its id
    bool holds(qint64 id) const;
    void sync() { mStore.sync(); }
    void done(qint64 id, const FileStamp &after);
    void tellDone(); // the journal; after a crash before that mend() finds it out
    void drop(qint64 id);
    void leave(qint64 id); // to the next mend()
    Mended mendOne(qint64 id, bool back);
    void removeForgottenCopies() const;
    void removeCopy(const FileChange &change);
    QString copyName(); // of a Through
    void makeRoom();
    void beginPart();
    void writeDone();
    void requireOwn();

    JournalStore mStore;
    FileLock mLock;
    Entries mPending; // announced, neither dropped nor told to be done
    int mUntold = 0;
    std::map<qint64, ChangeBatch> mBegun; // by number
    qint64 mLastId = 0, mLastBatch = 0;
    bool mIsOpen = false, mIsReadWhole = false;
};
