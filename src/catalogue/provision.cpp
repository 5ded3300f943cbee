#include "catalogue/provision.h"

#include "platform/ado/error.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/programfolder.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/messages.h"

#include <QDir>
#include <QFileInfo>

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

// The copy of a resource comes read-only.
bool copyCatalogue(const QString &to)
{
    return QFile::copy(QLatin1String(shipped), to) &&
           QFile::setPermissions(to, QFile::ReadOwner | QFile::WriteOwner | QFile::ReadGroup |
                                         QFile::ReadOther);
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
}
