#include "services/fileutilities.h"

#include "platform/desktop/desktop.h"
#include "platform/files/wholefile.h"
#include "services/messages.h"

#include <QDir>
#include <QDirIterator>
#include <QRegularExpression>
#include <QStandardPaths>
#include <cstdio>

using namespace Qt::StringLiterals;

QStringList gFoundFiles;
QString gBrowseInitialFolder;

namespace
{

QString gSaveFolder;

// Only * and ? are wild: "Album [Disc 1].mp3" is a plain name.
bool isPattern(const QString &name)
{
    return name.contains(u'*') || name.contains(u'?');
}

QRegularExpression wildcards(const QString &pattern)
{
    // The escape comes first, and whole: cut into units, characters of two would be broken.
    QString expression = QRegularExpression::escape(pattern);
    expression.replace("\\*"_L1, ".*"_L1);
    expression.replace("\\?"_L1, "."_L1);
    return QRegularExpression(QRegularExpression::anchoredPattern(expression),
                              QRegularExpression::CaseInsensitiveOption |
                                  QRegularExpression::DotMatchesEverythingOption);
}

QString withSeparator(QString path)
{
    if (!path.endsWith(QDir::separator()))
        path += QDir::separator();
    return path;
}

} // namespace

QString systemPath(const QString &stored)
{
    if (QDir::separator() == u'\\' || QFileInfo::exists(stored))
        return stored;
    return QString(stored).replace(u'\\', QDir::separator());
}

bool FileExists(const QString &path)
{
    if (path.isEmpty())
        return false;
    const QFileInfo info(systemPath(path));
    if (info.exists())
        return true;
    if (!isPattern(info.fileName()))
        return false;
    const auto pattern = wildcards(info.fileName());
    QDirIterator it(info.path(),
                    QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden | QDir::System);
    while (it.hasNext()) {
        it.next();
        if (pattern.match(it.fileName()).hasMatch())
            return true;
    }
    return false;
}

QString saveFolder()
{
    if (gSaveFolder.isEmpty())
        gSaveFolder = QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
    return QDir(gSaveFolder).exists() ? gSaveFolder : QDir::homePath();
}

void rememberSaveFolder(const QString &fileName)
{
    gSaveFolder = QFileInfo(fileName).absolutePath();
}

bool mayWrite(const QString &name)
{
    return !FileExists(name) || askYesNo(GetMessage("FileAlreadyExists")) == vbYes;
}

bool DirExists(QString path)
{
    path = path.trimmed();
    const bool root = IsDriveRoot(path);
    if (path.endsWith(QDir::separator()))
        path.chop(1);
    return root || IsDriveRoot(path) || (!path.isEmpty() && QFileInfo(systemPath(path)).isDir());
}

bool IsDriveRoot(const QString &text)
{
    if (text.isEmpty())
        return false;
    for (const QFileInfo &drive : QDir::drives()) {
        if (drive.absoluteFilePath().contains(text, Qt::CaseInsensitive))
            return true;
    }
    return false;
}

QString StripAtNull(QString &s)
{
    if (const auto end = s.indexOf(QChar(0)); end >= 0)
        s.truncate(end);
    return s;
}

QStringList FindFilesInTree(const QString &path, const QString &pattern, int)
{
    gFoundFiles.clear();
    ScanFolderTree(path, pattern, 0, 0);
    return gFoundFiles;
}

double ScanFolderTree(QString path, const QString &pattern, int fileCount, int folderCount)
{
    path = withSeparator(path);
    QStringList folders;
    double size = 0;
    const auto fits = wildcards(pattern);
    QDirIterator it(path, QDir::Dirs | QDir::Files | QDir::NoDotAndDotDot | QDir::Hidden);
    while (it.hasNext()) {
        it.next();
        const QFileInfo entry = it.fileInfo();
        const QString full = path + entry.fileName();
        // A linked folder may lead back to where the walk has been.
        if (entry.isDir() && !entry.isSymLink() && !full.contains("Processed"_L1))
            folders.append(full);
        if (!entry.isFile() || !fits.match(entry.fileName()).hasMatch())
            continue;
        size += double(entry.size());
        if (!full.contains("SYSTEM FILES"_L1))
            gFoundFiles.append(full);
    }
    for (const QString &folder : folders)
        size += ScanFolderTree(folder, pattern, fileCount, folderCount);
    return size;
}

bool MoveFileReplace(const QString &from, const QString &to)
{
    if (std::rename(QFile::encodeName(from).constData(), QFile::encodeName(to).constData()) != 0)
        return true;
    return !syncFolder(QFileInfo(to).absolutePath());
}

QString BrowseForFolderDialog(const QString &title, const QString &initialFolder)
{
    gBrowseInitialFolder = initialFolder;
    return Desktop::current().folderName({title, initialFolder, {}, {}});
}
