#pragma once

#include <QPointer>
#include <QTableView>
#include <functional>
#include <memory>

namespace ADODB
{
class Connection;
class TransactionFate;
} // namespace ADODB

class CellEdit;
class TrackCompletion;
class TrackDelegate;
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
    ~TrackGrid() override;

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
    /// ADODB::Error.
    void SaveDisc();

    /// Forgets what the grid holds and reads the disc. Throws ADODB::Error.
    void LoadDisc();

    /// Deletes the disc from the catalogue and closes the gap in the numbers of those behind it, in
    /// one transaction of its own. Throws ADODB::Error.
    void RemoveDisc();

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

    void keyPressEvent(QKeyEvent *event) override;
    bool event(QEvent *event) override;
    bool focusNextPrevChild(bool next) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;
    void resizeEvent(QResizeEvent *event) override;
    void changeEvent(QEvent *event) override;
    void hideEvent(QHideEvent *event) override;

private:
    CellEdit *cellEdit() const;
    void followFocus(QWidget *now);

    const std::unique_ptr<TrackCompletion> mCompletion;
    TrackModel *mModel;
    TrackDelegate *mDelegate;
    ADODB::Connection *mConnection = nullptr;
    std::shared_ptr<const ADODB::TransactionFate> mSaveFate;
    qint64 mCdId = 0;
    int mDiscNo = 1;
    int mLanguage = 0;
    bool mHasError = false;
    bool mFocused = false;
};
