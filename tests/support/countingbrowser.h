#pragma once

#include "platform/desktop/form.h"
#include "services/browser.h"
#include "support/texts.h"

/// Stands for the open browser and counts how often its lists are read anew.
class CountingBrowser : public Form, public Browser
{
public:
    CountingBrowser() : Form(u"frmCDList"_s) {}
    void RefreshLists() override { ++refreshed; }
    int refreshed = 0;
};
