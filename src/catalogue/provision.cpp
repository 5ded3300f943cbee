#include "catalogue/provision.h"

#include "platform/desktop/desktop.h"
#include "platform/desktop/programfolder.h"
#include "platform/error/error.h"
#include "platform/files/wholefile.h"
#include "services/messages.h"

#include <QDir>
#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr auto shipped = ":/catalogue/empty-catalogue";
constexpr int otherStartAtMost = 5000; // milliseconds

bool copyCatalogue(const QString &to)
{
    QFile from(QLatin1String{shipped});
    WholeFile copy(to);
    if (!from.open(QIODevice::ReadOnly) || !copy.open(QIODevice::WriteOnly))
        return false;
    copy.write(from.readAll());
    return copy.commit();
}

// On the disk before it returns: the folder gets its name only with the catalogue whole in it.
bool makeFolder(const QString &folder, CatalogueLock &lock)
{
    QDir beside(folder + u".new"_s);
    beside.removeRecursively(); // an attempt that did not get through
    const QString catalogue = programfolder::catalogueIn(beside.path());
    const bool made = QDir().mkpath(beside.path()) && copyCatalogue(catalogue) &&
                      lock.take(catalogue) != FileLock::Outcome::Held &&
                      QDir().rename(beside.path(), folder) &&
                      syncFolder(QFileInfo(folder).absolutePath());
    if (!made)
        beside.removeRecursively();
    return made;
}

// Two first starts at once: the second one finds what the first has made, and its lock held.
bool makeOrFind(const QString &folder, CatalogueLock &lock)
{
    const QString guard = folder + u".lock"_s;
    QDir().mkpath(QFileInfo(folder).absolutePath());
    FileLock oneAtATime;
    if (oneAtATime.takeWithin(guard, otherStartAtMost) == FileLock::Outcome::Held)
        return false;
    const bool there = QFileInfo::exists(folder);
    if (there && lock.take(programfolder::catalogueIn(folder)) == FileLock::Outcome::Held)
        throw Error(errCannotUse, u"Songcase"_s, GetMessage("xInUse"));
    const bool made = there || makeFolder(folder, lock);
    QFile::remove(guard);
    return made;
}

} // namespace

CatalogueLock provisionCatalogue()
{
    CatalogueLock lock;
    const QString folder = Desktop::current().programFolder();
    if (folder != programfolder::userFolder() || QFileInfo::exists(folder))
        return lock;
    if (!makeOrFind(folder, lock))
        throw Error(errCannotUse, u"Songcase"_s,
                    GetMessage("xCannotMakeCatalogue") + QDir::toNativeSeparators(folder));
    lock.markRunning(programfolder::catalogueIn(folder));
    return lock;
}
