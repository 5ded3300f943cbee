#include "services/globals.h"

#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "services/messages.h"

std::unique_ptr<ADODB::Connection> gConnection = std::make_unique<ADODB::Connection>();
QString gDatabasePath;
int gLanguage = languageEnglish;

bool gUseProxy = false;
QString gProxyServer, gProxyPassword, gProxyUserName, gProxyServerPort;

QString gImportFile;
bool gImportCompilationNested = false, gImportCompilationFlat = false;
bool gImportAlbumNested = false, gImportAlbumFlat = false;
std::shared_ptr<ADODB::Recordset> gImportRecords;

bool gTagsChanged = false;
