#pragma once

#include <QSaveFile>

/// A file that is written whole or not at all: what has its name keeps it until all of the new one
/// is on the disk. Every file of the program that is not the catalogue is written with it. A
/// writer need not look at the result of each write: one that fell short makes the end fail.
class WholeFile : public QSaveFile
{
public:
    using QSaveFile::QSaveFile;

    /// Gives the file its name; when it returns true, content and name outlive a power cut. After
    /// false nothing has changed, unless only the folder could not be synced.
    bool commit();

    /// What has gone wrong first, in the words of the system; what comes later would hide it.
    QString reason() const { return mReason; }

protected:
    qint64 writeData(const char *data, qint64 size) override;

private:
    bool reachesTheDisk();

    QString mReason;
};

/// Writes the names in a folder through to the disk. A system that knows no such thing for folders
/// has nothing to fail at.
bool syncFolder(const QString &folder);
