#include "platform/desktop/form.h"

#include "platform/desktop/accessibleform.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/nestedloop.h"

#include <QApplication>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QPushButton>
#include <QTimer>

namespace
{

QList<Form *> gOpenForms;
Form::Host *gHost = nullptr;

// Deletes a widget once no routine waits, whose it may be. Looked after again and again: a box may
// be open for long.
void deleteInMainLoop(QWidget *widget)
{
    constexpr int again = 20; // milliseconds
    if (NestedLoop::none())
        widget->deleteLater();
    else
        QTimer::singleShot(again, widget, [widget] { deleteInMainLoop(widget); });
}

} // namespace

/// Tells forms when they become the active one, however that came about: by window, by MDI child or
/// by the focus alone (there may be no window manager).
class FormActivation : public QObject
{
public:
    static void watch() { static FormActivation watcher; }

private:
    FormActivation()
    {
        connect(qApp, &QApplication::focusChanged, this, [this](QWidget *, QWidget *now) {
            Form *form = formOf(now);
            if (!form || form == mActive)
                return;
            mActive = form;
            form->Form_Activate();
            emit form->activated();
        });
    }

    static Form *formOf(QWidget *widget)
    {
        while (widget && !qobject_cast<Form *>(widget))
            widget = widget->parentWidget();
        return static_cast<Form *>(widget);
    }

    QPointer<Form> mActive;
};

Form::Form(const QString &name)
{
    setObjectName(name);
    gOpenForms.append(this);
    FormActivation::watch();
    AccessibleForm::install();
}

Form::~Form()
{
    gOpenForms.removeOne(this);
}

const QList<Form *> &Form::openForms()
{
    return gOpenForms;
}

Form *Form::busyForm()
{
    const auto busy = std::find_if(gOpenForms.begin(), gOpenForms.end(),
                                   [](const Form *form) { return form->isBusy(); });
    return busy == gOpenForms.end() ? nullptr : *busy;
}

void Form::setHost(Host *host)
{
    gHost = host;
}

void Form::Load()
{
    if (mLoaded)
        return;
    mLoaded = true;
    Form_Load();
}

void Form::Show()
{
    const bool first = !isVisible();
    Load();
    if (mUnloaded)
        return;
    if (gHost && first)
        gHost->adopt(this);
    else if (gHost)
        gHost->bringUp(this);
    else
        show();
}

void Form::ShowModal()
{
    Load();
    if (mUnloaded)
        return;
    if (gHost && mPlace)
        move(gHost->origin() + *mPlace);
    Desktop::current().showModal(*this);
}

bool Form::Unload()
{
    if (mUnloaded)
        return true;
    if (!agreesToGo())
        return false;
    finishUnload();
    return true;
}

// While one is asked others may come and go.
bool Form::UnloadAll(const QString &except, bool forced)
{
    QSet<Form *> asked;
    const auto nextToAsk = [&]() -> Form * {
        const auto next = std::find_if(gOpenForms.begin(), gOpenForms.end(), [&](Form *form) {
            return form->Name() != except && !asked.contains(form);
        });
        return next == gOpenForms.end() ? nullptr : *next;
    };
    while (Form *form = nextToAsk()) {
        asked.insert(form);
        if (!forced && !form->agreesToGo())
            return false;
    }
    const auto forms = gOpenForms;
    for (Form *form : forms) {
        if (form->Name() != except && !form->mUnloaded)
            form->finishUnload();
    }
    return true;
}

Form::Busy::~Busy()
{
    if (mForm)
        --mForm->mWorks;
}

bool Form::Reload()
{
    const QPointer<QWidget> focus = focusWidget();
    if (focus)
        setFocus();
    const bool goes = QueryUnload();
    if (goes) {
        Form_Unload();
        Form_Load();
    }
    if (focus && !mUnloaded)
        focus->setFocus();
    return goes && !mUnloaded;
}

// The widget itself lives until the main event loop comes round: its own handlers may still be
// running, also those that wait for an answer.
void Form::finishUnload()
{
    mUnloaded = true;
    gOpenForms.removeOne(this);
    Form_Unload();
    hide();
    if (QWidget *host = parentWidget(); host && host->inherits("QMdiSubWindow"))
        deleteInMainLoop(host); // and the form in it
    else
        deleteInMainLoop(this);
    emit unloaded();
}

void Form::closeEvent(QCloseEvent *event)
{
    event->setAccepted(Unload());
}

void Form::hideEvent(QHideEvent *event)
{
    QWidget::hideEvent(event);
    if (!event->spontaneous())
        emit hid();
}

void Form::setDefaultButton(QPushButton *button)
{
    mDefault = button;
    button->setDefault(true);
}

void Form::setCancelButton(QPushButton *button)
{
    mCancel = button;
}

void Form::keyPressEvent(QKeyEvent *event)
{
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    const bool escape = event->key() == Qt::Key_Escape;
    QPushButton *button = nullptr;
    if (enter)
        button = qobject_cast<QPushButton *>(focusWidget());
    if (enter && !button)
        button = mDefault;
    if (escape)
        button = mCancel;
    if (button && button->isVisible() && button->isEnabled())
        button->click();
    else
        QWidget::keyPressEvent(event);
}
