#include "controls/list/rowselection.h"

#include <QSignalBlocker>

void RowSelection::select(const QItemSelection &rows, SelectionFlags command)
{
    constexpr qsizetype manyRanges = 500;
    if (command & Clear && selection().size() > manyRanges) {
        {
            const QSignalBlocker quiet(this);
            QItemSelectionModel::select(QItemSelection(), Clear);
        }
        emit dropped();
    }
    QItemSelectionModel::select(rows, command);
}
