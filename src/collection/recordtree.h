#pragma once

#include <QTreeWidget>

/// The collection seen from the artists: letters, below them artists, their tracks, and the discs
/// on which a track stands. Filled level by level as nodes are opened; a closed node holds a
/// placeholder, so that it can be opened. Nodes are told apart by their keys.
class RecordTree : public QTreeWidget
{
    Q_OBJECT

public:
    explicit RecordTree(QWidget *parent = nullptr);

    /// Back to the 27 closed roots.
    void resetRoots();

    static QString keyOf(const QTreeWidgetItem *node);

private:
    QTreeWidgetItem *addRoot(const QString &name);
};
