#include "support/program.h"

#include "services/clsRegistry.h"
#include "services/globals.h"

#include "platform/ado/connection.h"

#include <QAction>
#include <QCoreApplication>
#include <QTest>
#include <QTimer>

Program::Program(ScriptedDesktop &desktop)
    : mDesktop(desktop), mFrame(std::make_unique<MainScreen>())
{
}

Program::~Program()
{
    mFrame.reset();
    gConnection = std::make_unique<ADODB::Connection>();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

bool Program::start()
{
    if (!mFrame->Load())
        return false;
    auto *timer = mFrame->findChild<QTimer *>(u"Timer1"_s);
    timer->setInterval(0);
    return QTest::qWaitFor([this] { return mFrame->isVisible(); });
}

bool Program::end()
{
    const bool ended = mFrame->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    return ended;
}

QAction *Program::entry(const char *name) const
{
    auto *action = mFrame->findChild<QAction *>(QLatin1String(name));
    if (!action)
        missing("MainScreen", name);
    return action;
}

void Program::choose(const char *name)
{
    QAction *action = entry(name);
    if (!action || !action->isEnabled())
        QTest::qFail(qPrintable(u"Not to be chosen: "_s + QLatin1String(name)), __FILE__, __LINE__);
    else
        action->trigger();
}

Form *Program::screen(const char *name) const
{
    for (Form *form : Form::openForms()) {
        if (form->Name() == QLatin1String(name))
            return form;
    }
    return nullptr;
}

void Program::missing(const char *screenName, const char *name) const
{
    QTest::qFail(
        qPrintable(u"Not there: %1 on %2"_s.arg(QLatin1String(name), QLatin1String(screenName))),
        __FILE__, __LINE__);
}

void storeLanguage(int language)
{
    clsRegistry settings;
    settings.CreateKey(settingsKey);
    settings.SetValue(settingsKey, u"Language"_s, language);
}
