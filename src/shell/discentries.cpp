#include "shell/discentries.h"

#include "discdata/ProxyInfo.h"
#include "discdata/cddbmenu.h"
#include "discdata/frmDiscInfoCDDB.h"
#include "shell/MainScreen.h"
#include "shell/startup.h"

#include <QAction>

using namespace Qt::StringLiterals;

namespace
{

void showProxy()
{
    defaultInstance<ProxyInfo>().ShowModal();
    startup::ReadProxySettings();
}

} // namespace

void connectDiscEntries(MainScreen &frame)
{
    const auto on = [&frame](const QString &entry, auto command) {
        QObject::connect(frame.command(entry), &QAction::triggered, &frame, command);
    };
    const auto lookUp = [] { defaultInstance<frmDiscInfoCDDB>().Show(); };
    on(u"mnuCDDB"_s, lookUp);
    on(u"tbCDDB"_s, lookUp);
    on(u"mnuRegisterCDDB"_s, [&frame] { registerAtServices(&frame); });
    const auto credits = [&frame] { showCredits(&frame); };
    on(u"mnuOverCDDB"_s, credits);
    on(u"tbCredits"_s, credits);
    on(u"mnuProxy"_s, showProxy);
}
