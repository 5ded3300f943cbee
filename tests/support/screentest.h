#pragma once

#include "platform/desktop/form.h"
#include "services/globals.h"
#include "services/messages.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <memory>

/// What a test of a screen stands on: English, a desktop and an empty catalogue before each case.
/// Behind it all screens go, and what was announced to the desktop must have come.
class ScreenTest : public QObject
{
    Q_OBJECT

protected slots:
    void init();
    void cleanup();

protected:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
};
