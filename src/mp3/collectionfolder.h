#pragma once

#include <QString>
#include <optional>

class Form;

/// Full name of a file of a collection: the folder, a separator (a second one behind a drive's
/// root), and its name in the folder, which may hold a sub-folder and, from an older catalogue, "\"
/// as the separator.
QString pathInFolder(const QString &folder, const QString &fileName);

/// Whether the folder is there, asked by a thread, since a dead medium gives no answer: after a
/// moment the user may cancel, and nothing comes back.
std::optional<bool> isFolderThere(Form &screen, const QString &folder);
