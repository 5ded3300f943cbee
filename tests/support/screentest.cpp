#include "support/screentest.h"

#include <QCoreApplication>

void ScreenTest::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
}

void ScreenTest::cleanup()
{
    const auto forms = Form::openForms();
    for (Form *form : forms)
        form->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}
