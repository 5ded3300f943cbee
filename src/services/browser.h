#pragma once

/// The browser of the collection as other screens see it: who has changed the catalogue calls
/// refreshBrowser(), and nothing happens if the browser is not open.
class Browser
{
public:
    virtual ~Browser() = default;
    virtual void RefreshLists() = 0;
};

void refreshBrowser();
