#include "services/frame.h"

#include "platform/desktop/form.h"

namespace
{

Frame *gFrame = nullptr;

} // namespace

Frame *Frame::current()
{
    return gFrame;
}

void Frame::setCurrent(Frame *frame)
{
    gFrame = frame;
}

void setImportEnabled(bool enabled)
{
    if (gFrame)
        gFrame->setImportEnabled(enabled);
}

void setFramePointer(PointerShape shape)
{
    if (gFrame)
        Desktop::current().setPointer(gFrame->window(), shape);
}

void freezeFrame()
{
    if (gFrame)
        Desktop::current().freeze(gFrame->window());
}

void releaseFrame()
{
    Desktop::current().freeze(nullptr);
}

void placeInFrame(Form *form, double shareOfWidth, double shareOfHeight)
{
    if (!gFrame)
        return;
    const QSize frame = gFrame->size();
    form->setPlace({int(frame.width() * shareOfWidth), int(frame.height() * shareOfHeight)});
}

void makeRoomInFrame(const Form *form)
{
    if (!gFrame)
        return;
    QSize frame = gFrame->size();
    if (form->width() > frame.width())
        frame.setWidth(qRound(form->width() * 1.4));
    if (form->height() > frame.height())
        frame.setHeight(qRound(form->height() * 1.2));
    if (frame != gFrame->size())
        gFrame->window()->resize(frame);
}
