#pragma once

#include "controls/list/listcolumns.h"

/// Columns that are as wide as their texts, where ListColumns gives each a share; the last one
/// takes what is left. Where there is too little room the widest give way, and show the whole text
/// as a tool tip.
class FittedColumns : public QObject
{
    Q_OBJECT

public:
    FittedColumns(DBListViewCTL *list, std::vector<ListColumn> columns);

    /// As ListColumns does. Throws Error if the recordset is closed.
    void show(const ADODB::RecordsetPtr &recordset);

    /// Once more, when rows have become bold. No more than the first thousand rows count.
    void fit();

    /// For the load of a screen whose list is as wide as its layout: it gets wider, so that no text
    /// is cut.
    void widen(QWidget *screen) const;

protected:
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    int limit(int room) const;
    void layOut();

    DBListViewCTL *mList;
    std::vector<bool> mGivesWay;
    ListColumns *mColumns;
    QList<int> mWidths; // of the texts, 0 for a hidden column
};
