#pragma once

#include "tags/filejournal.h"

#include <QHash>
#include <set>

class FileChanges;

/// Takes the changes of one batch back, the last first.
class ChangeUndo
{
public:
    ChangeUndo(FileJournal &journal, const FileJournal::Entries &entries, qint64 batch);
    FileJournal::Undone run(const ChangeBatch &about,
                            const std::function<bool(int done, int all)> &step);
    std::optional<int> firstPart() const; // of the journal, with what it needs

private:
    struct Now {
        QString name;
        FileStamp stamp; // as the journal knows it
    };
    QString withoutLinks(const QString &path) const;
    const FileJournal::Entry *next(const QString &path, qint64 behind) const;
    Now now(const QString &path, const FileJournal::Entry &since) const;
    void takeBack(FileChanges &changes, const FileJournal::Entry &entry);
    void takeBackMove(FileChanges &changes, const FileJournal::Entry &entry) const;
    void takeBackHead(FileChanges &changes, const FileJournal::Entry &entry);

    FileJournal &mJournal;
    const FileJournal::Entries &mEntries;
    const qint64 mBatch;
    mutable QHash<QString, QString> mFolders;                                 // without links
    std::map<std::pair<QString, qint64>, const FileJournal::Entry *> mByName; // and id
    std::map<QString, FileStamp> mTouched;                                    // by this undo
    std::set<qint64> mTakenBack;                                              // the same
};
