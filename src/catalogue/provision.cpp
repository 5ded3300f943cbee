#include "catalogue/provision.h"

#include "platform/desktop/desktop.h"
#include "platform/desktop/programfolder.h"
#include "platform/error/error.h"
#include "services/clsRegistry.h"
#include "services/messages.h"
#include "services/wholefile.h"

#include <QDir>
#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr auto shipped = ":/catalogue/empty-catalogue";

bool firstStart(const QString &folder)
{
    clsRegistry settings;
    const bool startedBefore = settings.GetValue(settingsReadKey, u"Session"_s).isValid();
    return !startedBefore && !QFileInfo::exists(folder);
}

// On the disk before it returns: the folder gets its name only with the catalogue whole in it.
bool copyCatalogue(const QString &to)
{
    QFile from(QLatin1String{shipped});
    WholeFile copy(to);
    if (!from.open(QIODevice::ReadOnly) || !copy.open(QIODevice::WriteOnly))
        return false;
    copy.write(from.readAll());
    return copy.commit();
}

} // namespace

void provisionCatalogue()
{
    const QString folder = Desktop::current().programFolder();
    if (folder != programfolder::userFolder() || !firstStart(folder))
        return;
    const QString beside = folder + u".new"_s;
    QDir(beside).removeRecursively(); // an attempt that did not get through
    const bool made = QDir().mkpath(beside) && copyCatalogue(beside + u"/Compact4.orv"_s) &&
                      QDir().rename(beside, folder);
    if (made && syncFolder(QFileInfo(folder).absolutePath()))
        return;
    QDir(beside).removeRecursively();
    throw Error(errCannotUse, u"Songcase"_s,
                GetMessage("xCannotMakeCatalogue") + QDir::toNativeSeparators(folder));
}
