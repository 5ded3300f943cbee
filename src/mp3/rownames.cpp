#include "mp3/rownames.h"

#include <QDir>
#include <QFileInfo>
#include <algorithm>
#include <optional>

using namespace Qt::StringLiterals;

namespace rownames
{

namespace
{

constexpr qsizetype longestName = 255;

// The root's name ends in the separator itself.
QString withSeparator(const QString &folder)
{
    return folder.endsWith(QDir::separator()) ? folder : folder + QDir::separator();
}

std::optional<QString> nameIn(const QString &folder, const QString &file)
{
    const QString start = withSeparator(folder);
    return file.startsWith(start) ? std::optional(file.sliced(start.size())) : std::nullopt;
}

// A folder can be typed in more than one way, and be reached through a link.
std::optional<QString> relativeName(const QString &folder, const QString &file)
{
    if (auto plain = nameIn(QDir::cleanPath(folder), QDir::cleanPath(file)))
        return plain;
    const QFileInfo info(file);
    const QString here = QFileInfo(folder).canonicalFilePath(); // empty if there is none
    const QString there = QFileInfo(info.path()).canonicalFilePath();
    if (here.isEmpty() || there.isEmpty())
        return {};
    return nameIn(here, withSeparator(there) + info.fileName());
}

// By design: the first of several comes last.
QStringList inOrderOfAdding(QStringList files)
{
    if (files.size() > 1)
        files.append(files.takeFirst());
    return files;
}

} // namespace

Chosen ofChosen(const QString &folder, const QStringList &files)
{
    Chosen chosen;
    for (const QString &file : inOrderOfAdding(files)) {
        const auto name = relativeName(folder, file);
        const bool isMP3 = QFileInfo(file).fileName().contains(".MP3"_L1, Qt::CaseInsensitive);
        // One alone is asked for its name first, several for their folder.
        if (!name && (isMP3 || files.size() > 1)) {
            chosen.refusal = "InvalidDirectory";
        } else if (!isMP3) {
            chosen.refusal = "OnlyMP3Files";
            chosen.askAgain = true;
        } else if (name->size() > longestName) {
            chosen.refusal = "NumberOfCharactersExceeded";
        }
        if (chosen.refusal)
            break;
        chosen.names.append(*name);
    }
    return chosen;
}

QStringList ofFound(const QString &folder, const QStringList &files)
{
    const qsizetype start = withSeparator(folder).size();
    QStringList names;
    names.reserve(files.size());
    for (const QString &file : files)
        names.append(file.sliced(start));
    return names;
}

} // namespace rownames
