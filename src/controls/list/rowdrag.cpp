#include "controls/list/rowdrag.h"

#include "controls/list/DBListViewCTL.h"

#include <QPointer>
#include <QScrollBar>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

enum DragState { vbEnter, vbLeave, vbOver };
constexpr int scrollInterval = 80; // ms for each row

} // namespace

RowDrag::RowDrag(DBListViewCTL *list) : QObject(list), mList(list), mScroll(new QTimer(this))
{
    mScroll->setObjectName(u"DragScroll"_s);
    mScroll->setInterval(scrollInterval);
    connect(mScroll, &QTimer::timeout, this, &RowDrag::scrollAtEdge);
}

void RowDrag::begin()
{
    mRunning = true;
    mInside = false;
    mList->viewport()->setCursor(mCursor);
    mList->viewport()->update();
    mScroll->start();
}

void RowDrag::end()
{
    if (!mRunning)
        return;
    mRunning = false;
    mScroll->stop();
    mList->viewport()->unsetCursor();
    mList->setDropHighlight({});
}

void RowDrag::setCursor(const QCursor &cursor)
{
    mCursor = cursor;
    if (mRunning)
        mList->viewport()->setCursor(cursor);
}

void RowDrag::pointerMoved(QPoint to)
{
    mAt = to;
    const bool inside = mList->viewport()->rect().contains(to);
    if (inside)
        tellOver(to, mInside ? vbOver : vbEnter);
    else if (mInside)
        tellOver(to, vbLeave);
    mInside = inside;
}

void RowDrag::released(QPoint at)
{
    end();
    if (mList->viewport()->rect().contains(at))
        emit mList->DragDrop(mList, at.x(), at.y());
}

void RowDrag::tellOver(QPoint at, int state)
{
    emit mList->DragOver(mList, at.x(), at.y(), state);
}

void RowDrag::scrollAtEdge()
{
    const int margin = mList->rowHeight(0) / 2;
    const int height = mList->viewport()->height();
    QScrollBar *bar = mList->verticalScrollBar();
    const int before = bar->value();
    if (mInside && mAt.y() < margin)
        bar->setValue(before - 1);
    else if (mInside && mAt.y() >= height - margin)
        bar->setValue(before + 1);
    if (bar->value() != before)
        tellOver(mAt, vbOver);
}
