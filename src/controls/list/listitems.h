#pragma once

#include <QColor>
#include <QString>

class DBListViewCTL;

/// One row of a list. It stays with its record when the list is sorted, and is nothing once the
/// list has been populated anew. What is asked of nothing is empty, what is done to it is lost.
class ListItem
{
public:
    ListItem() = default; // nothing
    explicit operator bool() const;

    QString Text() const { return SubItems(0); }
    QString SubItems(int n) const; // n columns behind the first
    void setSubItems(int n, const QString &text) const;

    int Index() const; // from 1, as shown

    /// Selecting a row adds it to the selection, without scrolling. It becomes the current one if
    /// the current one is not selected itself.
    bool Selected() const;
    void setSelected(bool selected) const;
    void EnsureVisible() const;

    bool Bold() const;
    void setBold(bool bold) const;
    QColor ForeColor() const;
    void setForeColor(const QColor &color) const; // an invalid colour is the usual one
    bool Checked() const;
    void setChecked(bool checked) const;

    friend bool operator==(const ListItem &a, const ListItem &b) = default;

private:
    friend class DBListViewCTL;
    ListItem(DBListViewCTL *list, int record, unsigned filling)
        : mList(list), mRecord(record), mFilling(filling)
    {
    }

    DBListViewCTL *mList = nullptr;
    int mRecord = -1;
    unsigned mFilling = 0; // the Populate that made the row
};

/// All rows of a list, in the order shown.
class ListItems
{
public:
    explicit ListItems(DBListViewCTL *list) : mList(list) {}
    int Count() const;
    ListItem Item(int index) const; // from 1; nothing outside of the list

private:
    DBListViewCTL *mList;
};

/// One column of a list, for as long as the list is not populated anew.
class ColumnHeader
{
public:
    ColumnHeader(DBListViewCTL *list, int index) : mList(list), mIndex(index) {}
    int Index() const { return mIndex; } // from 1
    QString Text() const;
    void setText(const QString &text) const;

    /// In pixels. A column of width 0 is hidden.
    int Width() const;
    void setWidth(int width) const;

    /// Of the caption and of all cells; to the left until it is set.
    void setAlignment(Qt::Alignment side) const;

private:
    bool exists() const;

    DBListViewCTL *mList;
    int mIndex;
};

/// All columns of a list, in the order of the fields.
class ColumnHeaders
{
public:
    explicit ColumnHeaders(DBListViewCTL *list) : mList(list) {}
    int Count() const;
    ColumnHeader Item(int index) const { return {mList, index}; } // from 1

private:
    DBListViewCTL *mList;
};
