// What the list does with keys, mouse and focus, and what it tells its screen of them.

#include "controls/list/DBListViewCTL.h"

#include "controls/list/accessiblecells.h"
#include "controls/list/keycodes.h"
#include "controls/list/listmodel.h"
#include "controls/list/rowdrag.h"

#include <QAccessible>
#include <QApplication>
#include <QMouseEvent>
#include <QPointer>
#include <QScrollBar>
#include <QStyleOption>

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

int buttonOf(Qt::MouseButton button)
{
    if (button == Qt::RightButton)
        return 2;
    return button == Qt::LeftButton ? 1 : 4;
}

/// F1 to F8 and the commands on Insert are the menu's.
bool isMenuKey(const QKeyEvent &event)
{
    const bool insert = event.key() == Qt::Key_Insert;
    return (event.key() >= Qt::Key_F1 && event.key() <= Qt::Key_F8) ||
           (insert && shiftStateOf(event.modifiers()) != 0);
}

bool isPrintable(const QString &text)
{
    return !text.isEmpty() && text.front().isPrint();
}

} // namespace

void DBListViewCTL::keyPressEvent(QKeyEvent *event)
{
    const QPointer<DBListViewCTL> self(this);
    if (mDrag->running() && event->key() == Qt::Key_Escape) {
        mDrag->end();
        return;
    }
    if (isMenuKey(*event)) {
        event->ignore();
        return;
    }
    if (const int code = keyCodeOf(event->key()))
        emit KeyDown(code, shiftStateOf(event->modifiers()));
    if (self && isEnabled() && !actOnKey(event)) {
        QTableView::keyPressEvent(event);
        keepOneSelected();
    }
}

// So that lists can be sorted without a mouse.
void DBListViewCTL::clickShownColumn(int nth)
{
    for (int column = 0; column < mModel->columnCount(); ++column) {
        if (!isColumnHidden(column) && --nth == 0)
            emit ColumnClick(column + 1);
    }
}

bool DBListViewCTL::actOnKey(QKeyEvent *event)
{
    const bool plain = shiftStateOf(event->modifiers()) == 0;
    const bool typing =
        !mTyped.isEmpty() && !mTypedAt.hasExpired(QApplication::keyboardInputInterval());
    if (event->matches(QKeySequence::Copy)) {
        copySelected();
    } else if (event->modifiers() == Qt::ControlModifier && event->key() >= Qt::Key_1 &&
               event->key() <= Qt::Key_9) {
        clickShownColumn(event->key() - Qt::Key_0);
    } else if (event->key() == Qt::Key_Space && plain && typing) {
        keyboardSearch(event->text());
    } else if (event->key() == Qt::Key_Space && plain && CheckBoxes()) {
        toggleCheck(currentIndex());
    } else if (event->key() == Qt::Key_Left && plain) {
        horizontalScrollBar()->triggerAction(QScrollBar::SliderSingleStepSub);
    } else if (event->key() == Qt::Key_Right && plain) {
        horizontalScrollBar()->triggerAction(QScrollBar::SliderSingleStepAdd);
    } else if (!event->text().isEmpty() && !isPrintable(event->text()) &&
               !event->matches(QKeySequence::SelectAll) && event->key() != Qt::Key_Return &&
               event->key() != Qt::Key_Enter) {
        event->ignore(); // Esc, Delete and their like would be taken for typing
    } else {
        return false;
    }
    return true;
}

void DBListViewCTL::keyReleaseEvent(QKeyEvent *event)
{
    QTableView::keyReleaseEvent(event);
    const int code = keyCodeOf(event->key());
    if (code != 0 && !event->isAutoRepeat() && !isMenuKey(*event))
        emit KeyUp(code, shiftStateOf(event->modifiers()));
}

void DBListViewCTL::keyboardSearch(const QString &typed)
{
    const bool continues =
        !mTyped.isEmpty() && !mTypedAt.hasExpired(QApplication::keyboardInputInterval());
    if (!isPrintable(typed) || (!continues && typed.trimmed().isEmpty()))
        return;
    mTyped = continues ? QString(mTyped + typed) : typed;
    mTypedAt.start();
    // One letter typed again and again visits all rows that start with it.
    const bool one = std::all_of(mTyped.begin(), mTyped.end(), [this](QChar c) {
        return c.toCaseFolded() == mTyped[0].toCaseFolded();
    });
    const int current = currentIndex().row();
    const int found =
        one ? searchFrom(current + 1, mTyped.left(1)) : searchFrom(std::max(current, 0), mTyped);
    if (found >= 0) {
        const QString word = mTyped;
        makeCurrent(found);
        mTyped = word;
    }
}

