#include "reports/accessiblepage.h"

#include "reports/reportview.h"

AccessiblePage::AccessiblePage(ReportView *view) : QAccessibleWidget(view, QAccessible::Document) {}

void AccessiblePage::install()
{
    static const bool installed = [] {
        QAccessible::installFactory([](const QString &, QObject *object) -> QAccessibleInterface * {
            auto *view = qobject_cast<ReportView *>(object);
            return view ? new AccessiblePage(view) : nullptr;
        });
        return true;
    }();
    Q_UNUSED(installed)
}

void AccessiblePage::pageChanged(ReportView *view)
{
    if (!QAccessible::isActive())
        return;
    QAccessibleTextUpdateEvent event(view, 0, {}, view->pageText());
    QAccessible::updateAccessibility(&event);
}

void *AccessiblePage::interface_cast(QAccessible::InterfaceType type)
{
    if (type == QAccessible::TextInterface)
        return static_cast<QAccessibleTextInterface *>(this);
    return QAccessibleWidget::interface_cast(type);
}

QAccessible::State AccessiblePage::state() const
{
    auto state = QAccessibleWidget::state();
    state.readOnly = true;
    state.multiLine = true;
    return state;
}

QString AccessiblePage::pageText() const
{
    return static_cast<const ReportView *>(widget())->pageText();
}

QString AccessiblePage::text(int startOffset, int endOffset) const
{
    return pageText().mid(startOffset, endOffset - startOffset);
}

int AccessiblePage::characterCount() const
{
    return int(pageText().size());
}

void AccessiblePage::selection(int, int *startOffset, int *endOffset) const
{
    *startOffset = *endOffset = 0;
}

QString AccessiblePage::attributes(int, int *startOffset, int *endOffset) const
{
    *startOffset = 0;
    *endOffset = characterCount();
    return {};
}
