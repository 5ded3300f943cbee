#pragma once

#include <QString>

/// Where the catalogue lies. No separator at the end.
namespace programfolder
{

/// $SONGCASE_FOLDER if set; else the folder of the executable if a Compact*.orv lies there (a
/// portable installation); else the data folder of the user.
QString find();

/// The data folder of the user, the only one that the program makes by itself.
QString userFolder();

/// The catalogue in a program's own folder.
QString catalogueIn(const QString &folder);

} // namespace programfolder
