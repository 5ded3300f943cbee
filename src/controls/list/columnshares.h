#pragma once

#include <QList>
#include <QObject>

class QTableView;

/// Keeps the columns of a table as wide as the table: columns with a share divide what the others
/// leave. A share changes when the user drags the column; the others' widths are their own.
class ColumnShares : public QObject
{
    Q_OBJECT

public:
    /// By column; 0 for one that is as wide as its head and `least` digits.
    ColumnShares(QTableView *view, const QList<int> &shares, int least);

    void layOut();

private:
    int ownWidth(int column) const;
    void keep();

    QTableView *mView;
    QList<int> mShares;
    const int mLeast;
    bool mLayingOut = false;
};
