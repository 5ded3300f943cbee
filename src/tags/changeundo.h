#pragma once

#include "tags/filejournal.h"

class FileChanges;

/// Takes the changes of one batch back, the last first.
class ChangeUndo
{
public:
    ChangeUndo(FileJournal &journal, const FileJournal::Entries &entries, qint64 batch)
        : mJournal(journal), mEntries(entries), mBatch(batch)
    {
    }
    FileJournal::Undone run(ChangeBatch about, const std::function<bool(int done, int all)> &step);

private:
    QString nowAt(const QString &path, qint64 sinceId) const;
    void takeBack(FileChanges &changes, const FileJournal::Entry &entry) const;
    void takeBackMove(FileChanges &changes, const FileJournal::Entry &entry) const;
    void takeBackHead(FileChanges &changes, const FileJournal::Entry &entry) const;

    FileJournal &mJournal;
    const FileJournal::Entries &mEntries;
    const qint64 mBatch;
};