// To go elsewhere begins a new word.
void DBListViewCTL::currentChanged(const QModelIndex &current, const QModelIndex &previous)
{
    QTableView::currentChanged(current, previous);
    mTyped.clear();
}

int DBListViewCTL::searchFrom(int row, const QString &text) const
{
    const bool sorted = mSorted && mSortKey < mModel->columnCount() && !isColumnHidden(mSortKey);
    return mModel->findStart(sorted ? mSortKey : shownIndex(0).column(), text, row);
}

void DBListViewCTL::toggleCheck(const QModelIndex &index)
{
    const QModelIndex cell = index.siblingAtColumn(mModel->checkColumn());
    const bool checked = cell.data(Qt::CheckStateRole).toInt() == Qt::Checked;
    mModel->setData(cell, checked ? Qt::Unchecked : Qt::Checked, Qt::CheckStateRole);
}

bool DBListViewCTL::onCheckBox(const QModelIndex &index, QPoint at) const
{
    if (!index.isValid() || index.column() != mModel->checkColumn())
        return false;
    QStyleOptionViewItem option;
    initViewItemOption(&option);
    option.rect = visualRect(index);
    option.features |= QStyleOptionViewItem::HasCheckIndicator;
    return style()
        ->subElementRect(QStyle::SE_ItemViewItemCheckIndicator, &option, this)
        .contains(at);
}

void DBListViewCTL::mousePressEvent(QMouseEvent *event)
{
    const QPointer<DBListViewCTL> self(this);
    const QPoint at = event->position().toPoint();
    emit MouseDown(buttonOf(event->button()), shiftStateOf(event->modifiers()), at.x(), at.y());
    if (!self || mDrag->running())
        return;
    const QModelIndex index = indexAt(at);
    mCheckPressed = event->button() == Qt::LeftButton && onCheckBox(index, at);
    if (mCheckPressed) {
        toggleCheck(index);
        return;
    }
    QTableView::mousePressEvent(event);
    keepOneSelected();
    columnsChanged(); // the cursor stands in the cell that tells of the whole row
    mSelectionMoved = false;
    if (index.isValid())
        emit ItemClick(itemAt(index.row()));
    else if (!selectionModel()->hasSelection())
        emit SelectionCleared();
}

void DBListViewCTL::mouseMoveEvent(QMouseEvent *event)
{
    if (mDrag->running())
        mDrag->pointerMoved(event->position().toPoint());
    else if (!mCheckPressed)
        QTableView::mouseMoveEvent(event);
}

void DBListViewCTL::mouseReleaseEvent(QMouseEvent *event)
{
    const bool selects = !mDrag->running() && !mCheckPressed;
    if (selects)
        QTableView::mouseReleaseEvent(event);
    else if (mDrag->running())
        mDrag->released(event->position().toPoint());
    keepOneSelected();
    // A press on one of several selected rows leaves the others so until the button goes up, and
    // one that is held selects on.
    const bool isClick = selects && mSelectionMoved && currentIndex().isValid();
    mCheckPressed = mSelectionMoved = false;
    if (isClick)
        emit ItemClick(itemAt(currentIndex().row()));
}

void DBListViewCTL::mouseDoubleClickEvent(QMouseEvent *event)
{
    const QModelIndex index = indexAt(event->position().toPoint());
    if (event->button() == Qt::LeftButton && onCheckBox(index, event->position().toPoint())) {
        mCheckPressed = true;
        toggleCheck(index);
        return;
    }
    QTableView::mouseDoubleClickEvent(event);
    if (event->button() == Qt::LeftButton && index.isValid())
        emit DblClick();
}

void DBListViewCTL::focusInEvent(QFocusEvent *event)
{
    QTableView::focusInEvent(event);
    // The toolkit tells of the list behind this.
    if (QAccessible::isActive())
        QMetaObject::invokeMethod(
            this, [this] { tellCurrentRow(this); }, Qt::QueuedConnection);
    if (event->reason() != Qt::PopupFocusReason)
        emit GotFocus();
}

void DBListViewCTL::focusOutEvent(QFocusEvent *event)
{
    QTableView::focusOutEvent(event);
    if (event->reason() != Qt::PopupFocusReason)
        emit LostFocus();
}

void DBListViewCTL::hideEvent(QHideEvent *event)
{
    mDrag->end();
    QTableView::hideEvent(event);
}
