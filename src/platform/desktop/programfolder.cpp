#include "platform/desktop/programfolder.h"

#include <QCoreApplication>
#include <QDir>
#include <QStandardPaths>

using namespace Qt::StringLiterals;

namespace programfolder
{

QString userFolder()
{
    return QStandardPaths::writableLocation(QStandardPaths::AppDataLocation);
}

QString find()
{
    if (const QString told = qEnvironmentVariable("SONGCASE_FOLDER"); !told.isEmpty())
        return QDir::cleanPath(QDir(told).absolutePath());
    const QDir own(QCoreApplication::applicationDirPath());
    if (!own.entryList({u"Compact*.orv"_s}, QDir::Files).isEmpty())
        return own.absolutePath();
    return userFolder();
}

QString catalogueIn(const QString &folder)
{
    return folder + QDir::separator() + u"Compact4.orv"_s;
}

} // namespace programfolder
