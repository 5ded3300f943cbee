#pragma once

#include "platform/files/systemfile.h"

#include <functional>
#include <map>
#include <optional>
#include <vector>

struct JournalSizes {
    qint64 part = 4 << 20;  // bytes of a file before the next one begins
    qint64 all = 200 << 20; // bytes of all before the oldest goes
};

/// Entries one behind the other in files of a folder, "changes-1" and on: some words about each,
/// and bytes. What was synced is read again after any end of the program; an entry that was cut
/// off or damaged is not there. Only what an entry says is read to find it, not its bytes. Throws
/// Error (errFileFailed) where the disk fails.
class JournalStore
{
public:
    struct Place {
        int part = 0; // the number of the file
        qint64 at = 0;
        qint64 size = 0; // of the bytes
    };
    explicit JournalStore(QString folder, JournalSizes sizes = {});

    QString folder() const { return mFolder; }

    /// Tells what the entries of the last file say, oldest first. To be called before an append.
    /// False: it could not be read, or not all of it.
    using Reader = std::function<void(const QByteArray &words, const Place &place)>;
    bool openLast(const Reader &reader);

    /// The same of all files.
    bool readAll(const Reader &reader) const;

    Place append(const QByteArray &words, const QByteArray &bytes = {});
    void append(const std::vector<QByteArray> &words); // with one write
    void sync();

    /// Nothing where they are gone, or are not those that were written.
    std::optional<QByteArray> bytes(const Place &place) const;

    /// Whether the next entry has to begin a file: there is none, it is gone, or it is not to be
    /// trusted any more.
    bool mustBegin() const;

    /// Whether it should: so much is in it, behind what it began with.
    bool isFull() const;

    /// Begins a file. What is appended until begun() it begins with; then the oldest may go.
    void beginPart();
    void begun();

    /// This file and those behind it do not go for want of room, as long as they are needed.
    void keepFrom(std::optional<int> part) { mKeptFrom = part; }

private:
    QString nameOf(int part) const;
    int lastNumber() const;
    std::map<int, qint64> parts() const; // sizes by number
    enum class Condition { Whole, CutOff, Damaged };
    Condition readPart(int part, const Reader &reader) const;
    void write(const QByteArray &entries);

    const QString mFolder;
    const JournalSizes mSizes;
    std::optional<SystemFile> mFile;
    int mPart = 0;
    qint64 mEnd = 0, mBeginning = 0;
    std::optional<int> mKeptFrom;
    bool mIsDoubtful = false; // not read whole, or a sync has failed
};
