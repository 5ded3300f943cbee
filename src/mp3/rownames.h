#pragma once

#include <QStringList>

/// Names of files in a folder, as rows of a collection keep them, out of full names.
namespace rownames
{

/// What files chosen in a dialog come to, in the order in which they are added. `names` are those
/// before the first one that is refused.
struct Chosen {
    QStringList names;
    const char *refusal = nullptr; // key of what is told
    bool askAgain = false;
};
Chosen ofChosen(const QString &folder, const QStringList &files);

/// Of files that were found below the folder.
QStringList ofFound(const QString &folder, const QStringList &files);

} // namespace rownames
