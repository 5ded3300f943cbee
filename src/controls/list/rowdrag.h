#pragma once

#include <QCursor>
#include <QObject>

class DBListViewCTL;
class QMouseEvent;

/// A drag inside a list that its screen handles: follows the pointer between Drag(1) and the
/// release of the button, scrolls the list when the pointer rests near its upper or lower edge, and
/// tells through the list's DragOver and DragDrop. Nothing is moved here.
class RowDrag : public QObject
{
    Q_OBJECT

public:
    explicit RowDrag(DBListViewCTL *list);

    bool running() const { return mRunning; }
    void begin();
    void end();
    void setCursor(const QCursor &cursor);

    void pointerMoved(QPoint to);
    void released(QPoint at); // ends the drag, then tells of the drop

private:
    void scrollAtEdge();
    void tellOver(QPoint at, int state);

    DBListViewCTL *mList;
    class QTimer *mScroll;
    QCursor mCursor{Qt::DragMoveCursor};
    bool mRunning = false;
    bool mInside = false;
    QPoint mAt;
};
