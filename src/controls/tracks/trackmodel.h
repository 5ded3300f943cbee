#pragma once

#include "controls/tracks/trackrow.h"

#include <QAbstractTableModel>
#include <QHash>
#include <QPoint>

/// The tracks of a disc as they are being edited: rows of texts, the empty row that waits behind
/// them, undo, and what has changed since the disc was loaded or saved. Rows and columns count from
/// 0; column 0 is the track number, given by position to the rows that are not empty.
///
/// Rows are known by keys of the model's own. The ids of the catalogue belong to what was saved
/// alone: a row brought back by undo never brings an id back that another row has by now.
class TrackModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    explicit TrackModel(bool withArtist, QObject *parent = nullptr);

    void setHeads(const QStringList &heads);

    /// Shows these tracks and forgets all else, undo included.
    void load(const QList<StoredTrack> &tracks);

    /// From now on tracks neither come nor go: as many as the disc has, empty ones among them.
    void setFixed() { mFixed = true; }

    /// Shows these instead, as one step of the user's; those with a link of what was loaded are
    /// those tracks.
    void showUnsaved(const QList<StoredTrack> &tracks);

    TrackField fieldOf(int column) const { return TrackField(column - 1 + mFirstField); }
    int columnOf(TrackField field) const { return field + 1 - mFirstField; }
    int waitingRow() const
    {
        return int(mRows.size());
    } // behind the tracks; none where they are fixed
    QString text(int row, TrackField field) const;
    int trackNumber(int row) const; // 0 for an empty row

    /// What a cell makes of a text that is typed into it.
    QString keep(int row, TrackField field, const QString &typed) const;

    // Changes by the user, each one step to undo. In the waiting row they make a row of it.
    void setText(int row, TrackField field, const QString &text);
    void clear(const QModelIndexList &cells);
    void insertTrack(int row);
    void removeTrack(int row);

    /// Fills cells from this one to the right and down; what stands right of the last column is
    /// left out. In the number column the first cells of the lines are left out if they are
    /// numbers; else it starts with the first field.
    struct Pasted {
        QModelIndex last; // cell that was filled
        bool cut;         // some text was too long
    };
    Pasted paste(int row, int column, const QList<QStringList> &lines);

    /// Lines of cells parted by tabs, as spreadsheets put them on the clipboard: a cell with tabs,
    /// line breaks or doubled quotes inside may stand between quotes.
    static QList<QStringList> parted(const QString &clipboard);
    static QString joined(const QList<QStringList> &lines); // the way back

    // Undo and redo give the cell that changed, no valid index if there is nothing to do.
    QModelIndex undo() { return step(mUndo, mRedo); }
    QModelIndex redo() { return step(mRedo, mUndo); }

    bool isChanged() const;

    /// The rows that are tracks, in their order.
    QList<TrackToSave> toSave() const;
    int rowOfTrack(qsizetype track) const; // of the nth in toSave()

    /// The links of what was loaded or saved, by whose absence in toSave() a save knows deleted
    /// ones.
    QList<qint64> savedLinks() const;

    /// The tracks of toSave() stand in the catalogue now, under these links.
    void markSaved(const QList<qint64> &links);
    void forgetSaved(); // and that they ever stood there
    void unmarkSaved(); // the last markSaved() has not happened

    int rowCount(const QModelIndex &parent = {}) const override;
    int columnCount(const QModelIndex &parent = {}) const override;
    QVariant data(const QModelIndex &index, int role) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role) override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;

private:
    struct Row {
        int key = 0;
        TrackTexts texts;
    };
    struct Saved {
        QList<int> order; // of the keys
        QHash<int, StoredTrack> tracks;
    };
    struct Step {
        QList<Row> rows;
        QPoint cell; // column, row
    };

    bool isTrack(const Row &row) const;   // an empty row is none, unless the tracks are fixed
    bool isChanged(const Row &row) const; // a row that is new is
    void change(QList<Row> rows, int row, int column); // one step to undo
    void show(QList<Row> rows);
    void fillUpTo(QList<Row> &rows, int row);
    QModelIndex step(QList<Step> &from, QList<Step> &to);

    const int mFirstField; // the first that is shown
    bool mFixed = false;
    QStringList mHeads;
    QList<Row> mRows;
    QList<int> mNumbers; // of mRows
    Saved mSaved, mSavedBefore;
    QList<Step> mUndo, mRedo;
    int mLastKey = 0;
};
