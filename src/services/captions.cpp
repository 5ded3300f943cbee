#include "services/captions.h"

#include "platform/text/textrules.h"
#include "services/messages.h"

#include <QAction>
#include <QToolBar>
#include <QWidget>

namespace
{

QObject *controlOf(QWidget *screen, const char *name)
{
    const auto objectName = QString::fromLatin1(name);
    if (screen->objectName() == objectName)
        return screen;
    auto *control = screen->findChild<QObject *>(objectName);
    Q_ASSERT_X(control, "applyCaptions", name);
    return control;
}

void setToolTip(QObject *control, const QString &text)
{
    control->setProperty("toolTip", text);
    control->setProperty("accessibleName", text);
}

// Labels and buttons have "text", heads of frames and menus "title", screens "windowTitle". What is
// written on a toolbar is for screen readers.
void setText(QWidget *screen, QObject *control, const QString &text)
{
    const char *property = "text";
    if (qobject_cast<QToolBar *>(control))
        property = "accessibleName";
    else if (control == screen)
        property = "windowTitle";
    else if (control->metaObject()->indexOfProperty(property) < 0)
        property = "title";
    control->setProperty(property, text::withLineFeeds(text));
}

} // namespace

void applyCaptions(QWidget *screen, std::initializer_list<Caption> captions)
{
    for (const Caption &caption : captions) {
        QObject *control = controlOf(screen, caption.control);
        const QString text = GetMessage(caption.key);
        if (caption.where == Caption::ToolTip)
            setToolTip(control, text);
        else
            setText(screen, control, text);
    }
}
