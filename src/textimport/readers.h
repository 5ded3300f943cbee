#pragma once

#include "services/textfiles.h"
#include "textimport/importrecords.h"

#include <functional>

/// A line of the file that says what it must not; the file is refused with this reason.
struct DataError {
    int line; // from 1
    QString reason;
};

/// What a line belongs to, for the readers that word their progress by it.
enum class FilePart { Head, Tracks };

/// The lines of a text file one by one, counted and told to whoever shows the progress. Lines
/// behind the end of the file are empty and count too.
class ImportLines
{
public:
    using Told = std::function<void(int lineNumber, FilePart part)>;

    ImportLines(InputTextFile &file, Told told) : mFile(file), mTold(std::move(told)) {}

    bool atEnd() const { return mFile.atEnd(); }
    QString next(FilePart part);

    /// Refuses the file for the line read last, with the text of a message key.
    [[noreturn]] void refuse(const char *key) const;
    [[noreturn]] void refuseWith(const QString &reason) const { throw DataError{mNumber, reason}; }

private:
    InputTextFile &mFile;
    Told mTold;
    int mNumber = 0;
};

// The readers of the four formats: lines into rows. A fault in the data is thrown as DataError;
// what a reader cannot even take apart (a track without its stars) as Error. The rows up to there
// are kept.

/// One field per row: title, count of discs; per disc a count of tracks; per track artist, title,
/// genre, year.
void ReadCompilationNested(ImportLines &lines, TrackRows &rows);

/// The same for albums: the artist stands before the title of the CD and not at its tracks.
void ReadAlbumNested(ImportLines &lines, TrackRows &rows);

/// One track per row: artist*title*genre*year. An empty line or "*" ends a disc, a line without a
/// star is the title of a CD.
void ReadCompilationFlat(ImportLines &lines, TrackRows &rows);

/// One track per row: title*genre*year. A line without a star is the artist of an album, the line
/// behind it its title.
void ReadAlbumFlat(ImportLines &lines, TrackRows &rows);
