#include "platform/desktop/modalloop.h"

#include "platform/desktop/form.h"
#include "platform/desktop/nestedloop.h"

#include <QApplication>
#include <QEventLoop>
#include <QMessageBox>
#include <QPushButton>
#include <QScreen>

void runModal(Form &form)
{
    const auto frameless = form.windowFlags() & Qt::FramelessWindowHint;
    form.setWindowFlags(Qt::Dialog | frameless);
    form.setWindowModality(Qt::ApplicationModal);
    form.resize(form.size().boundedTo(form.screen()->availableSize())); // its buttons are below
    const QPointer<Form> alive = &form;
    QEventLoop loop;
    QObject::connect(&form, &Form::hid, &loop, &QEventLoop::quit);
    QObject::connect(&form, &QObject::destroyed, &loop, &QEventLoop::quit);
    form.show(); // may handle events, and the form may be through already
    if (!alive || !form.isVisible())
        return;
    form.activateWindow();
    const NestedLoop nested;
    loop.exec();
}

namespace
{

bool gRefused = false;

void refuse(const QMessageBox &box)
{
    gRefused = true;
    for (const auto answer : {QMessageBox::Cancel, QMessageBox::No, QMessageBox::Ok}) {
        if (QAbstractButton *button = box.button(answer)) {
            button->click();
            return;
        }
    }
}

} // namespace

bool modalWasRefused()
{
    return gRefused;
}

void setModalAnswered()
{
    gRefused = false;
}

void refuseModal()
{
    QWidget *top = QApplication::activeModalWidget();
    if (const auto *box = qobject_cast<QMessageBox *>(top))
        refuse(*box);
    else if (auto *dialog = qobject_cast<QDialog *>(top))
        dialog->reject();
    else if (auto *form = qobject_cast<Form *>(top))
        form->Unload();
}
