#include "platform/desktop/desktop.h"

#include <QCoreApplication>
#include <QGuiApplication>

namespace
{

Desktop *gDesktop = nullptr;

BoxAnswer box(BoxKind kind, BoxButtons buttons, const QString &text, const QString &title)
{
    const QString shown = title.isEmpty() ? QGuiApplication::applicationDisplayName() : title;
    return Desktop::current().messageBox(kind, buttons, text, shown);
}

} // namespace

Desktop &Desktop::current()
{
    Q_ASSERT(gDesktop);
    return *gDesktop;
}

void Desktop::setCurrent(Desktop *desktop)
{
    gDesktop = desktop;
}

void errorBox(const QString &text, const QString &title)
{
    box(BoxKind::Error, BoxButtons::Ok, text, title);
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
