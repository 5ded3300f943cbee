#pragma once

#include <QString>

/// Whether there is a regular file of this name, or a link to one. Opening a pipe or a device could
/// wait for ever; they are never opened.
bool isOrdinaryFile(const QString &name);
