#include "services/browser.h"

#include "platform/desktop/form.h"

using namespace Qt::StringLiterals;

void refreshBrowser()
{
    const auto forms = Form::openForms();
    for (Form *form : forms) {
        if (form->Name() != "frmCDList"_L1)
            continue;
        if (auto *browser = dynamic_cast<Browser *>(form))
            browser->RefreshLists();
    }
}
