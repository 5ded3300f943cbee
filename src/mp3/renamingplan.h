#pragma once

#include "mp3/collectionrow.h"

#include <QHash>
#include <QSet>
#include <vector>

/// What stands in the way of a new name. IsThere is a question to the user; before FileGone all
/// others leave the file its name.
enum class NameObstacle {
    None,
    TagMissing,       // no artist or no title
    ForbiddenSymbols, // in artist or title
    LetterRefused,    // no file can have such a name
    TooLong,          // for the file system
    OfAnotherRow,     // whose file would be lost
    OfAFolder,        // with all that is in it
    IsThere,          // a file has this name; it may be the row's own
    FileGone,         // the row's own
    MovedAlready      // by another row that stands for the same file
};

/// The name that a file of a collection is to get.
struct NewName {
    QString name; // in the folder of the collection
    QString oldPath, newPath;
    NameObstacle obstacle = NameObstacle::None;
    int otherRow = 0; // that has it already, 0: none
};

/// Whether two names lead to one file, by case, by a link, or by being the same.
bool isSameFile(const QString &path, const QString &other);

/// Makes the new names of files of one collection out of their tags, and knows which names its rows
/// have, while one file after the other is renamed.
class RenamingPlan
{
public:
    /// `collection` are all its rows, those that keep their names as well.
    RenamingPlan(QString folder, const std::vector<CollectionRow> &collection);

    QString folder() const { return mFolder; }
    NewName nameFor(const CollectionRow &row) const;

    /// Whether its folder is write-protected, so that the file cannot have another name.
    static bool isFolderClosed(const NewName &name);

    /// The row has this name from now on.
    void take(const CollectionRow &row, const NewName &name);

    /// The same where nothing is to be touched: the old name counts as free, whatever the disk
    /// says.
    void pretend(const CollectionRow &row, const NewName &name);

private:
    struct User {
        int row;
        QString path;
    };
    NameObstacle obstacleTo(const CollectionRow &row, const NewName &name) const;
    int otherRowWith(const CollectionRow &row, const NewName &name) const;
    bool isThere(const QString &path) const;

    const QString mFolder;
    QMultiHash<QString, User> mUsers; // by name, without regard to case
    QHash<QString, QString> mMoved;   // old path to new one
    QSet<QString> mPretendedFree;
};
