#include "collection/recoverycopy.h"

#include "platform/files/wholefile.h"
#include "services/globals.h"

#include <QDir>
#include <QJsonDocument>
#include <QUuid>

using namespace Qt::StringLiterals;

QString RecoveryCopy::folder()
{
    return gDatabasePath.isEmpty() ? QString()
                                   : QFileInfo(gDatabasePath).absolutePath() + u"/Unsaved"_s;
}

void RecoveryCopy::keep(const UnsavedRecord &record)
{
    const QByteArray bytes = QJsonDocument(record.toJson()).toJson(QJsonDocument::Compact);
    // Never with the folder above it: that is there only once a first start has made it whole.
    const bool there = QFileInfo::exists(folder()) || QDir().mkdir(folder());
    if (bytes == mWritten || folder().isEmpty() || !there)
        return;
    if (mFile.isEmpty())
        mFile = folder() + u'/' + QUuid::createUuid().toString(QUuid::WithoutBraces) + u".json"_s;
    WholeFile file(mFile);
    if (file.open(QIODevice::WriteOnly) && file.write(bytes) == bytes.size() && file.commit())
        mWritten = bytes;
}

void RecoveryCopy::drop()
{
    if (mFile.isEmpty())
        return;
    remove(mFile);
    mFile.clear();
    mWritten.clear();
}

QList<RecoveryCopy::Found> RecoveryCopy::all()
{
    QList<Found> found;
    const auto files =
        folder().isEmpty()
            ? QFileInfoList()
            : QDir(folder()).entryInfoList({u"*.json"_s}, QDir::Files, QDir::Time | QDir::Reversed);
    for (const QFileInfo &info : files) {
        QFile file(info.filePath());
        if (!file.open(QIODevice::ReadOnly))
            continue;
        const auto object = QJsonDocument::fromJson(file.readAll()).object();
        if (const auto record = UnsavedRecord::fromJson(object))
            found.append({info.filePath(), *record});
    }
    return found;
}

// The folder goes with the last one.
void RecoveryCopy::remove(const QString &file)
{
    QFile::remove(file);
    QDir().rmdir(QFileInfo(file).absolutePath());
}
