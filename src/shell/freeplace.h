#pragma once

#include <QPoint>

class QMdiArea;
class QMdiSubWindow;

/// Where a child of the area, one that asks for no place, covers the fewest controls of the others;
/// lists are none.
QPoint freePlaceFor(const QMdiSubWindow &child, const QMdiArea &area);
