#include "fuzz/fuzz.h"
#include "platform/error/error.h"
#include "support/testcatalogue.h"
#include "textimport/readers.h"

namespace
{

using Reader = void (*)(ImportLines &, TrackRows &);

// The reader is named by the first byte. It gives rows or refuses the file, with a reason.
void runReader(const QByteArray &input)
{
    constexpr Reader readers[] = {ReadCompilationNested, ReadAlbumNested, ReadCompilationFlat,
                                  ReadAlbumFlat};
    static const QTemporaryDir folder;
    InputTextFile file;
    fuzz::must(OpenInputFile(writeFile(folder.filePath(u"in.txt"_s), input.mid(1)), file),
               "a text file is refused");
    const auto records = newImportRecords();
    TrackRows rows(*records, 1, 1);
    int told = 0;
    ImportLines lines(file, [&](int number, FilePart) {
        fuzz::must(number == ++told && told < 100000, "lines without end");
    });
    try {
        readers[input.isEmpty() ? 0 : std::size_t(input[0]) % std::size(readers)](lines, rows);
    } catch (const DataError &error) {
        fuzz::must(error.line <= told && !error.reason.isEmpty(),
                   "a fault without place or reason");
    } catch (const Error &) {
    }
    const auto made = records->rows();
    for (qsizetype row = 0; row < made->rowCount(); ++row)
        fuzz::must(made->text(row, importfield::Artist).size() <= 510, "a text longer than told");
}

fuzz::Target import(
    "import",
    [] {
        return fuzz::Inputs{
            "0Now 12\r\n1\r\n2\r\nAbba\r\nSos\r\nPop\r\n1975\r\nBlur\r\nSong 2\r\n\r\n\r\n",
            "1Abba\nArrival\n1\n1\nSos\nPop\n1975\n",
            "2Now 12\nAbba*Sos*Pop*1975\n*\nBlur*Song 2**\n",
            "3Abba\nArrival\nSos*Pop*1975\n\nTiger**\n"};
    },
    runReader);

} // namespace
