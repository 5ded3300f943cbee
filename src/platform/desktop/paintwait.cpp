#include "platform/desktop/paintwait.h"

#include "platform/desktop/nestedloop.h"

#include <QCoreApplication>
#include <QElapsedTimer>

void paintUntil(const std::function<bool()> &come, int longest)
{
    const NestedLoop painting;
    QElapsedTimer waited;
    waited.start();
    while (!come() && waited.elapsed() < longest)
        QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents, 5);
}

void paintAlone()
{
    const NestedLoop painting;
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents |
                                    QEventLoop::ExcludeSocketNotifiers |
                                    QEventLoop::X11ExcludeTimers);
}
