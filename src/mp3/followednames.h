#pragma once

#include <QHash>
#include <QString>

/// Files of the user that have other names now: full names, clean and composed, the old
/// one to the new one.
using RenamedFiles = QHash<QString, QString>;

/// What moves, one after the other, come to.
RenamedFiles renamedBy(const std::vector<std::pair<QString, QString>> &moves);

/// What an open editor of a collection is, to those who change its files from outside; which of
/// them have another name now it is told.
class FollowsNames
{
public:
    virtual ~FollowsNames() = default;
    virtual void followNames(const RenamedFiles &renamed) = 0;
};

/// The name in a folder that a file of a collection has now; the one that it had if it was not
/// renamed.
QString followedName(const RenamedFiles &renamed, const QString &folder, const QString &fileName);

/// After files were changed: gives the new names to the collections in the catalogue, in one
/// transaction over gConnection, and tells the open editors. Throws Error, and nothing has happened
/// then.
void followNames(const RenamedFiles &renamed);
