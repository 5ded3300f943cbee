#include "platform/desktop/desktop.h"

#include <utility>

using namespace Qt::StringLiterals;

namespace
{

Desktop *gDesktop = nullptr;
QString gBoxTitle = u"Songcase"_s;

BoxAnswer box(BoxKind kind, BoxButtons buttons, const QString &text, const QString &title)
{
    return Desktop::current().messageBox(kind, buttons, text, title.isEmpty() ? gBoxTitle : title);
}

} // namespace

Desktop &Desktop::current()
{
    Q_ASSERT(gDesktop);
    return *gDesktop;
}

Desktop *Desktop::setCurrent(Desktop *desktop)
{
    return std::exchange(gDesktop, desktop);
}

void setBoxTitle(const QString &title)
{
    gBoxTitle = title;
}

void errorBox(const QString &text, const QString &title)
{
    box(BoxKind::Error, BoxButtons::Ok, text, title);
}

void warningBox(const QString &text)
{
    box(BoxKind::Warning, BoxButtons::Ok, text, {});
}

void plainBox(const QString &text)
{
    box(BoxKind::Plain, BoxButtons::Ok, text, {});
}

void informationBox(const QString &text, const QString &title)
{
    box(BoxKind::Information, BoxButtons::Ok, text, title);
}

BoxAnswer askYesNo(const QString &text, const QString &title)
{
    return box(BoxKind::Question, BoxButtons::YesNo, text, title);
}

BoxAnswer askYesNoCancel(const QString &text, const QString &title)
{
    return box(BoxKind::Question, BoxButtons::YesNoCancel, text, title);
}

Hourglass::Hourglass(QWidget *window) : mWindow(window)
{
    Desktop::current().setPointer(mWindow, vbHourglass);
}

Hourglass::~Hourglass()
{
    if (mWindow)
        Desktop::current().setPointer(mWindow, vbDefault);
}
