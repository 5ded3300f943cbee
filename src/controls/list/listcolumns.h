#pragma once

#include "controls/list/columnshares.h"
#include "platform/ado/recordset.h"

#include <QPointer>
#include <vector>

class DBListViewCTL;

/// What the columns of a list are: one line for each field of its recordset.
struct ListColumn {
    enum Kind { Hidden, Text, Number }; // numbers stand to the right
    Kind kind;
    const char *caption = nullptr; // key
    int share = 0; // of the width; 0 for as much as the caption and some digits need
};

/// The one way in which screens give their lists captions, widths and hidden columns. Widths follow
/// the size of the list.
class ListColumns : public QObject
{
    Q_OBJECT

public:
    using Dragged = ColumnShares::Dragged;

    /// `whole` is what the shares are parts of, if it is not their sum.
    ListColumns(DBListViewCTL *list, std::vector<ListColumn> columns, int whole = 0,
                Dragged dragged = Dragged::Kept);
    ~ListColumns() override; // the list is free for other columns

    /// Shows the rows of a recordset, as Populate() does, under these columns. Throws Error if the
    /// recordset is closed.
    void show(const ADODB::RecordsetPtr &recordset);

    /// The columns without a row.
    void showNone();

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    void setUpColumns();

    DBListViewCTL *mList;
    std::vector<ListColumn> mColumns;
    QPointer<ColumnShares> mShares;
};
