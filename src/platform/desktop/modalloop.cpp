#include "platform/desktop/modalloop.h"

#include "platform/desktop/form.h"

#include <QEventLoop>

void runModal(Form &form)
{
    const auto frameless = form.windowFlags() & Qt::FramelessWindowHint;
    form.setWindowFlags(Qt::Dialog | frameless);
    form.setWindowModality(Qt::ApplicationModal);
    const QPointer<Form> alive = &form;
    QEventLoop loop;
    QObject::connect(&form, &Form::hid, &loop, &QEventLoop::quit);
    QObject::connect(&form, &QObject::destroyed, &loop, &QEventLoop::quit);
    form.show(); // may handle events, and the form may be through already
    if (!alive || !form.isVisible())
        return;
    form.activateWindow();
    loop.exec();
}
