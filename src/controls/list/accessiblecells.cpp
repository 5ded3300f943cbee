#include "controls/list/accessiblecells.h"

#include <QAbstractItemView>
#include <QAccessible>

namespace
{

QAccessibleInterface *cellOf(QAbstractItemView *view, const QModelIndex &index)
{
    QAccessibleInterface *all = QAccessible::queryAccessibleInterface(view);
    const QPoint at = view->viewport()->mapToGlobal(view->visualRect(index).center());
    return all ? all->childAt(at.x(), at.y()) : nullptr;
}

} // namespace

void tellCurrentRow(QAbstractItemView *view)
{
    if (!QAccessible::isActive() || !view->hasFocus() || !view->currentIndex().isValid())
        return;
    if (QAccessibleInterface *cell = cellOf(view, view->currentIndex())) {
        QAccessibleEvent event(cell, QAccessible::Focus);
        QAccessible::updateAccessibility(&event);
    }
}

void tellExpanded(QAbstractItemView *tree, const QModelIndex &node)
{
    if (!QAccessible::isActive())
        return;
    if (QAccessibleInterface *cell = cellOf(tree, node)) {
        QAccessible::State changed;
        changed.expanded = true;
        QAccessibleStateChangeEvent event(cell, changed);
        QAccessible::updateAccessibility(&event);
    }
}
