#pragma once

#include <QAccessibleWidget>

class ReportView;

/// A preview as assistive tools have it: a document with the lines of the page that shows.
class AccessiblePage : public QAccessibleWidget, public QAccessibleTextInterface
{
public:
    explicit AccessiblePage(ReportView *view);

    static void install(); // for all previews that are made from now on

    /// Tells of another page, if a tool listens.
    static void pageChanged(ReportView *view);

    void *interface_cast(QAccessible::InterfaceType type) override;
    QAccessible::Role role() const override { return QAccessible::Document; }
    QAccessible::State state() const override;

    QString text(int startOffset, int endOffset) const override;
    int characterCount() const override;
    int cursorPosition() const override { return mCursor; }
    void setCursorPosition(int position) override { mCursor = position; }
    using QAccessibleWidget::text;

    // Nothing can be selected, and letters have no places of their own.
    void selection(int, int *startOffset, int *endOffset) const override;
    int selectionCount() const override { return 0; }
    void addSelection(int, int) override {}
    void removeSelection(int) override {}
    void setSelection(int, int, int) override {}
    QRect characterRect(int) const override { return {}; }
    int offsetAtPoint(const QPoint &) const override { return -1; }
    void scrollToSubstring(int, int) override {}
    QString attributes(int offset, int *startOffset, int *endOffset) const override;

private:
    QString pageText() const;

    int mCursor = 0;
};
