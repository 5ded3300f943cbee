#include "controls/list/fittedcolumns.h"

#include "controls/list/DBListViewCTL.h"

#include <QEvent>
#include <QHeaderView>
#include <QLayout>
#include <QScrollBar>
#include <algorithm>
#include <numeric>

namespace
{

constexpr int readable = 8; // characters

// None may be wider than this, so that all find room.
int limitOf(QList<int> widths, int room)
{
    std::sort(widths.begin(), widths.end());
    for (qsizetype i = 0; i < widths.size(); ++i) {
        const int share = room / int(widths.size() - i);
        if (widths[i] > share)
            return share;
        room -= widths[i];
    }
    return widths.isEmpty() ? room : widths.last();
}

} // namespace

// The filter comes first, so that it acts after that of the shares.
FittedColumns::FittedColumns(DBListViewCTL *list, std::vector<ListColumn> columns)
    : QObject(list), mList(list)
{
    for (const ListColumn &column : columns)
        mGivesWay.push_back(column.share > 0);
    mList->viewport()->installEventFilter(this);
    mColumns = new ListColumns(list, std::move(columns), 0, ListColumns::Dragged::Lost);
}

void FittedColumns::show(const ADODB::RecordsetPtr &recordset)
{
    mColumns->show(recordset);
    fit();
}

void FittedColumns::fit()
{
    mList->ensurePolished();
    const QHeaderView *header = mList->horizontalHeader();
    const QAbstractItemView *view = mList;
    mWidths.clear();
    for (int column = 0; column < header->count(); ++column) {
        const int texts =
            std::max(view->sizeHintForColumn(column), header->sectionSizeHint(column));
        mWidths.append(mList->isColumnHidden(column) ? 0 : texts);
    }
    layOut();
}

void FittedColumns::widen(QWidget *screen) const
{
    const QMargins margins = screen->layout()->contentsMargins();
    const int around = margins.left() + margins.right() + 2 * mList->frameWidth() +
                       mList->verticalScrollBar()->sizeHint().width();
    const int wanted = std::accumulate(mWidths.begin(), mWidths.end(), around);
    screen->resize(std::max(screen->width(), wanted), screen->height());
}

// Of those that give way.
int FittedColumns::limit(int room) const
{
    QList<int> givesWay;
    int whole = 0;
    for (int column = 0; column < mWidths.size(); ++column) {
        if (mGivesWay[std::size_t(column)])
            givesWay.append(mWidths[column]);
        else
            whole += mWidths[column];
    }
    return limitOf(givesWay, room - whole);
}

// Where it would leave them too narrow to be read, all give way.
void FittedColumns::layOut()
{
    int left = mList->viewport()->width();
    const int some = limit(left);
    const bool isNarrow = some < readable * mList->fontMetrics().averageCharWidth();
    const int all = isNarrow ? limitOf(mWidths, left) : left;
    for (int column = 0; column < mWidths.size(); ++column) {
        const bool givesWay = mGivesWay[std::size_t(column)] && !isNarrow;
        const int texts = std::min(mWidths[column], givesWay ? some : all);
        const bool isLast = column == mWidths.size() - 1;
        if (texts > 0)
            mList->setColumnWidth(column, isLast ? std::max(texts, left) : texts);
        left -= texts;
    }
}

bool FittedColumns::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::Resize)
        layOut();
    return QObject::eventFilter(watched, event);
}
