#include "services/frame.h"

#include "platform/desktop/form.h"

#include <QScreen>
#include <QStyle>
#include <algorithm>

namespace
{

Frame *gFrame = nullptr;

// What the window manager draws around a window: known once it has done so, guessed before.
QSize decorationOf(const QWidget *window)
{
    if (window->isVisible())
        return window->frameGeometry().size() - window->size();
    const auto pixels = [window](QStyle::PixelMetric metric) {
        return window->style()->pixelMetric(metric, nullptr, window);
    };
    const int border = 2 * pixels(QStyle::PM_MdiSubWindowFrameWidth);
    return {border, border + pixels(QStyle::PM_TitleBarHeight)};
}

// The corner is that of the decoration, the size that of the inside.
QRect onScreen(const QWidget *window, const QRect &wanted)
{
    const QRect screen = window->screen()->availableGeometry();
    const QSize decoration = decorationOf(window);
    const QSize size = wanted.size().boundedTo(screen.size() - decoration);
    const QSize whole = size + decoration;
    const auto inside = [](int at, int from, int last) {
        return std::max(from, std::min(at, last));
    };
    return {QPoint(inside(wanted.x(), screen.left(), screen.right() + 1 - whole.width()),
                   inside(wanted.y(), screen.top(), screen.bottom() + 1 - whole.height())),
            size};
}

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

QAction *frameCommand(const QString &name)
{
    return gFrame ? gFrame->command(name) : nullptr;
}

void placeInFrame(Form *form, double shareOfWidth, double shareOfHeight)
{
    if (!gFrame)
        return;
    const QSize frame = gFrame->size();
    const QPoint wanted(int(frame.width() * shareOfWidth), int(frame.height() * shareOfHeight));
    const QPoint origin = gFrame->window()->pos();
    const QRect place = onScreen(gFrame->window(), {origin + wanted, form->size()});
    form->resize(place.size());
    form->setPlace(place.topLeft() - origin);
}

void makeRoomInFrame(const Form *form)
{
    if (!gFrame || gFrame->window()->windowState() & (Qt::WindowMaximized | Qt::WindowFullScreen))
        return;
    QSize frame = gFrame->size();
    if (form->width() > frame.width())
        frame.setWidth(qRound(form->width() * 1.4));
    if (form->height() > frame.height())
        frame.setHeight(qRound(form->height() * 1.2));
    if (frame != gFrame->size())
        placeOnScreen(gFrame->window(), gFrame->window()->pos(), frame);
}

void placeOnScreen(QWidget *window, QPoint corner, QSize size)
{
    const QRect place = onScreen(window, {corner, size});
    window->move(place.topLeft());
    window->resize(place.size());
}
