#include "catalogue/cataloguefile.h"
#include "fuzz/fuzz.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "services/settingsfile.h"
#include "support/damage.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>

namespace
{

// Whatever stands in the file, settings can be written and read again, and nothing of it is lost.
void runSettings(const QByteArray &input)
{
    const QTemporaryDir folder;
    const QString name = writeFile(folder.filePath(u"settings.json"_s), input);
    SettingsFile settings(name);
    const QString key = u"80000002\\Software\\Songcase"_s;
    QVariant old, value;
    settings.value(key, u"old"_s, old);
    fuzz::must(settings.createKey(key) == SettingsFile::Success, "no key can be made");
    fuzz::must(settings.setValue(key, u"New"_s, 7) == SettingsFile::Success,
               "nothing can be written");
    fuzz::must(settings.value(key + u'\\', u"NEW"_s, value) == SettingsFile::Success &&
                   value == QVariant(7),
               "what was written is not read");
    QVariant still;
    settings.value(key, u"old"_s, still);
    fuzz::must(still == old, "another value has changed");
    const auto aside = QDir(folder.path()).entryList({u"*damaged*"_s}, QDir::Files);
    for (const QString &file : aside)
        fuzz::must(readFile(folder.filePath(file)) == input, "the damaged file has changed");
}

// As at a start. False if the file was refused.
bool opens(const QString &name)
{
    try {
        cataloguefile::inspect(name);
        openConnection(name);
        cataloguefile::verify(*gConnection, true);
        return true;
    } catch (const Error &error) {
        fuzz::must(!error.Description.isEmpty(), "refused without words");
        return false;
    }
}

// A damaged catalogue is refused untouched, or can be worked with, errors included.
void runCatalogue(const QByteArray &input)
{
    static const QTemporaryDir folder;
    const QString name = writeFile(folder.filePath(u"Compact4.orv"_s), input);
    fuzz::must(damage::startAndEnd(input, damage::Size::Small).lost.isEmpty(), "rows are lost");
    if (opens(name)) {
        for (const char *statement :
             {"select * from artiesten order by naam", "select * from tracks",
              "insert into artiesten values (1000,'new')",
              "delete from artiesten where naam like 'artist 1%'"}) {
            try {
                gConnection->Execute(QLatin1String(statement));
            } catch (const Error &) {
            }
        }
        gConnection.reset();
    } else {
        gConnection.reset();
        fuzz::must(readFile(name) == input, "a refused file was written");
        fuzz::must(QDir(folder.path()).entryList(QDir::Files).size() == 1, "a file is left beside");
    }
    QFile::remove(name);
}

// Damages that leave more of a file whole: of the input only a number is taken.
void runDamage(const QByteArray &input)
{
    const QByteArray catalogue = damage::damagedCatalogue(qChecksum(input));
    for (const auto size : {damage::Size::Small, damage::Size::Large})
        fuzz::must(damage::startAndEnd(catalogue, size).lost.isEmpty(), "rows are lost");
}

fuzz::Target settings(
    "settings",
    [] {
        return fuzz::Inputs{
            R"({"80000002\\software\\songcase": {"old": {"type": "text", "value": "caf\u00e9"}}})",
            R"({"80000002\\SOFTWARE\\Songcase\\": {"Old": {"type": "number", "value": 19}}})",
            R"({"80000002\\software\\songcase": {"old": {"type": "binary", "value": "AAEC"}}})"};
    },
    runSettings);

fuzz::Target catalogues(
    "catalogues", [] { return fuzz::Inputs{damage::wholeCatalogue()}; }, runCatalogue);

fuzz::Target damages(
    "damages", [] { return fuzz::Inputs{"0"}; }, runDamage);

} // namespace
