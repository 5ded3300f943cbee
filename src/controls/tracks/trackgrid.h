#pragma once

#include "controls/tracks/trackdelegate.h"
#include "controls/tracks/trackstore.h"

#include <QTableView>
#include <memory>

namespace ADODB
{
class Connection;
class TransactionFate;
} // namespace ADODB

class ColumnShares;
class TrackModel;

/// The tracks of one disc as a spreadsheet: typing replaces a cell, Enter or a double click edits
/// it, Enter goes down, Tab walks the fields, an empty row waits at the end. Reads and writes the
/// disc given by CdId and DiscNo on its Connection. Rows and columns count from 1; the first column
/// is the track number.
///
/// Insert inserts a track, End deletes the current one, PgUp and PgDn go to the first and last;
/// Shift+Insert, Shift+End and Ctrl+Enter raise the three requests. A key that a toolbar sends
/// commits a cell being edited first. F2 is not the grid's, Esc never leaves it.
class TrackGrid : public QTableView
{
    Q_OBJECT

public:
    int Language() const { return mLanguage; }
    void setLanguage(int language); // of heads, genres and messages

    int CurrentColumn() const;
    void setCurrentColumn(int column); // the nearest there is
    int CurrentRow() const;
    void setCurrentRow(int row);

    /// Whether the last SaveDisc could not write its tracks and has told why.
    bool HasError() const { return mHasError; }

    void setConnection(ADODB::Connection *connection) { mConnection = connection; }
    qint64 CdId() const { return mCdId; }
    void setCdId(qint64 id) { mCdId = id; }
    int DiscNo() const { return mDiscNo; }
    void setDiscNo(int number) { mDiscNo = number; }

    /// Writes the tracks inside the caller's transaction, an edit in progress included. A row that
    /// cannot be written gets the cursor after the user was told; then nothing is written. Throws
    /// Error.
    void SaveDisc();

    /// Forgets what the grid holds and reads the disc. Throws Error.
    void LoadDisc();

    /// Deletes the disc from the catalogue and closes the gap in the numbers of those behind it, in
    /// one transaction of its own. Throws Error.
    void RemoveDisc();

    /// The tracks as they stand in the grid, what is being typed included; link 0: a new one.
    QList<StoredTrack> Tracks() const;

    /// Behind LoadDisc: these tracks, not saved yet, in the place of those that were loaded.
    void ShowUnsaved(const QList<StoredTrack> &tracks);

    /// Shows tracks that are of no catalogue, and as many as they are, empty ones included: none
    /// can be added or taken away.
    void ShowTracks(const QList<StoredTrack> &tracks);
    void goToCell(int row, TrackField field); // from 0; with the focus

    /// The tracks stand in no catalogue any more: all of them are new.
    void ForgetSaved();

    void CommitEdit(); // what is being typed counts as content

    /// Whether there is something that SaveDisc would write, what is being typed included. A save
    /// whose transaction was rolled back has not happened.
    bool IsChanged() const;

signals:
    void GotFocus(); // a cell's editor is the grid's own focus
    void LostFocus();
    void UnlockScreen();
    void LockScreen();
    void LeaveForward();
    void LeaveBackward();
    void RequestSave();
    void RequestAddDisc();
    void RequestDeleteDisc();

protected:
    enum class Columns { WithArtist, WithoutArtist };
    TrackGrid(Columns columns, QWidget *parent);

    bool event(QEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;
    void changeEvent(QEvent *event) override;

private:
    void setUpView();
    void layOut();
    void followFocus(QWidget *now);
    QString message(const char *key) const;
    TrackStore store() const;

    // Editing and moving.
    TrackDelegate::Cell describe(const QModelIndex &index) const;
    QStringList suggestionsFor(const QModelIndex &index, const QString &start) const;
    CellEdit *cellEdit() const { return mDelegate->edit(); }
    void editCurrent();
    void cancelEdit();
    bool leaveEdit();
    void refuseYear(const QModelIndex &index, const QString &text);
    void actOnEditKey(QKeyEvent *event);
    bool actOnKey(QKeyEvent *event);
    bool actOnClipboardKey(QKeyEvent *event);
    bool actOnPlainKey(int key);
    void go(int row, int column); // the nearest cell there is
    void walk(int step);
    int lastColumn() const;
    void copy() const;
    void paste();
    void tellCut();
    void clearSelected();

    // Saving.
    void settleSave() const;
    void refuse(const QString &why);

    const bool mWithArtist;
    TrackModel *mModel;
    TrackDelegate *mDelegate;
    ColumnShares *mShares;
    ADODB::Connection *mConnection = nullptr;
    mutable std::shared_ptr<const ADODB::TransactionFate> mSaveFate; // of the last SaveDisc
    qint64 mCdId = 0;
    int mDiscNo = 1;
    int mLanguage = 0;
    bool mHasError = false;
    bool mFocused = false;
    bool mTellsCut = false;
};
