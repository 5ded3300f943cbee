#pragma once

#include "tags/headchange.h"

/// Gives a file another name, and what has that name to the desktop's wastebasket; where the
/// desktop has none it goes. That is done to the file `over` alone, which the user has looked at:
/// without it the name has to be free. A second name of the file itself is free. The name is on the
/// disk then. Throws Error (errFileNotMoved, errNameRefused, errNotReplaced) with everything as it
/// was.
void moveFile(const QString &from, const QString &to, const std::optional<FileStamp> &over);

/// Whether a move that was begun has happened.
Mended mendMove(const FileChange &change);

/// Of the name itself, be it a link. Where there is nothing the one gives nothing, the other throws
/// Error (errFileNotMoved).
std::optional<FileStamp> findName(const QString &path);
FileStamp stampOfName(const QString &path);
bool isNameTaken(const QString &path);

/// Whether a name has the file of a stamp still. Its medium may have come back with another number
/// of its own, or of the file.
bool isStill(const QString &path, const FileStamp &stamp);
