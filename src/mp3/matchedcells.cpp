#include "mp3/matchedcells.h"

#include "services/messages.h"

#include <QAbstractItemView>
#include <QHelpEvent>
#include <QToolTip>

using namespace Qt::StringLiterals;

bool MatchedCells::isChanged(const QModelIndex &index) const
{
    return mBefore && index.isValid() && index.row() < mBefore->rowCount() &&
           index.column() < mBefore->columnCount() &&
           mBefore->text(index.row(), index.column()) != index.data().toString();
}

void MatchedCells::initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const
{
    RowDelegate::initStyleOption(option, index);
    if (!isChanged(index))
        return;
    constexpr int tint = 60; // of 255
    QColor color = option->palette.color(QPalette::Highlight);
    color.setAlpha(tint);
    option->backgroundBrush = color;
    option->font.setBold(true);
}

bool MatchedCells::helpEvent(QHelpEvent *event, QAbstractItemView *view,
                             const QStyleOptionViewItem &option, const QModelIndex &index)
{
    if (event->type() != QEvent::ToolTip || !isChanged(index))
        return RowDelegate::helpEvent(event, view, option, index);
    const QString before = mBefore->text(index.row(), index.column());
    const QString was = before.isEmpty() ? GetMessage("xTagWasEmpty")
                                         : GetMessage("xTagWas") + before.toHtmlEscaped();
    QToolTip::showText(event->globalPos(),
                       u"<span><b>"_s + index.data().toString().toHtmlEscaped() + u"</b><br>"_s +
                           was + u"</span>"_s,
                       view->viewport(), option.rect);
    return true;
}
