#include "mp3/collectionfolder.h"

#include "services/fileutilities.h"

#include <QDir>

QString pathInFolder(const QString &folder, const QString &fileName)
{
    return systemPath(folder + QDir::separator() + fileName);
}
