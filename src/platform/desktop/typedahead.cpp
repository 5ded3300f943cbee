#include "platform/desktop/typedahead.h"

#include "platform/desktop/desktop.h"

#include <QDialog>
#include <QKeyEvent>

namespace
{

constexpr qint64 unanswerable = 700; // ms

// By the key, for one that is posted need not bring a text. Those with a sign are below Esc.
bool isTyped(const QKeyEvent &key)
{
    return key.key() < Qt::Key_Escape &&
           !(key.modifiers() & (Qt::AltModifier | Qt::ControlModifier));
}

class TypedAhead : public QObject
{
public:
    TypedAhead(QDialog *box, Desktop &clock) : QObject(box), mBox(box), mClock(clock)
    {
        box->installEventFilter(this);
        for (QWidget *part : box->findChildren<QWidget *>())
            part->installEventFilter(this); // a button with the focus takes a blank for itself
    }

protected:
    bool eventFilter(QObject *watched, QEvent *event) override
    {
        switch (event->type()) {
        case QEvent::Show:
        case QEvent::Paint:
            if (watched == mBox)
                comesUp(event->type());
            break;
        case QEvent::ShortcutOverride:
        case QEvent::KeyPress:
            return swallows(static_cast<QKeyEvent &>(*event));
        default:
            break;
        }
        return false;
    }

private:
    // A slow desktop shows it long after it was told to.
    void comesUp(QEvent::Type how)
    {
        if (mIsPainted)
            return;
        mIsPainted = how == QEvent::Paint;
        mSince = mClock.now();
    }

    bool swallows(QKeyEvent &key) const
    {
        const qint64 seen = mSince.msecsTo(mClock.now());
        const bool isEarly = seen >= 0 && seen < unanswerable; // the clock may be put back
        if (!isTyped(key) || (!isEarly && !key.isAutoRepeat()))
            return false;
        key.accept();
        return true;
    }

    QDialog *mBox;
    Desktop &mClock;
    QDateTime mSince;
    bool mIsPainted = false;
};

} // namespace

void ignoreTypedAhead(QDialog *box, Desktop &clock)
{
    new TypedAhead(box, clock);
}
