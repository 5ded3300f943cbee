#pragma once

#include <QString>

class Error;

/// The settings side of the start: session number, language, generation of the catalogue, proxy.
namespace startup
{

/// What a start has found out.
struct Found {
    int session = 1;
    int dbVersion = 0; // the value as read, 0 where it was not numeric
    bool conversionPending = false;
    QString useProxy; // the text of the value UseProxy
};

/// Reads the settings, mends and counts on, and sets gLanguage and the proxy globals. Nothing that
/// stands in them makes it fail.
Found readSettings(const QString &programFolder);

/// The language that the settings hold, English where they hold none; nothing is written.
int storedLanguage();

/// Reads the proxy globals; gives the text of the value UseProxy.
QString ReadProxySettings();

/// Opens the catalogue as gConnection. Throws Error, which then stands in its Errors too,
/// and gConnection is there but closed.
void openCatalogue(const QString &file, bool lastRunBroken);

/// Shows why the catalogue could not be opened, and what the connection says.
void showErrors(const Error &error);

} // namespace startup
