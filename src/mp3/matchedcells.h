#pragma once

#include "controls/list/rowdelegate.h"
#include "platform/ado/rows.h"

#include <memory>

/// Draws the cells of a list so that those stand out whose text is another than in the rows that it
/// was filled from; the tool tip tells what was there before. For a list that is not sorted.
class MatchedCells : public RowDelegate
{
    Q_OBJECT

public:
    using RowDelegate::RowDelegate;

    void setBefore(std::shared_ptr<const ADODB::Rows> rows) { mBefore = std::move(rows); }

    bool helpEvent(QHelpEvent *event, QAbstractItemView *view, const QStyleOptionViewItem &option,
                   const QModelIndex &index) override;

protected:
    void initStyleOption(QStyleOptionViewItem *option, const QModelIndex &index) const override;

private:
    bool isChanged(const QModelIndex &index) const;

    std::shared_ptr<const ADODB::Rows> mBefore;
};
