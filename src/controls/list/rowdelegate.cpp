#include "controls/list/rowdelegate.h"

#include <QAbstractItemView>
#include <QHelpEvent>
#include <QToolTip>

using namespace Qt::StringLiterals;

void RowDelegate::initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const
{
    QStyledItemDelegate::initStyleOption(option, index);
    option->state &= ~QStyle::State_HasFocus;
    // A row has one line: of more, all but the first would be cut off, whatever the width.
    option->text.replace(QChar::LineSeparator, u' ');
}

bool RowDelegate::helpEvent(QHelpEvent *event, QAbstractItemView *view,
                            const QStyleOptionViewItem &option, const QModelIndex &index)
{
    if (event->type() != QEvent::ToolTip || !view->toolTip().isEmpty())
        return false;
    const bool cut = index.isValid() && sizeHint(option, index).width() > option.rect.width();
    if (cut) // plain text, whatever signs it holds
        QToolTip::showText(event->globalPos(),
                           u"<span>"_s + index.data().toString().toHtmlEscaped() + u"</span>"_s,
                           view->viewport(), option.rect);
    else
        QToolTip::hideText();
    return true;
}
