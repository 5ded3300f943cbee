#include "services/fileutilities.h"

#include "platform/desktop/desktop.h"
#include "platform/files/nativename.h"
#include "platform/files/wholefile.h"
#include "services/messages.h"

#include <QDir>
#include <QRegularExpression>
#include <QStandardPaths>
#include <algorithm>
#include <cstdio>
#include <dirent.h>
#include <sys/stat.h>
#include <vector>

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

// As S_IFREG, S_IFDIR and so on; of a link what it leads to. 0: there is nothing.
mode_t typeOf(const QString &path)
{
    struct stat about = {};
    return stat(nativeName(path).constData(), &about) == 0 ? about.st_mode & S_IFMT : 0;
}

// The catalogue keeps composed letters, while other systems name files in decomposed ones.
QString asOnDisk(const QString &path)
{
    QString found;
    const auto parts = path.split(QDir::separator());
    for (const QString &part : parts) {
        const auto isThere = [&](const QString &form) { return typeOf(found + form) != 0; };
        QString next = part;
        for (const auto form : {QString::NormalizationForm_C, QString::NormalizationForm_D}) {
            if (!part.isEmpty() && !isThere(next))
                next = part.normalized(form);
        }
        if (!part.isEmpty() && !isThere(next))
            return path;
        found += next + QDir::separator();
    }
    return found.chopped(1);
}

struct Entry {
    QString name;
    mode_t type; // a link's own; 0 where the file system does not tell
};

// The toolkit's own list leaves out names that are no UTF-8.
std::vector<Entry> entriesOf(const QString &folder)
{
    std::vector<Entry> entries;
    const std::unique_ptr<DIR, int (*)(DIR *)> open(opendir(nativeName(folder).constData()),
                                                    closedir);
    while (const dirent *next = open ? readdir(open.get()) : nullptr) {
        const QByteArray name = next->d_name;
        if (name != "." && name != "..")
            entries.push_back({nameOfNative(name), mode_t(DTTOIF(next->d_type))});
    }
    return entries;
}

// What a person takes for the order of names: "2" before "10", whatever the case of letters.
bool isBefore(const Entry &a, const Entry &b)
{
    const auto digits = [](const QString &s, qsizetype from) {
        qsizetype end = from;
        while (end < s.size() && s[end] >= u'0' && s[end] <= u'9')
            ++end;
        while (from + 1 < end && s[from] == u'0')
            ++from;
        return QStringView(s).sliced(from, end - from);
    };
    qsizetype i = 0, j = 0;
    while (i < a.name.size() && j < b.name.size()) {
        const auto m = digits(a.name, i), n = digits(b.name, j);
        if (!m.isEmpty() && !n.isEmpty()) {
            if (m != n)
                return m.size() != n.size() ? m.size() < n.size() : m < n;
            i = m.end() - a.name.begin();
            j = n.end() - b.name.begin();
            continue;
        }
        const char32_t c = a.name[i++].toCaseFolded().unicode();
        const char32_t d = b.name[j++].toCaseFolded().unicode();
        if (c != d)
            return c < d;
    }
    const qsizetype restOfA = a.name.size() - i, restOfB = b.name.size() - j;
    return restOfA != restOfB ? restOfA < restOfB : a.name < b.name;
}

/// A walk through folders, each one's own files before those of the folders in it.
struct TreeWalk {
    QRegularExpression fits;
    std::stop_token stop;
    QStringList files;
    double size = 0; // bytes

    // `folder` ends in a separator.
    void enter(const QString &folder)
    {
        auto entries = entriesOf(folder);
        std::sort(entries.begin(), entries.end(), isBefore);
        QStringList folders;
        for (const Entry &entry : entries) {
            const QString full = folder + entry.name;
            // A linked folder may lead back to where the walk has been.
            const bool isFolder = entry.type == S_IFDIR || (entry.type == 0 && isOwnFolder(full));
            if (isFolder && !full.contains("Processed"_L1))
                folders.append(full + QDir::separator());
            if (!isFolder && fits.match(entry.name).hasMatch())
                take(full);
        }
        for (const QString &below : folders) {
            if (!stop.stop_requested())
                enter(below);
        }
    }

    void take(const QString &file)
    {
        struct stat about = {};
        if (stat(nativeName(file).constData(), &about) != 0 || !S_ISREG(about.st_mode))
            return;
        size += double(about.st_size);
        if (!file.contains("SYSTEM FILES"_L1))
            files.append(file);
    }

    static bool isOwnFolder(const QString &path)
    {
        struct stat about = {};
        return lstat(nativeName(path).constData(), &about) == 0 && S_ISDIR(about.st_mode);
    }
};

} // namespace

QString systemPath(const QString &stored)
{
    if (QDir::separator() == u'\\' || typeOf(stored) != 0)
        return stored;
    const QString path = QString(stored).replace(u'\\', QDir::separator());
    return typeOf(path) != 0 ? path : asOnDisk(path);
}

bool FileExists(const QString &path)
{
    if (path.isEmpty())
        return false;
    const QString full = systemPath(path);
    if (typeOf(full) != 0)
        return true;
    const auto name = full.lastIndexOf(QDir::separator()) + 1;
    if (!isPattern(full.sliced(name)))
        return false;
    const auto pattern = wildcards(full.sliced(name));
    const auto entries = entriesOf(name == 0 ? u"./"_s : full.first(name));
    return std::any_of(entries.begin(), entries.end(),
                       [&](const Entry &entry) { return pattern.match(entry.name).hasMatch(); });
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
    return root || IsDriveRoot(path) || (!path.isEmpty() && typeOf(systemPath(path)) == S_IFDIR);
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

double ScanFolderTree(const QString &path, const QString &pattern, int, int)
{
    TreeWalk walk{wildcards(pattern), {}, {}};
    walk.enter(withSeparator(path));
    gFoundFiles += walk.files;
    return walk.size;
}

QStringList filesInTree(const QString &path, const QString &pattern, const std::stop_token &stop)
{
    TreeWalk walk{wildcards(pattern), stop, {}};
    walk.enter(withSeparator(path));
    return walk.files;
}

bool MoveFileReplace(const QString &from, const QString &to)
{
    if (std::rename(nativeName(from).constData(), nativeName(to).constData()) != 0)
        return true;
    return !syncFolder(QFileInfo(to).absolutePath());
}

QString BrowseForFolderDialog(const QString &title, const QString &initialFolder)
{
    gBrowseInitialFolder = initialFolder;
    return Desktop::current().folderName({title, initialFolder, {}, {}});
}
