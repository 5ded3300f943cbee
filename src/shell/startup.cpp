#include "shell/startup.h"

#include "catalogue/cataloguefile.h"
#include "catalogue/connect.h"
#include "discdata/changedfiles.h"
#include "platform/ado/connection.h"
#include "platform/ado/value.h"
#include "platform/desktop/paintwait.h"
#include "platform/text/textrules.h"
#include "services/clsRegistry.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "tags/filejournal.h"

#include <QCoreApplication>
#include <QDir>
#include <QTimer>
#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>
#include <utility>

using namespace Qt::StringLiterals;

namespace startup
{

namespace
{

constexpr int currentGeneration = 4;
constexpr int largestNumber = std::numeric_limits<int>::max();

QString read(clsRegistry &settings, const char *name)
{
    return settings.GetValue(settingsReadKey, QLatin1String(name)).toString();
}

void write(clsRegistry &settings, const char *name, int value)
{
    settings.SetValue(settingsKey, QLatin1String(name), value);
}

void writeFirst(clsRegistry &settings, const char *name, int value)
{
    settings.CreateKey(settingsKey);
    write(settings, name, value);
}

// What is no number, or one beyond what a number of the settings can be, is as good as not there.
std::optional<int> readNumber(clsRegistry &settings, const char *name)
{
    const QString stored = read(settings, name);
    if (!text::isNumeric(stored))
        return {};
    const double value = stored.trimmed().toDouble();
    if (std::abs(value) > largestNumber)
        return {};
    return int(ADODB::Value(stored).toLong());
}

int countSession(clsRegistry &settings)
{
    const auto stored = readNumber(settings, "Session");
    if (!stored) {
        writeFirst(settings, "Session", 1);
        return 1;
    }
    const int session = std::min(*stored, largestNumber - 1) + 1; // the last one stays
    write(settings, "Session", session);
    return session;
}

void readLanguage(clsRegistry &settings)
{
    const auto stored = readNumber(settings, "Language");
    if (!stored) {
        gLanguage = languageEnglish;
        writeFirst(settings, "Language", gLanguage);
        return;
    }
    gLanguage = stored == languageDutch ? languageDutch : languageEnglish;
    if (stored != gLanguage)
        write(settings, "Language", gLanguage);
}

bool oldCatalogueIn(const QString &folder)
{
    return FileExists(folder + QDir::separator() + u"Compact.orv"_s) ||
           FileExists(folder + QDir::separator() + u"Compact3.orv"_s);
}

void readGeneration(clsRegistry &settings, const QString &programFolder, Found &found)
{
    const auto stored = readNumber(settings, "DBVersion");
    if (!stored) {
        writeFirst(settings, "DBVersion", currentGeneration);
        found.conversionPending = oldCatalogueIn(programFolder);
        return;
    }
    found.dbVersion = *stored;
    if (found.dbVersion < currentGeneration) {
        settings.SetValue(u"Software\\Orvanta Software\\Songcase"_s, u"DBVersion"_s,
                          currentGeneration);
        found.conversionPending = true;
    }
}

// The hourglass stays until the routine that waits has returned, or handles events.
void showWait()
{
    constexpr int soon = 1; // milliseconds; with none it would come round in the wait
    static bool shown = false;
    if (!std::exchange(shown, true)) {
        setFramePointer(vbHourglass);
        QTimer::singleShot(soon, qApp, [] {
            shown = false;
            setFramePointer(vbDefault);
        });
    }
    paintAlone();
}

// What a crash has left in files of the user. What cannot be reached now is mended when it can.
void mendChangedFiles()
{
    try {
        changedFiles().mend();
    } catch (const Error &) { // told when files are changed
    }
}

} // namespace

Found readSettings(const QString &programFolder)
{
    clsRegistry settings;
    Found found;
    found.session = countSession(settings);
    readLanguage(settings);
    readGeneration(settings, programFolder, found);
    found.useProxy = ReadProxySettings();
    return found;
}

int storedLanguage()
{
    clsRegistry settings;
    const bool dutch = read(settings, "Language") == QString::number(languageDutch);
    return dutch ? languageDutch : languageEnglish;
}

QString ReadProxySettings()
{
    clsRegistry settings;
    QString useProxy = read(settings, "UseProxy");
    gUseProxy = useProxy == "1"_L1;
    gProxyServer = gUseProxy ? read(settings, "ProxyServer") : QString();
    gProxyPassword = gUseProxy ? read(settings, "ProxyPassword") : QString();
    gProxyUserName = gUseProxy ? read(settings, "ProxyUserName") : QString();
    gProxyServerPort = gUseProxy ? read(settings, "ProxyServerPort") : u"0"_s;
    return useProxy;
}

void openCatalogue(const QString &file, bool lastRunBroken)
{
    gConnection = std::make_unique<ADODB::Connection>();
    configureConnection(*gConnection, file);
    gConnection->WhileLocked = showWait;
    try {
        cataloguefile::inspect(file);
        gConnection->Open();
        cataloguefile::verify(*gConnection, lastRunBroken);
    } catch (const Error &error) {
        gConnection->Errors.assign(1, error);
        if (gConnection->State() == ADODB::adStateOpen)
            gConnection->Close();
        throw;
    }
    mendChangedFiles();
}

void showErrors(const Error &error)
{
    const auto show = [](const Error &e) {
        errorBox(u"ADO Connect Error: "_s + QString::number(e.Number) + u' ' + e.Description,
                 GetMessage("MsgSysErr"));
    };
    show(error);
    const auto entries = gConnection->Errors;
    for (const Error &entry : entries)
        show(entry);
}

} // namespace startup
