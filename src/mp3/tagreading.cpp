#include "mp3/tagreading.h"

#include "mp3/collectionfolder.h"
#include "platform/error/error.h"

#include <QDir>

FileFound lookAtFile(const QString &folder, const QString &fileName, const FileMemory &remembered)
{
    FileFound found;
    found.memory = remembered;
    if (remembered.state == FileMemory::Left)
        return found;
    QString path = folder + QDir::separator() + fileName; // which most files have as it stands
    auto stamp = stampOfOrdinaryFile(path);
    if (!stamp) {
        path = pathInFolder(folder, fileName);
        stamp = stampOfOrdinaryFile(path);
    }
    if (!stamp) {
        found.isNew = remembered.state != FileMemory::Missing;
        found.memory = {FileMemory::Missing, {}};
        return found;
    }
    const bool isSame = remembered.stamp == *stamp;
    if (remembered.state == FileMemory::Read && isSame)
        return found;
    found.isNew = true;
    found.memory = {FileMemory::Read, *stamp}; // what changes while it is read is seen next time
    try {
        found.tag.LoadFromFile(path, 1);
    } catch (const Error &) {
        found.memory.state = FileMemory::Unreadable;
        found.isNew = remembered.state != FileMemory::Unreadable || !isSame;
    }
    return found;
}
