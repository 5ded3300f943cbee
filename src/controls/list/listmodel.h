#pragma once

#include "controls/list/sortedrows.h"
#include "platform/ado/rows.h"

#include <QAbstractTableModel>
#include <QColor>
#include <QHash>
#include <QSet>
#include <QStringList>

/// The rows of a list: those of a recordset, never changed, and over them what the screen has
/// written or marked. A record is a row's number in the recordset, a row its place on the screen;
/// everything but the model's own functions speaks of records.
class ListModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    struct Marks {
        bool bold = false;
        bool checked = false;
        QColor color; // invalid: the usual one
    };

    using QAbstractTableModel::QAbstractTableModel;

    void fill(std::shared_ptr<const ADODB::Rows> rows); // null: nothing at all
    unsigned filling() const { return mFilling; }       // counts the calls of fill()

    int recordAt(int row) const { return mOrder.empty() ? row : int(mOrder[std::size_t(row)]); }
    int rowOf(int record) const
    {
        return mOrder.empty() ? record : int(mRowOf[std::size_t(record)]);
    }

    QString text(int record, int column) const;
    void write(int record, int column, const QString &text);
    Marks marks(int record) const { return mMarks.value(record); }
    void setMarks(int record, const Marks &marks);

    /// The next row, from this one on and then from the top, whose text in a column starts so,
    /// without regard to case; -1 if there is none.
    int findStart(int column, const QString &start, int fromRow) const;

    /// Shows the rows ascending by a column, in the recordset's order if it is -1.
    void sortBy(int column);
    bool hasOrderOf(int column) const { return column == mSortedBy; }

    void setAlignment(int column, Qt::Alignment side); // until the next fill()

    /// For assistive tools the cell in the first column that shows is its whole row.
    void setFirstShown(int column) { mFirstShown = column; }
    void setHidden(int column, bool hidden);

    void setCheckColumn(int column); // -1: no check boxes
    int checkColumn() const { return mCheckColumn; }

    int rowCount(const QModelIndex &parent = {}) const override;
    int columnCount(const QModelIndex &parent = {}) const override;
    QVariant data(const QModelIndex &index, int role) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role) override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    bool setHeaderData(int section, Qt::Orientation orientation, const QVariant &value,
                       int role) override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;

signals:
    void checkToggled(int record); // through setData(), by the user

private:
    QVariant alignment(int column) const;
    QString rowText(int record) const;
    bool startsWith(int record, int column, const QString &start) const;
    std::vector<std::uint32_t> orderBy(int column);
    void setOrder(std::vector<std::uint32_t> order);
    void keepOrderFor(const ADODB::Rows *rows);
    void rowChanged(int record);

    std::shared_ptr<const ADODB::Rows> mRows;
    unsigned mFilling = 0;
    QStringList mCaptions;
    QHash<int, Qt::Alignment> mAlignments;     // by column, where it is not the left
    std::vector<std::uint32_t> mOrder, mRowOf; // empty in the recordset's order
    int mSortedBy = -1;                        // -2: by a column written to since
    std::vector<std::uint32_t> mLastOrder;     // of the same rows by mLastSortedBy, before fill()
    int mLastSortedBy = -1;
    int mCheckColumn = -1;
    int mFirstShown = 0;
    QSet<int> mHidden;
    QHash<int, WrittenTexts> mWritten; // by column
    QHash<int, Marks> mMarks;
};
