#pragma once

#include <QString>

/// The wastebasket of the desktop. Files go into it, and out of it again, by a new name alone: what
/// would have to be copied to another disk stays where it is.
namespace wastebasket
{

/// Whether the user has one; the first call may begin it. One that is only away, full or locked
/// counts: take() refuses then, and nothing is lost.
bool exists();

/// The name that the file has there. Empty: no wastebasket can take it, it is where it was.
QString take(const QString &path);

/// Brings back what take() gave this name, unless another file has the old one.
void giveBack(const QString &there, const QString &path);

} // namespace wastebasket

/// Gives a file a name that no other has. False with errno; EEXIST: another has it.
bool renameWhereFree(const QString &from, const QString &to);
