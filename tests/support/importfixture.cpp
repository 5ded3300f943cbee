#include "support/importfixture.h"

#include "platform/ado/recordset.h"
#include "services/globals.h"

void chooseImport(char format, const QString &file)
{
    gImportFile = file;
    gImportCompilationNested = format == 'A';
    gImportAlbumNested = format == 'B';
    gImportCompilationFlat = format == 'C';
    gImportAlbumFlat = format == 'D';
}

QStringList importRows()
{
    QStringList all;
    const auto rows = gImportRecords->rows();
    for (qsizetype row = 0; row < rows->rowCount(); ++row) {
        QStringList values;
        for (int column = 0; column < rows->columnCount(); ++column)
            values.append(rows->text(row, column));
        all.append(values.join(u'|'));
    }
    return all;
}

void ImportTest::init()
{
    ScreenTest::init();
    gImportFile.clear();
    mFrame = std::make_unique<TestFrame>();
}

void ImportTest::cleanup()
{
    ScreenTest::cleanup();
    mFrame.reset();
}
