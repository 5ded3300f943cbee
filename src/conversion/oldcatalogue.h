#pragma once

#include <QString>

namespace ADODB
{
class Connection;
}
class LongWork;

/// Opens a catalogue of the older program, of whatever generation of its database: a helper program
/// reads the file, which is never written, and its tables come to stand in memory behind this
/// connection, for the usual statements. All rows are there then, as many as the file states.
/// False: cancelled. Throws Error, in words for the user; the connection is then closed.
/// withMP3: whether the tables of MP3 files are read, and must be there.
bool openOldCatalogue(ADODB::Connection &connection, const QString &file, bool withMP3,
                      LongWork &work);
