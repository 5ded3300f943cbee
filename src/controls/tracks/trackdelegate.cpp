#include "controls/tracks/trackdelegate.h"

#include "catalogue/typedtext.h"

#include <QKeyEvent>

TrackDelegate::TrackDelegate(Describe describe, QObject *parent)
    : RowDelegate(parent), mDescribe(std::move(describe))
{
}

QWidget *TrackDelegate::createEditor(QWidget *parent, const QStyleOptionViewItem &,
                                     const QModelIndex &index) const
{
    const Cell cell = mDescribe(index);
    mEdit = new CellEdit(cell.name, parent);
    mEdit->setMaxLength(typedtext::room(index.data(Qt::EditRole).toString()));
    mEdit->setSuggestions(cell.suggestions);
    if (!cell.list.isEmpty())
        mEdit->setList(cell.list, cell.listName);
    connect(mEdit, &CellEdit::cancelled, this, &TrackDelegate::cancelled);
    connect(mEdit, &CellEdit::gridKey, this, &TrackDelegate::gridKey);
    connect(mEdit, &CellEdit::inputRejected, this, &TrackDelegate::cutOff);
    return mEdit;
}

void TrackDelegate::destroyEditor(QWidget *editor, const QModelIndex &index) const
{
    if (editor == mEdit)
        mEdit.clear();
    RowDelegate::destroyEditor(editor, index);
}

// The field takes its keys itself: which of them end the edit depends on its list of suggestions.
bool TrackDelegate::eventFilter(QObject *editor, QEvent *event)
{
    return event->type() != QEvent::KeyPress && RowDelegate::eventFilter(editor, event);
}

void TrackDelegate::initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const
{
    // Not the rule of whole rows: the focus is shown on its cell.
    QStyledItemDelegate::initStyleOption(option, index); // NOLINT(bugprone-parent-virtual-call)
    if (index.column() != 0)
        return;
    // Half of the ink: what themes call a placeholder's colour need not go with the text's.
    QColor lighter = option->palette.color(QPalette::Text);
    lighter.setAlphaF(0.55F);
    option->palette.setColor(QPalette::Text, lighter);
}
