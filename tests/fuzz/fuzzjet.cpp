#include "conversion/streamedtables.h"
#include "fuzz/fuzz.h"
#include "platform/ado/recordset.h"
#include "platform/work/helperprogram.h"
#include "support/jetfile.h"
#include "support/testcatalogue.h"

#include <QProcess>
#include <QTemporaryDir>

namespace
{

// All rows that were stated are there, or it is an error.
void fill(ADODB::Connection &tables, const QList<QByteArray> &lines)
{
    tables.Open({}, {}, u"Data Source=:memory:; "_s);
    StreamedTables stream(tables);
    try {
        for (const QByteArray &line : lines)
            stream.take({line.constData(), std::size_t(line.size())});
    } catch (const Error &) {
        return;
    }
    for (const OldTable &table : oldTables()) {
        if (stream.isWhole() && stream.has(table))
            tables.Execute(QString::fromLatin1(table.rows));
    }
}

fuzz::Target lines(
    "old tables",
    [] {
        return fuzz::Inputs{
            "table Artiesten 2\ncolumn Naam\ncolumn ID\n='Abba\t1\n='a\\\\b\\tc\t2\nend",
            "table Tracks 1\ncolumn ID\ncolumn Artiest_ID\ncolumn Titel\ncolumn Genre\n"
            "column Hitjaar\ncolumn x\n=1\t2\t'T\t\\N\t1.5e3\t\\N\ntable MP3Collections 0\n"
            "column id\ncolumn map\ncolumn album\nend"};
    },
    [](const QByteArray &input) {
        ADODB::Connection tables;
        fill(tables, input.split('\n'));
    });

// As the screen runs it, if without its limits: what the library makes of it is the helper's.
fuzz::Target file(
    "old database",
    [] {
        return fuzz::Inputs{jetFile(oldCatalogue()), jetFile(oldCatalogue(), {3, 0, {}})};
    },
    [](const QByteArray &input) {
        const QTemporaryDir folder;
        QStringList arguments = {writeFile(folder.filePath(u"old.orv"_s), input)};
        for (const OldTable &table : oldTables())
            arguments.append(QLatin1String(table.name));
        QProcess helper;
        helper.start(HelperProgram::placeOf(u"songcase-jet"_s), arguments);
        fuzz::must(helper.waitForStarted(), "the helper is not there");
        if (!helper.waitForFinished(10'000))
            helper.kill(); // the screen does so too
        const bool whole = helper.exitStatus() == QProcess::NormalExit && helper.exitCode() == 0;
        QList<QByteArray> said = helper.readAllStandardOutput().split('\n');
        fuzz::must(!whole || said.contains("end"), "an end that is not told");
        said.removeLast();
        ADODB::Connection tables;
        fill(tables, said);
        fuzz::must(readFile(arguments[0]) == input, "the file was written");
    });

} // namespace
