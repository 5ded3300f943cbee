#include "mp3/renamingplan.h"

#include "mp3/collectionfolder.h"
#include "platform/files/nativename.h"
#include "platform/text/textrules.h"
#include "services/fileutilities.h"
#include "tags/movedfile.h"

#include <QDir>
#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

constexpr double firstOfTwoDigits = 10;

// By design: the value decides and the zero goes before the text, so "07" becomes "007", and "3/12"
// stays.
QString numberFor(const QString &trackPosition)
{
    const bool oneDigit =
        text::isNumeric(trackPosition) && trackPosition.trimmed().toDouble() < firstOfTwoDigits;
    return oneDigit ? u'0' + trackPosition : trackPosition;
}

QString nameOf(const CollectionRow &row)
{
    return numberFor(row[CollectionField::TrackPosition]) + u'-' +
           row[CollectionField::LeadArtist] + u'-' + row[CollectionField::Title] + u".mp3"_s;
}

// By design: the track position is not looked at, nor any sign but these.
bool hasForbiddenSymbols(const CollectionRow &row)
{
    const QString names = row[CollectionField::LeadArtist] + row[CollectionField::Title];
    return std::any_of(names.cbegin(), names.cend(),
                       [](QChar c) { return u"><|:/*\\?"_s.contains(c); });
}

// The track position may bring a separator; and half a character of UTF-16 would be written as
// another one.
bool isNameOfFile(const QString &name)
{
    return !name.contains(u'/') && !name.contains(QDir::separator()) && !name.contains(QChar(0)) &&
           nameOfNative(nativeName(name)) == name;
}

bool isTooLong(const QString &path)
{
    struct stat about = {};
    return lstat(nativeName(path).constData(), &about) != 0 && errno == ENAMETOOLONG;
}

bool isFolder(const QString &path)
{
    struct stat about = {};
    return stat(nativeName(path).constData(), &about) == 0 && S_ISDIR(about.st_mode);
}

qsizetype endOfFolder(const QString &path)
{
    return path.lastIndexOf(QDir::separator()) + 1;
}

// With its separator. It was found under its path either as it is stored or with "\" taken as the
// separator, which shows in their number.
QString subFolderOf(const QString &stored, const QString &path, const QString &folder)
{
    const auto parts = [](const QString &s) { return s.count(QDir::separator()); };
    const bool asStored = parts(path) == parts(folder) + 1 + parts(stored);
    const QString name = asStored ? stored : QString(stored).replace(u'\\', QDir::separator());
    return name.first(endOfFolder(name));
}

// A name counts as the same if a disk could take it for the same.
QString keyOf(const QString &path)
{
    return path.normalized(QString::NormalizationForm_C).toCaseFolded();
}

} // namespace

bool isSameFile(const QString &path, const QString &other)
{
    struct stat one = {}, two = {};
    return stat(nativeName(path).constData(), &one) == 0 &&
           stat(nativeName(other).constData(), &two) == 0 && one.st_dev == two.st_dev &&
           one.st_ino == two.st_ino;
}

RenamingPlan::RenamingPlan(QString folder, const std::vector<CollectionRow> &collection)
    : mFolder(std::move(folder))
{
    mUsers.reserve(qsizetype(collection.size()));
    for (const CollectionRow &row : collection) {
        // The disk is asked only where the name may be another one there.
        const QString &name = row[CollectionField::FileName];
        const QString path =
            QDir::cleanPath(name.contains(u'\\') ? pathInFolder(mFolder, name)
                                                 : mFolder + QDir::separator() + name);
        mUsers.insert(keyOf(path), {row.index, path});
    }
}

NewName RenamingPlan::nameFor(const CollectionRow &row) const
{
    NewName name;
    const QString &stored = row[CollectionField::FileName];
    name.oldPath = pathInFolder(mFolder, stored);
    name.name = subFolderOf(stored, name.oldPath, mFolder) + nameOf(row);
    name.newPath = name.oldPath.first(endOfFolder(name.oldPath)) + nameOf(row);
    name.otherRow = otherRowWith(row, name);
    name.obstacle = obstacleTo(row, name);
    return name;
}

NameObstacle RenamingPlan::obstacleTo(const CollectionRow &row, const NewName &name) const
{
    if (row[CollectionField::LeadArtist].isEmpty() || row[CollectionField::Title].isEmpty())
        return NameObstacle::TagMissing;
    if (hasForbiddenSymbols(row))
        return NameObstacle::ForbiddenSymbols;
    if (!isNameOfFile(nameOf(row)))
        return NameObstacle::LetterRefused;
    if (isTooLong(name.newPath))
        return NameObstacle::TooLong;
    if (mMoved.value(name.oldPath) == name.newPath)
        return NameObstacle::MovedAlready;
    if (name.otherRow != 0)
        return NameObstacle::OfAnotherRow;
    if (isFolder(name.newPath))
        return NameObstacle::OfAFolder;
    if (isThere(name.newPath))
        return NameObstacle::IsThere;
    return FileExists(name.oldPath) ? NameObstacle::None : NameObstacle::FileGone;
}

// 0: none has it. Names that differ in case alone are one where the disk makes no difference.
int RenamingPlan::otherRowWith(const CollectionRow &row, const NewName &name) const
{
    const QString path = QDir::cleanPath(name.newPath), own = QDir::cleanPath(name.oldPath);
    const auto [from, to] = mUsers.equal_range(keyOf(path));
    const auto found = std::find_if(from, to, [&](const User &user) {
        return user.row != row.index && user.path != own &&
               (user.path == path || isSameFile(user.path, path));
    });
    return found == to ? 0 : found->row;
}

// A link that leads nowhere has its name as well, and would be replaced.
bool RenamingPlan::isThere(const QString &path) const
{
    return !mPretendedFree.contains(path) && (isNameTaken(path) || FileExists(path));
}

bool RenamingPlan::isFolderClosed(const NewName &name)
{
    const QByteArray folder = nativeName(name.oldPath.first(endOfFolder(name.oldPath)));
    return name.oldPath != name.newPath &&
           faccessat(AT_FDCWD, folder.constData(), W_OK, AT_EACCESS) != 0 &&
           (errno == EACCES || errno == EROFS);
}

void RenamingPlan::take(const CollectionRow &row, const NewName &name)
{
    const QString before = QDir::cleanPath(name.oldPath), now = QDir::cleanPath(name.newPath);
    const auto [from, to] = mUsers.equal_range(keyOf(before));
    const auto own = std::find_if(from, to, [&](const User &u) { return u.row == row.index; });
    if (own != to)
        mUsers.erase(own);
    mUsers.insert(keyOf(now), {row.index, now});
    if (before != now)
        mMoved.insert(name.oldPath, name.newPath);
}

void RenamingPlan::pretend(const CollectionRow &row, const NewName &name)
{
    take(row, name);
    mPretendedFree.remove(name.newPath);
    if (!isSameFile(name.oldPath, name.newPath)) // it stays there then
        mPretendedFree.insert(name.oldPath);
}
