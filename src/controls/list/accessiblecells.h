#pragma once

class QAbstractItemView;
class QModelIndex;

// What the views of the toolkit leave out for assistive tools. Nothing happens if none listens.

/// Tells of the current row as the place of the focus; for a view that has just got it.
void tellCurrentRow(QAbstractItemView *view);

/// Tells that a node that shows was opened or closed.
void tellExpanded(QAbstractItemView *tree, const QModelIndex &node);
