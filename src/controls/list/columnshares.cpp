#include "controls/list/columnshares.h"

#include <QHeaderView>
#include <QScopedValueRollback>
#include <QTableView>
#include <algorithm>

ColumnShares::ColumnShares(QTableView *view, const QList<int> &shares, int least, int whole,
                           Dragged dragged)
    : QObject(view),
      mView(view),
      mShares(shares),
      mLeast(least),
      mWhole(whole),
      mKeep(dragged == Dragged::Kept)
{
    connect(view->horizontalHeader(), &QHeaderView::sectionResized, this, &ColumnShares::keep);
}

int ColumnShares::ownWidth(int column) const
{
    const QFontMetrics metrics = mView->fontMetrics();
    const int digits = metrics.horizontalAdvance(QString(mLeast, u'0'));
    return std::max(digits + 2 * metrics.averageCharWidth(),
                    mView->horizontalHeader()->sectionSizeHint(column));
}

// Gives what they take of the width.
int ColumnShares::layOutOwn()
{
    int taken = 0;
    for (int column = 0; column < mShares.size(); ++column) {
        if (mShares[column] != OwnWidth)
            continue;
        mView->horizontalHeader()->setSectionResizeMode(column, QHeaderView::Fixed);
        mView->setColumnWidth(column, ownWidth(column));
        taken += mView->columnWidth(column);
    }
    return taken;
}

void ColumnShares::layOut()
{
    if (mView->horizontalHeader()->count() != mShares.size())
        return;
    const QScopedValueRollback layingOut(mLayingOut, true);
    const int left = mView->viewport()->width() - layOutOwn();
    int whole = mWhole;
    for (int share : mShares)
        whole += mWhole == 0 ? std::max(share, 0) : 0;
    const int readable = mWhole == 0 ? mView->fontMetrics().averageCharWidth() * 8 : 1;
    qint64 before = 0, edge = 0;
    for (int column = 0; column < mShares.size(); ++column) {
        if (mShares[column] <= 0)
            continue;
        before += mShares[column];
        const qint64 next = left * before / whole;
        mView->setColumnWidth(column, std::max(int(next - edge), readable));
        edge = next;
    }
    mRoom = mView->viewport()->width();
    mWidths.clear();
    for (int column = 0; column < mShares.size(); ++column)
        mWidths.append(mView->columnWidth(column));
}

void ColumnShares::keepOver(const std::function<void()> &remake)
{
    {
        const QScopedValueRollback remaking(mLayingOut, true);
        remake();
    }
    restore();
}

void ColumnShares::restore()
{
    if (!mKeep || mView->viewport()->width() != mRoom) {
        layOut();
        return;
    }
    const QScopedValueRollback layingOut(mLayingOut, true);
    for (int column = 0; column < mShares.size(); ++column) {
        if (mShares[column] != NotShown)
            mView->setColumnWidth(column, mWidths[column]);
    }
}

// What was dragged is in pixels, and from then on so are the others.
void ColumnShares::keep()
{
    if (mLayingOut || !mKeep || mWidths.isEmpty())
        return;
    int own = 0;
    for (int column = 0; column < mShares.size(); ++column) {
        mWidths[column] = mView->columnWidth(column);
        if (mShares[column] > 0)
            mShares[column] = std::max(mWidths[column], 1);
        else
            own += mWidths[column];
    }
    if (mWhole > 0)
        mWhole = std::max(mRoom - own, 1);
}
