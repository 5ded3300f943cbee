#pragma once

#include <QAccessibleWidget>

/// A screen as assistive tools have it: one that is modal is a dialog, however it is built.
class AccessibleForm : public QAccessibleWidget
{
public:
    explicit AccessibleForm(QWidget *form);

    static void install(); // for all forms

    QAccessible::Role role() const override;
    QAccessible::State state() const override;
};
