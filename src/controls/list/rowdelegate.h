#pragma once

#include <QStyledItemDelegate>

/// Draws the cells of a list. The focus belongs to the whole row, so the list draws it; a text of
/// several lines stands in one, and what does not fit its column shows in a tool tip, unless the
/// list has one of its own.
class RowDelegate : public QStyledItemDelegate
{
    Q_OBJECT

public:
    using QStyledItemDelegate::QStyledItemDelegate;

    bool helpEvent(QHelpEvent *event, QAbstractItemView *view, const QStyleOptionViewItem &option,
                   const QModelIndex &index) override;

protected:
    void initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const override;
};
