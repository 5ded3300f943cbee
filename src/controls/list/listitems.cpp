#include "controls/list/listitems.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listmodel.h"

ListItem::operator bool() const
{
    return mList && mRecord >= 0 && mFilling == mList->mModel->filling();
}

QString ListItem::SubItems(int n) const
{
    const bool there = *this && n >= 0 && n < mList->mModel->columnCount();
    return there ? mList->mModel->text(mRecord, n) : QString();
}

void ListItem::setSubItems(int n, const QString &text) const
{
    if (*this && n >= 0 && n < mList->mModel->columnCount())
        mList->mModel->write(mRecord, n, text);
}

int ListItem::Index() const
{
    return *this ? mList->mModel->rowOf(mRecord) + 1 : 0;
}

bool ListItem::Selected() const
{
    return *this && mList->selectionModel()->isSelected(mList->mModel->index(Index() - 1, 0));
}

void ListItem::setSelected(bool selected) const
{
    if (*this && selected != Selected())
        mList->setRowSelected(Index() - 1, selected);
}

void ListItem::EnsureVisible() const
{
    if (*this)
        mList->scrollTo(mList->shownIndex(Index() - 1));
}

bool ListItem::Bold() const
{
    return *this && mList->mModel->marks(mRecord).bold;
}

void ListItem::setBold(bool bold) const
{
    if (!*this)
        return;
    auto marks = mList->mModel->marks(mRecord);
    marks.bold = bold;
    mList->mModel->setMarks(mRecord, marks);
}

QColor ListItem::ForeColor() const
{
    return *this ? mList->mModel->marks(mRecord).color : QColor();
}

void ListItem::setForeColor(const QColor &color) const
{
    if (!*this)
        return;
    auto marks = mList->mModel->marks(mRecord);
    marks.color = color;
    mList->mModel->setMarks(mRecord, marks);
}

bool ListItem::Checked() const
{
    return *this && mList->mModel->marks(mRecord).checked;
}

void ListItem::setChecked(bool checked) const
{
    if (!*this)
        return;
    auto marks = mList->mModel->marks(mRecord);
    marks.checked = checked;
    mList->mModel->setMarks(mRecord, marks);
}

int ListItems::Count() const
{
    return mList->mModel->rowCount();
}

ListItem ListItems::Item(int index) const
{
    return mList->itemAt(index - 1);
}

bool ColumnHeader::exists() const
{
    return mIndex >= 1 && mIndex <= mList->mModel->columnCount();
}

QString ColumnHeader::Text() const
{
    return mList->mModel->headerData(mIndex - 1, Qt::Horizontal, Qt::DisplayRole).toString();
}

void ColumnHeader::setText(const QString &text) const
{
    mList->mModel->setHeaderData(mIndex - 1, Qt::Horizontal, text, Qt::EditRole);
}

int ColumnHeader::Width() const
{
    return exists() ? mList->columnWidthOf(mIndex - 1) : 0;
}

void ColumnHeader::setWidth(int width) const
{
    if (exists())
        mList->setColumnWidthOf(mIndex - 1, width);
}

void ColumnHeader::setAlignment(Qt::Alignment side) const
{
    if (exists())
        mList->mModel->setAlignment(mIndex - 1, side);
}

int ColumnHeaders::Count() const
{
    return mList->mModel->columnCount();
}
