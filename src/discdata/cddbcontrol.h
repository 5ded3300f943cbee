#pragma once

#include "discdata/cddbobjects.h"
#include "discdata/cddbuserprofile.h"
#include "discdata/filelookup.h"
#include "platform/error/error.h"

#include <QPointer>

class CddbTagManager;
class Form;
class Lookup;
class LongWork;
class QWidget;

/// The changes that ShowEditDialog tells. At least one of the two is set when the record was
/// changed; the first one alone decides whether a new disc is sent.
enum CddbChange : int {
    cddbToSend = 0x100,
    cddbEdited = 0x400,
    cddbChanged = cddbToSend | cddbEdited,
};

/// What LookupDisc answers.
enum CddbResult : int { cddbNoMatch = 1, cddbSeveral = 2, cddbExact = 3 };

/// The one way to the services that know discs: look-up, submission, the sign-up that both need,
/// and the dialogs for all that. An instance is a session of one screen. To the caller every
/// operation is synchronous; what takes long is a LongWork of the parent window, which must be a
/// Form for those. Any operation may throw Error; discservice.h has the numbers.
class CDDBControl
{
public:
    CDDBControl();
    ~CDDBControl();
    CDDBControl(const CDDBControl &) = delete;
    CDDBControl &operator=(const CDDBControl &) = delete;

    /// Non-zero if the user has signed up. Prompt 1 shows the sign-up dialog if not.
    int IsUserRegistered(int prompt);

    /// To be called first. Our services know the program by its name and version alone.
    void SetClientIdentity(const QString &clientId, const QString &clientTag,
                           const QString &version, const QString &reserved);
    CddbUserProfile GetUserProfile() const;
    CddbOptions GetOptions() const { return mOptions; }
    void SetOptions(const CddbOptions &options);

    /// What the open device holds, in the control's own form; empty if that is no table of
    /// contents.
    QString GetTocFromDevice(int deviceId) const;

    /// One of CddbResult.
    int LookupDisc(const QString &toc, int flags);
    CddbMatch GetMatch() const { return mMatch; } // of the last look-up
    void SetParentWindow(QWidget *window, int reserved);
    void ShutDown();

    /// Null: cancelled.
    CddbDiscPtr ShowFuzzyDialog(const CddbMatchListPtr &list);
    CddbDiscPtr GetFullDisc(const CddbDiscPtr &candidate, int flags);

    /// Changes the disc in place; gives the CddbChange flags, 0 for none.
    int ShowEditDialog(const CddbDiscPtr &disc, int flags);
    CddbDiscPtr CreateDisc(const QString &toc, const QString &one, const QString &other);

    /// Gives no meaning to its result; the disc is stored when it returns.
    int SubmitDisc(const CddbDiscPtr &disc, int flags);
    CddbGenreListPtr GetGenreList(int reserved) const;

    /// The disc of the track that the file identifier of a tag tells, and its number; nothing where
    /// it tells none, or the services know it no longer. Several that hold it are left for
    /// GetFileMatches.
    CddbDiscPtr LookupByFileId(const QString &fileId, int flags, int &track);

    /// The candidates that the last look-up of a file has left; nothing if there are none.
    CddbMatchListPtr GetFileMatches() const { return mFileMatches; }

    /// Works with this control and must not outlive it.
    std::unique_ptr<CddbTagManager> GetTagManager();
    void ShowAboutBox();
    int ShowRegistrationDialog(const CddbUserProfile &profile, int flags);

private:
    friend class CddbTagManager;
    using AskFile = std::function<FileLookup::Found(FileLookup &lookup)>;
    CddbDiscPtr lookUpFile(const AskFile &ask, int &track);

    Form &screen() const;
    std::unique_ptr<Lookup> lookup() const;
    void requireRegistered() const;
    CddbDiscPtr discOf(const DiscRecord &record, const QString &toc) const;

    QPointer<QWidget> mParent;
    CddbOptions mOptions;
    CddbMatch mMatch;
    CddbMatchListPtr mFileMatches;
    std::shared_ptr<GenreTable> mGenres;
};

/// The set-up that every session begins with: identity, owner, options out of the globals.
void setUpCddb(CDDBControl &control, QWidget *owner, bool withLanguage = true);

/// What a failed set-up or menu command shows: a missing server has words of its own, any other
/// failure its description.
void showCddbError(const Error &error);
