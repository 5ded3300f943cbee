#pragma once

#include <QLineEdit>
#include <QPointer>
#include <functional>

class QListWidget;

/// The field in which a cell of a track grid is edited. While one types it offers what begins so,
/// in a list below that takes no focus and changes nothing until an entry is chosen: with Down and
/// Enter, or the mouse. Going on typing is all it takes to do without.
class CellEdit : public QLineEdit
{
    Q_OBJECT

public:
    using Suggestions = std::function<QStringList(const QString &start)>;

    CellEdit(const QString &name, QWidget *parent);
    ~CellEdit() override;

    void setSuggestions(const Suggestions &suggestions) { mSuggestions = suggestions; }

    /// A list that is shown whole on Alt+Down or a click on the arrow.
    void setList(const QStringList &list, const QString &arrowName);

signals:
    void cancelled();

    /// A key that is the grid's, after the field is done with it. End belongs to the text when it
    /// is typed, and to the grid when a toolbar has sent it.
    void gridKey(QKeyEvent *event);

protected:
    bool event(QEvent *event) override;
    void hideEvent(QHideEvent *event) override;

private:
    QIcon arrowIcon() const;
    bool takeKey(QKeyEvent *event);
    bool takeListKey(QKeyEvent *event);
    void suggest();
    void showSuggestions(const QStringList &texts);
    void placePopup();
    void hidePopup();
    bool popupShown() const;
    void choose(int entry);

    Suggestions mSuggestions;
    QStringList mList;
    QPointer<QListWidget> mPopup; // in the window, over all that is in it
};
