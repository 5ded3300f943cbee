#include "collection/diskposition.h"

#include "controls/tracks/trackgrid.h"
#include "platform/desktop/desktop.h"

using namespace Qt::StringLiterals;

// What the grid still has to do may move the cursor.
void DiskPosition::remember()
{
    Desktop::current().pump();
    mLast = {mDisk->CurrentColumn(), mDisk->CurrentRow()};
    mWaiting = mLast;
}

void DiskPosition::restore()
{
    const auto to = std::exchange(mWaiting, std::nullopt);
    if (!to)
        return;
    mDisk->setCurrentRow(std::max(1, to->y()));
    mDisk->setCurrentColumn(std::max(1, to->x()));
}

QString DiskPosition::text() const
{
    return u" ( "_s + QString::number(mLast.x()) + u" - "_s + QString::number(mLast.y()) + u')';
}
