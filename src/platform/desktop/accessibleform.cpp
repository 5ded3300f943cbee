#include "platform/desktop/accessibleform.h"

#include "platform/desktop/form.h"

AccessibleForm::AccessibleForm(QWidget *form) : QAccessibleWidget(form) {}

void AccessibleForm::install()
{
    static const bool installed = [] {
        QAccessible::installFactory([](const QString &, QObject *object) -> QAccessibleInterface * {
            auto *form = qobject_cast<Form *>(object);
            return form ? new AccessibleForm(form) : nullptr;
        });
        return true;
    }();
    Q_UNUSED(installed)
}

QAccessible::Role AccessibleForm::role() const
{
    return widget()->isModal() ? QAccessible::Dialog : QAccessibleWidget::role();
}

QAccessible::State AccessibleForm::state() const
{
    auto state = QAccessibleWidget::state();
    state.modal = widget()->isModal();
    return state;
}
