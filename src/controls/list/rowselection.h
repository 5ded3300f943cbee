#pragma once

#include <QItemSelectionModel>

/// The selection of a list. Qt compares all ranges of a new selection with all old ones, which
/// takes minutes when sorting has scattered hundreds of thousands of selected rows; here such a
/// selection is dropped first, and one signal asks the list to be painted anew.
class RowSelection : public QItemSelectionModel
{
    Q_OBJECT

public:
    using QItemSelectionModel::QItemSelectionModel;

    void select(const QItemSelection &rows, SelectionFlags command) override;
    using QItemSelectionModel::select;

signals:
    void dropped();
};
