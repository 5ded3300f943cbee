#pragma once

#include "platform/desktop/desktop.h"

#include <QSize>

class Form;
class QAction;
class QWidget;

/// What the screens may do with the frame that they stand in. There is none in a test of one
/// screen.
class Frame
{
public:
    virtual ~Frame() = default;
    virtual QWidget *window() = 0;
    virtual QSize size() const = 0; // in pixels
    virtual void setImportEnabled(bool enabled) = 0;

    /// The entry of the menu with this name, nothing if there is none.
    virtual QAction *command(const QString & /*name*/) { return nullptr; }

    static Frame *current();
    static void setCurrent(Frame *frame);
};

// The same, harmless without a frame.
void setImportEnabled(bool enabled);
void setFramePointer(PointerShape shape);
void freezeFrame();
void releaseFrame();
QAction *frameCommand(const QString &name);

/// For the load of a form: it will stand at this share of the frame's size, no larger than the
/// screen.
void placeInFrame(Form *form, double shareOfWidth, double shareOfHeight);

/// For the load of a form: a frame that is smaller than the form grows beyond it, as far as the
/// screen has room. One that is maximized stays so.
void makeRoomInFrame(const Form *form);

/// Places a window of its own on its screen: with this size of its inside as far as there is room,
/// its upper left corner here or as much further up and left as it takes to be seen whole.
void placeOnScreen(QWidget *window, QPoint corner, QSize size);
