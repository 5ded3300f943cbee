#pragma once

#include <QString>

/// Opens a catalogue as gConnection as the program does, less the look through the whole file that
/// belongs to a start and not to the work that is measured. Throws Error.
void openForWork(const QString &file);
