#include "chooseimport.h"

#include "services/globals.h"

void chooseImport(char format, const QString &file)
{
    gImportFile = file;
    gImportCompilationNested = format == 'A';
    gImportAlbumNested = format == 'B';
    gImportCompilationFlat = format == 'C';
    gImportAlbumFlat = format == 'D';
}
