#pragma once

#include "discdata/founddisc.h"

#include <stop_token>

// Discs as files of the user. These read many files and take their time: for a worker.

/// A cue sheet or a text of cdrdao, told apart by the ending. Where its image is missing, the
/// names in it are words to search by.
FoundDisc readSheetFile(const QString &name);

/// The sound files of a folder, as the tracks of one disc: in the order of the numbers in their
/// tags if all have one, else of their names. A cue sheet that lies there alone tells more, and is
/// read instead. All of them must be readable.
FoundDisc readSoundFolder(const QString &folder, const std::stop_token &stop);

/// An image, by the sheet of its name that lies beside it.
FoundDisc readSheetOfImage(const QString &image);
