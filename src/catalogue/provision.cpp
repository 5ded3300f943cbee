#include "catalogue/provision.h"

#include "platform/ado/error.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/programfolder.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/fileutilities.h"
#include "shell/services/messages.h"
#include "shell/services/wholefile.h"

#include <QDir>
#include <QFileInfo>
#include <QSaveFile>

namespace
{

constexpr auto shipped = ":/catalogue/empty-catalogue";

bool firstStart(const QString &folder)
{
    clsRegistry settings;
    const bool startedBefore =
        settings.GetValue(settingsReadKey, QStringLiteral("Session")).isValid();
    return !startedBefore && !QFileInfo::exists(folder);
}

// On the disk before it returns: the folder gets its name only with the catalogue whole in it.
bool copyCatalogue(const QString &to)
{
    QFile from(QLatin1String{shipped});
    QSaveFile copy(to);
    if (!from.open(QIODevice::ReadOnly) || !copy.open(QIODevice::WriteOnly))
        return false;
    copy.write(from.readAll());
    return commitWhole(copy);
}

} // namespace

void provisionCatalogue()
{
    const QString folder = Desktop::current().programFolder();
    if (folder != programfolder::userFolder() || !firstStart(folder))
        return;
    const QString beside = folder + QStringLiteral(".new");
    QDir(beside).removeRecursively(); // an attempt that did not get through
    const bool made = QDir().mkpath(beside) &&
                      copyCatalogue(beside + QStringLiteral("/Compact4.orv")) &&
                      QDir().rename(beside, folder);
    if (!made)
        throw ADODB::Error(ADODB::errCannotUse, QStringLiteral("Songcase"),
                           GetMessage("xCannotMakeCatalogue") + QDir::toNativeSeparators(folder));
    syncFolder(QFileInfo(folder).absolutePath());
}
