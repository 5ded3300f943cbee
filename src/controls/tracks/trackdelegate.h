#pragma once

#include "controls/list/rowdelegate.h"
#include "controls/tracks/celledit.h"

#include <QPointer>

/// Draws and edits the cells of a track grid.
class TrackDelegate : public RowDelegate
{
    Q_OBJECT

public:
    /// What the grid knows of the cell that is going to be edited.
    struct Cell {
        QString name; // for screen readers
        CellEdit::Suggestions suggestions;
        QStringList list; // to choose from; none for most
        QString listName;
    };
    using Describe = std::function<Cell(const QModelIndex &index)>;

    TrackDelegate(Describe describe, QObject *parent);

    /// The field of the cell being edited, null if none is.
    CellEdit *edit() const { return mEdit; }

    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    void destroyEditor(QWidget *editor, const QModelIndex &index) const override;

signals:
    void cancelled() const;
    void gridKey(QKeyEvent *event) const;
    void cutOff() const; // more was typed or pasted than the cell can take

protected:
    bool eventFilter(QObject *editor, QEvent *event) override;
    void initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const override;

private:
    const Describe mDescribe;
    mutable QPointer<CellEdit> mEdit;
};
