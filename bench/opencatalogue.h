#pragma once

#include <QString>

/// Opens a catalogue as gConnection, with the checks of a start after a proper end. Throws
/// ADODB::Error.
void openCatalogue(const QString &file);

/// Chooses the format 'A' to 'D' of gImportFile for an import, as the wizard does.
void chooseImport(char format, const QString &file);
