#pragma once

#include <QString>
#include <memory>

namespace ADODB
{
class Connection;
class Recordset;
} // namespace ADODB

// What the screens share, one instance each, plain values.

/// The one connection, MainScreen's alone to open and close. The object is always there: what is
/// asked of it while it is closed is an error like any other.
extern std::unique_ptr<ADODB::Connection> gConnection;

extern QString gDatabasePath; // full name of the catalogue
extern int gLanguage;         // 1 English, 19 Dutch; fixed for a run

extern bool gUseProxy;
extern QString gProxyServer, gProxyPassword, gProxyUserName, gProxyServerPort;

extern QString gImportFile; // full name of the text file chosen for import
extern bool gImportCompilationNested, gImportCompilationFlat; // exactly one of the four is true
extern bool gImportAlbumNested, gImportAlbumFlat;             // during an import
extern std::shared_ptr<ADODB::Recordset> gImportRecords; // parsed tracks on their way to the load

extern bool gTagsChanged; // a tag was written since the list of the collection was read
