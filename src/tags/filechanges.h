#pragma once

#include "tags/CddbID3Tag.h"
#include "tags/filejournal.h"
#include "tags/headchange.h"

/// The changes of one command of the user in files: one batch of the journal, one undo takes it
/// back. Each is whole or has not happened.
class FileChanges
{
public:
    struct About {
        QDateTime when;
        QString what, where; // as in ChangeBatch
        qint64 undoes = 0;   // the batch that is taken back
    };

    FileChanges(FileJournal &journal, About about);
    ~FileChanges(); // what was announced and not saved is forgotten
    FileChanges(const FileChanges &) = delete;
    FileChanges &operator=(const FileChanges &) = delete;

    /// Before many saves, in their order: what stands in the files now goes into the journal with
    /// one sync for a hundred, not one each. A save that this does not cover (another tag, the file
    /// written since) does it itself.
    using Tags = std::vector<std::pair<QString, CddbID3Tag>>; // path, tag
    void announce(const Tags &tags);

    /// Writes the fields that differ from what the file's tag says now; all else in the file stays
    /// as it is. Throws Error: errTagNotAccessible, errTagDamaged, errTagTooLong, errTagNotWritten.
    void saveTag(const CddbID3Tag &tag, const QString &path);

    /// Gives a file another name; as moveFile(), and throws errChangeNotKept too.
    void move(const QString &from, const QString &to, const std::optional<FileStamp> &over = {});

    /// Gives a file another beginning, `before` being what it began with when it was as `stamp`
    /// says.
    void replaceHead(const QString &path, const FileStamp &stamp, const QByteArray &before,
                     const QByteArray &head);

private:
    struct Prepared {
        HeadChange head;
        CddbID3Tag tag;
    };

    void begin();
    static std::optional<HeadChange> planned(const CddbID3Tag &tag, const SystemFile &file);
    void tell(HeadChange &head, const SystemFile &file);
    void requireUntouched(const FileChange &change);
    void perform(const HeadChange &head, SystemFile &file);
    void performOrMend(const HeadChange &head, SystemFile &file);
    void announceSome();
    void forgetAnnounced();
    qint64 announceOne(const CddbID3Tag &tag, const QString &path);
    std::optional<HeadChange> takeAnnounced(const CddbID3Tag &tag, const SystemFile &file);
    std::optional<HeadChange> findAnnounced(const CddbID3Tag &tag, const SystemFile &file);

    FileJournal &mJournal;
    const About mAbout;
    qint64 mBatch = 0; // 0: not begun
    // By path without links; nothing: looked at, and not told to the journal.
    std::map<QString, std::optional<Prepared>> mAnnounced;
    Tags mToCome; // those from mNext on are not looked at yet
    size_t mNext = 0;
};
