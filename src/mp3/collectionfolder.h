#pragma once

#include <QString>

/// Full name of a file of a collection: the folder, a separator (a second one behind a drive's
/// root), and its name in the folder, which may hold a sub-folder and, from an older catalogue, "\"
/// as the separator.
QString pathInFolder(const QString &folder, const QString &fileName);
