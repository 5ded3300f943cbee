#include "opencatalogue.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "platform/ado/connection.h"
#include "services/globals.h"

#include <QFileInfo>

void openForWork(const QString &file)
{
    cataloguefile::inspect(file);
    gConnection = std::make_unique<ADODB::Connection>();
    configureConnection(*gConnection, file);
    gConnection->Open();
    gDatabasePath = QFileInfo(file).absoluteFilePath();
}
