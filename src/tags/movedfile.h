#pragma once

#include "tags/headchange.h"

/// Gives a file another name, and what has that name to the desktop's wastebasket where there is
/// one; where there is none it goes. The name is on the disk then. Throws Error (errFileNotMoved,
/// errNameRefused) with everything as it was.
void moveFile(const QString &from, const QString &to);

/// The same, but only while nothing has the new name.
void moveBack(const QString &from, const QString &to);

/// Whether a move that was begun has happened.
Mended mendMove(const FileChange &change);

/// Of the name itself, be it a link; throws Error where there is nothing.
FileStamp stampOfName(const QString &path);
bool isNameTaken(const QString &path);
