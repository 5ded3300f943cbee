#pragma once

#include "textimport/readers.h"

/// Reads the text file gImportFile, in the format that the gImport... flags name, into a new
/// gImportRecords. The catalogue is asked for two free ids and is not changed.
class FileReading
{
public:
    /// Told after each line how many of them are done; false stops there.
    std::function<bool(qint64 done, qint64 all)> step = [](qint64, qint64) { return true; };

    /// What to show of the progress where the reading stands now.
    QString label(int percent) const;

    /// A missing file and one without a line give no rows. Throws DataError, Stopped, and any other
    /// std::exception for what is no text file of tracks at all; the rows read so far stay.
    void run();
    struct Stopped {
    };

    /// The number of lines read so far: where it failed.
    int lineNumber() const { return mLineNumber; }

private:
    void readLines(InputTextFile &file, TrackRows &rows);

    void lineRead(int lineNumber, FilePart part);

    int mLineNumber = 0, mLineTotal = 0;
    FilePart mPart = FilePart::Head;
};
