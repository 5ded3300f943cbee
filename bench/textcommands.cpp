#include "catalogue/cataloguefile.h"
#include "chooseimport.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "textimport/catalogueload.h"
#include "textimport/filereading.h"
#include "workcommands.h"

#include <QTemporaryDir>

using namespace Qt::StringLiterals;

namespace
{

void read(const QString &format, const QString &file)
{
    chooseImport(format.front().toLatin1(), file);
    measured("read", [] {
        FileReading reading;
        try {
            reading.run();
        } catch (const DataError &error) {
            throw Error(error.line, QString(), error.reason);
        }
        return count("rows", gImportRecords->RecordCount()) + count("lines", reading.lineNumber());
    });
}

} // namespace

// The readers ask a catalogue for two free ids: an empty one is made for them.
void readText(const QStringList &arguments)
{
    const QTemporaryDir folder;
    const QString catalogue = folder.filePath(u"empty.orv"_s);
    cataloguefile::create(catalogue);
    openForWork(catalogue);
    read(arguments[0], arguments[1]);
    gConnection.reset();
}

void loadText(const QStringList &arguments)
{
    openForWork(arguments[0]);
    read(arguments[1], arguments[2]);
    measured("load", [] {
        CatalogueLoad load;
        load.ask = [](const QString &question) { return askYesNoCancel(question); };
        load.run();
        return count("links", load.importedCount());
    });
}
