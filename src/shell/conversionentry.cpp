#include "shell/conversionentry.h"

#include "conversion/frmAutoUpdateUtility.h"
#include "platform/ado/connection.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/MainScreen.h"

#include <QAction>
#include <utility>

using namespace Qt::StringLiterals;

namespace
{

bool isCatalogueOpen()
{
    return gConnection && gConnection->State() == ADODB::adStateOpen;
}

void showConversion()
{
    if (isCatalogueOpen())
        defaultInstance<frmAutoUpdateUtility>().ShowModal();
    else
        errorBox(GetMessage("xErrCannotOpen"), GetMessage("MsgSysErr"));
}

} // namespace

void connectConversionEntry(MainScreen &frame)
{
    QObject::connect(frame.command(u"mnuConvertDatabase"_s), &QAction::triggered, &frame,
                     showConversion);
}

void offerConversion(bool &pending)
{
    if (std::exchange(pending, false) && isCatalogueOpen())
        showConversion();
}
