#pragma once

class QSaveFile;

/// Gives a file that was written its name, if all of it has reached the disk; otherwise what had
/// the name before stays and the result is false. To be used for QSaveFile::commit(), which
/// overlooks that its last bytes, still in memory, find the disk full.
bool commitWhole(QSaveFile &file);
