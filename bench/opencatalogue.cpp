#include "opencatalogue.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"

void openCatalogue(const QString &file)
{
    gDatabasePath = file;
    cataloguefile::inspect(file);
    gConnection = std::make_unique<ADODB::Connection>();
    configureConnection(*gConnection, file);
    gConnection->Open();
    cataloguefile::verify(*gConnection, false);
}

void chooseImport(char format, const QString &file)
{
    gImportFile = file;
    gImportCompilationNested = format == 'A';
    gImportAlbumNested = format == 'B';
    gImportCompilationFlat = format == 'C';
    gImportAlbumFlat = format == 'D';
}
