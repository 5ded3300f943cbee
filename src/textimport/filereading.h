#pragma once

#include "textimport/readers.h"

/// Reads the text file gImportFile, in the format that the gImport... flags name, into a new
/// gImportRecords. The catalogue is asked for two free ids and is not changed.
class FileReading
{
public:
    /// What to show of the progress, whenever it has changed; percent of the lines.
    std::function<void(int percent, const QString &label)> show;

    /// After each line, for what has to happen meanwhile.
    std::function<void()> lineRead;

    /// A missing file and one without a line give no rows. Throws DataError, and any
    /// std::exception for what is no text file of tracks at all; the rows read so far stay.
    void run();

    /// The number of lines read so far: where it failed.
    int lineNumber() const { return mLineNumber; }

private:
    void readLines(InputTextFile &file, TrackRows &rows);
    void tell(FilePart part);

    int mLineNumber = 0, mLineTotal = 0;
    int mPercentShown = -1;
    bool mFromTableShown = false;
};
