#include "textimport/filereading.h"

#include "catalogue/ids.h"
#include "platform/error/error.h"
#include "services/fileutilities.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

// By design: where a reader does not take the word behind the percentage from the table, it is
// Dutch in both languages.
bool wordIsFromTable(FilePart part)
{
    return gImportCompilationNested || (gImportAlbumNested && part == FilePart::Tracks);
}

} // namespace

void FileReading::run()
{
    gImportRecords = newImportRecords();
    const qint64 discRow = nextId(Table::CompactDiscs);
    const qint64 cd = nextId(Table::CDTitels);
    if (!FileExists(gImportFile))
        return;
    InputTextFile file;
    if (!OpenInputFile(gImportFile, file))
        throw makeError(errCannotUse, gImportFile);
    mLineTotal = file.countLines();
    lineRead(0, FilePart::Head);
    if (mLineTotal == 0)
        return;
    TrackRows rows(*gImportRecords, discRow, cd);
    readLines(file, rows);
    CloseTextFile(file);
    gImportRecords->MoveFirst(); // refuses a file without a track
}

void FileReading::readLines(InputTextFile &file, TrackRows &rows)
{
    ImportLines lines(file, [this](int lineNumber, FilePart part) { lineRead(lineNumber, part); });
    if (gImportCompilationNested)
        ReadCompilationNested(lines, rows);
    else if (gImportCompilationFlat)
        ReadCompilationFlat(lines, rows);
    else if (gImportAlbumNested)
        ReadAlbumNested(lines, rows);
    else if (gImportAlbumFlat)
        ReadAlbumFlat(lines, rows);
}

void FileReading::lineRead(int lineNumber, FilePart part)
{
    mLineNumber = lineNumber;
    mPart = part;
    if (!step(mLineNumber, mLineTotal))
        throw Stopped();
}

QString FileReading::label(int percent) const
{
    return QString::number(percent) +
           (wordIsFromTable(mPart) ? GetMessage("lblRead") : u"% ingelezen"_s);
}
