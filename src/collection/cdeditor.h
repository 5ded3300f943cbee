#pragma once

#include "collection/diskposition.h"
#include "collection/headerfields.h"
#include "collection/heldrecord.h"
#include "collection/recoverycopy.h"
#include "platform/desktop/form.h"

#include <functional>

class DiscTabs;
class QTimer;
class QToolBar;
class TrackButtons;
class TrackGrid;
class Error;
namespace ADODB
{
class Recordset;
class Transaction;
} // namespace ADODB

/// What the editors of compilations and albums have in common, which is nearly all: a head that the
/// form reads and writes, a tab for each disc, and a grid with the tracks of the disc that shows.
/// The grid writes its tracks inside the transaction of the form's save. Discs are saved when
/// their tab is left, without a question.
///
/// Mode and CdId are set before Show(). A form that is busy takes no command and refuses to close:
/// it handles events at points where the grid stands between two states.
class CdEditor : public Form
{
    Q_OBJECT

public:
    QString Mode;    // "I" a new record, "U" an existing one; the first save makes it "U"
    qint64 CdId = 0; // CDTitels.ID; of a new record from its first save on

    /// Saves the head and the disc that shows, all or nothing. With Reload the grid reads the disc
    /// again. Tells the user what is wrong.
    void SaveAtUserRequest(bool Reload = false);

    /// The save command: the grid's cursor stays where it is.
    void SaveKeepingPosition();

    /// Shows a disc, as a click on its tab does, with the cursor on a track. Both count from 1;
    /// what is not there is left alone.
    void GoToTrack(int disc, int track);

    // Of a record that somebody else deletes: whether it is the one here, what is to be kept of it
    // before, and that it has gone.
    bool holds(qint64 id) const;
    void keepForAnew();
    void recordDeleted();

    /// Behind Show(): what an earlier run has not saved, and the copy that it left of it.
    void restore(const UnsavedRecord &record, const QString &copy);

protected:
    static constexpr QLatin1String modeNew{"I"}, modeExisting{"U"};

    struct Controls {
        HeaderFields::Fields fields;
        DiscTabs *discs;
        QToolBar *toolbar;
        TrackGrid *disk;
        QPushButton *cancel;
    };
    /// What is fixed for a kind of record.
    struct Kind {
        double left;              // where the form stands, as a share of the frame's width
        QString unknownMode;      // said when Mode is neither "I" nor "U"
        QString positionTitle;    // of the box when the save command fails
        bool idBeforeTransaction; // a new id is looked up before the transaction begins
    };

    explicit CdEditor(const QString &name);
    void setUp(const Controls &controls, const Kind &kind);

    // What the two kinds differ in. All statements are about the row of CDTitels with this id.
    virtual const char *gapIn(const Header &header) const = 0; // key of what to say, or nullptr
    virtual QString selectRecord(qint64 id) const = 0; // CDTitle, Genre, hitjaar, DiscNum; Artiest
    virtual QString insertTitle(qint64 id, const Header &header) const = 0;
    virtual QString updateTitle(qint64 id, const Header &header) const = 0;
    virtual void beforeTitle(const Header &) {}                          // in the transaction
    virtual void afterTitle(const Header &, const Header & /*saved*/) {} // of an existing record
    virtual Header asStored(const Header &header) { return header; }     // tells what is otherwise
    virtual QWidget *behindLastTrack() const = 0; // gets the focus from the grid
    virtual void RestoreDiskPosition();

    void Form_Load() override;
    bool QueryUnload() override;
    void Form_Unload() override;

private:
    void connectFields();
    void connectDisk();
    void connectToolbar();
    void command(const std::function<void()> &routine);

    void load();
    void refuseToLoad(const QString &why);
    void loadNew();
    void loadRecord();
    Header headerOf(ADODB::Recordset &record) const;
    void ShowDisc(int number);

    bool canBeSaved(const Header &header);
    void save(bool reload);
    void write(const Header &header, bool reload);
    void writeTitle(bool anew, qint64 newId, const Header &header);
    void commit(ADODB::Transaction &transaction, const Header &header, bool reload,
                bool tracksChanged);
    void committed(const Header &header, bool listsChange, bool reload);
    void saveCommand();

    void RememberDiskPosition();
    QString withPosition(const Error &error) const;
    void DiscsTab_Click(int leftBehind);
    void goToTab(int tab);
    void changeDisc(int leftBehind);
    void AddDisc();
    void DeleteDisc();
    void DeleteDiscLocked();
    bool removeDisc();
    void loseRecord(const char *message);
    void showLost(bool lost);
    TrackStore::Artists artists() const;
    void cmdCancel_Click();
    bool saveBeforeClosing();
    bool isChanged() const;
    void takeFocus();
    UnsavedRecord unsaved() const;
    void keepCopy();

    Controls mControls{};
    Kind mKind{};
    HeaderFields *mFields = nullptr;
    TrackButtons *mTracks = nullptr;
    Header mSaved; // as last loaded or saved
    HeldRecord mRecord;
    DiskPosition mPosition;
    RecoveryCopy mCopy;
    QTimer *mCopyTimer;
    bool mDropCopy = false; // the form goes, and nothing of it is wanted any more
    bool mCloseSilently = false;
    bool mSaveFailed = false;
    bool mDeletingDisc = false;
};
