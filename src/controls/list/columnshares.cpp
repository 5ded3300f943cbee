#include "controls/list/columnshares.h"

#include <QHeaderView>
#include <QScopedValueRollback>
#include <QTableView>
#include <algorithm>
#include <numeric>

ColumnShares::ColumnShares(QTableView *view, const QList<int> &shares, int least)
    : QObject(view), mView(view), mShares(shares), mLeast(least)
{
    QHeaderView *head = view->horizontalHeader();
    for (int column = 0; column < shares.size(); ++column) {
        if (!shares[column])
            head->setSectionResizeMode(column, QHeaderView::Fixed);
    }
    connect(head, &QHeaderView::sectionResized, this, &ColumnShares::keep);
}

int ColumnShares::ownWidth(int column) const
{
    const QFontMetrics metrics = mView->fontMetrics();
    const int digits = metrics.horizontalAdvance(QString(mLeast, u'0'));
    return std::max(digits + 2 * metrics.averageCharWidth(),
                    mView->horizontalHeader()->sectionSizeHint(column));
}

void ColumnShares::layOut()
{
    const QScopedValueRollback layingOut(mLayingOut, true);
    int left = mView->viewport()->width();
    for (int column = 0; column < mShares.size(); ++column) {
        if (mShares[column])
            continue;
        mView->setColumnWidth(column, ownWidth(column));
        left -= mView->columnWidth(column);
    }
    const int readable = mView->fontMetrics().averageCharWidth() * 8;
    int shares = std::accumulate(mShares.begin(), mShares.end(), 0);
    for (int column = 0; column < mShares.size(); ++column) {
        if (!mShares[column])
            continue;
        const int wide = int(qint64(left) * mShares[column] / shares);
        mView->setColumnWidth(column, std::max(wide, readable));
        left -= wide;
        shares -= mShares[column];
    }
}

void ColumnShares::keep()
{
    if (mLayingOut)
        return;
    for (int column = 0; column < mShares.size(); ++column) {
        if (mShares[column])
            mShares[column] = std::max(mView->columnWidth(column), 1);
    }
}
