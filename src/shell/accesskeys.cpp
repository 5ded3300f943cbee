#include "shell/accesskeys.h"

#include "platform/desktop/form.h"

#include <QAbstractButton>
#include <QApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QMenuBar>

namespace
{

Form *formWithFocus()
{
    for (QWidget *w = QApplication::focusWidget(); w; w = w->parentWidget()) {
        if (auto *form = qobject_cast<Form *>(w))
            return form;
    }
    return nullptr;
}

QKeySequence accessKeyOf(const QWidget *w)
{
    if (const auto *button = qobject_cast<const QAbstractButton *>(w))
        return button->shortcut();
    const auto *label = qobject_cast<const QLabel *>(w);
    return label && label->buddy() ? QKeySequence::mnemonic(label->text()) : QKeySequence();
}

} // namespace

AccessKeys::AccessKeys(const QMenuBar *menus, QObject *parent) : QObject(parent), mMenus(menus)
{
    qApp->installEventFilter(this);
}

bool AccessKeys::belongsToMenu(QKeyCombination key) const
{
    const auto actions = mMenus->actions();
    return std::any_of(actions.begin(), actions.end(), [key](const QAction *menu) {
        return QKeySequence::mnemonic(menu->text()) == QKeySequence(key);
    });
}

QWidget *AccessKeys::ownerOf(QKeyCombination key)
{
    const Form *form = formWithFocus();
    if (!form)
        return nullptr;
    for (QWidget *w : form->findChildren<QWidget *>()) {
        if (w->isVisible() && w->isEnabled() && accessKeyOf(w) == QKeySequence(key))
            return w;
    }
    return nullptr;
}

void AccessKeys::activate(QWidget *owner)
{
    if (auto *label = qobject_cast<QLabel *>(owner)) {
        label->buddy()->setFocus(Qt::ShortcutFocusReason);
    } else if (auto *button = qobject_cast<QAbstractButton *>(owner)) {
        if (button->focusPolicy() & Qt::TabFocus)
            button->setFocus(Qt::ShortcutFocusReason);
        button->click();
    }
}

// The system asks whether somebody wants the key for himself before it looks for a menu, and then
// brings it as any other.
bool AccessKeys::eventFilter(QObject *watched, QEvent *event)
{
    const bool asked = event->type() == QEvent::ShortcutOverride;
    if (!watched->isWidgetType() || (!asked && event->type() != QEvent::KeyPress))
        return false;
    const auto *key = static_cast<QKeyEvent *>(event);
    if (key->modifiers() != Qt::AltModifier || !belongsToMenu(key->keyCombination()))
        return false;
    if (asked) {
        mOwner = ownerOf(key->keyCombination());
        event->setAccepted(mOwner);
        return mOwner;
    }
    const QPointer<QWidget> owner = std::exchange(mOwner, nullptr);
    if (owner)
        activate(owner);
    return owner;
}
