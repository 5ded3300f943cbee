#include "shell/freeplace.h"

#include <QAbstractButton>
#include <QAbstractScrollArea>
#include <QMdiArea>
#include <QMdiSubWindow>

namespace
{

int controlsBehind(const QMdiSubWindow &child, QPoint corner, const QMdiArea &area)
{
    constexpr int worstFirst = 100; // a button is worth more than any number of links
    int covered = 0;
    for (const QWidget *w : area.viewport()->findChildren<QWidget *>()) {
        const bool isControl = w->focusPolicy() & Qt::TabFocus && w->isVisible() &&
                               !qobject_cast<const QAbstractScrollArea *>(w) &&
                               !child.isAncestorOf(w);
        const QRect place(w->mapTo(area.viewport(), QPoint()), w->size());
        if (isControl && place.intersects({corner, child.size()}))
            covered += qobject_cast<const QAbstractButton *>(w) ? worstFirst : 1;
    }
    return covered;
}

} // namespace

QPoint freePlaceFor(const QMdiSubWindow &child, const QMdiArea &area)
{
    const QSize free = area.viewport()->size() - child.size();
    const int right = free.width(), down = free.height();
    QPoint best = child.pos();
    int least = controlsBehind(child, best, area);
    for (const QPoint corner : {QPoint(right, down / 2), QPoint(right, 0), QPoint(right, down),
                                QPoint(0, down), QPoint(0, down / 2)}) {
        const int covered = controlsBehind(child, corner, area);
        if (covered < least) {
            best = corner;
            least = covered;
        }
    }
    return best;
}
