#pragma once

#include <QList>
#include <QObject>
#include <functional>

class QTableView;

/// Keeps the columns of a table as wide as the table: columns with a share divide what the others
/// leave. What the user drags is a share too, unless told otherwise.
class ColumnShares : public QObject
{
    Q_OBJECT

public:
    enum Share { NotShown = -1, OwnWidth = 0 };
    enum class Dragged { Kept, Lost };

    /// By column: a share, OwnWidth for one that is as wide as its head and `least` digits, or
    /// NotShown. Shares are parts of `whole`; without one they are parts of their sum, and none
    /// becomes too narrow to be read.
    ColumnShares(QTableView *view, const QList<int> &shares, int least, int whole = 0,
                 Dragged dragged = Dragged::Kept);

    void layOut();

    /// Runs what makes the columns anew; they get back the widths that they had, if the table is
    /// as wide as it was.
    void keepOver(const std::function<void()> &remake);

private:
    void restore();
    int layOutOwn();
    int ownWidth(int column) const;
    void keep();

    QTableView *mView;
    QList<int> mShares, mWidths;
    const int mLeast;
    int mWhole, mRoom = 0;
    const bool mKeep;
    bool mLayingOut = false;
};
