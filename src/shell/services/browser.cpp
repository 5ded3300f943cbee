#include "shell/services/browser.h"

#include "platform/desktop/form.h"

void refreshBrowser()
{
    const auto forms = Form::openForms();
    for (Form *form : forms) {
        if (form->Name() != QLatin1String("frmCDList"))
            continue;
        if (auto *browser = dynamic_cast<Browser *>(form))
            browser->RefreshLists();
    }
}
