#pragma once

#include "platform/desktop/desktop.h"

#include <QSize>

class Form;
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

    static Frame *current();
    static void setCurrent(Frame *frame);
};

// The same, harmless without a frame.
void setImportEnabled(bool enabled);
void setFramePointer(PointerShape shape);
void freezeFrame();
void releaseFrame();

/// For the load of a form: it will stand at this share of the frame's size.
void placeInFrame(Form *form, double shareOfWidth, double shareOfHeight);

/// For the load of a form: a frame that is smaller than the form grows beyond it.
void makeRoomInFrame(const Form *form);
