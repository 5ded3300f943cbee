#include "controls/list/rowdelegate.h"

#include <QAbstractItemView>
#include <QHelpEvent>
#include <QToolTip>

void RowDelegate::initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const
{
    QStyledItemDelegate::initStyleOption(option, index);
    option->state &= ~QStyle::State_HasFocus;
}

bool RowDelegate::helpEvent(QHelpEvent *event, QAbstractItemView *view,
                            const QStyleOptionViewItem &option, const QModelIndex &index)
{
    if (event->type() != QEvent::ToolTip || !view->toolTip().isEmpty())
        return false;
    const bool cut = index.isValid() && sizeHint(option, index).width() > option.rect.width();
    const QString text = cut ? index.data().toString().toHtmlEscaped() : QString();
    QToolTip::showText(event->globalPos(), text, view->viewport(), option.rect);
    return true;
}
