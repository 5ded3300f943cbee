#pragma once

#include <QString>

/// Chooses a file and its format, 'A' to 'D', for an import, as the wizard does.
void chooseImport(char format, const QString &file);
