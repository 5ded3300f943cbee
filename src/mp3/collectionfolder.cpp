#include "mp3/collectionfolder.h"

#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/messages.h"

#include <QDir>

QString pathInFolder(const QString &folder, const QString &fileName)
{
    return systemPath(folder + QDir::separator() + fileName);
}

std::optional<bool> isFolderThere(Form &screen, const QString &folder)
{
    std::optional<bool> isThere;
    LongWork work(screen, GetMessage("xLookingForFolder"));
    const auto look = [folder](qsizetype, const std::stop_token &) { return DirExists(folder); };
    work.eachOf<bool>(1, look, [&](qsizetype, bool &&found) { isThere = found; });
    return isThere;
}
