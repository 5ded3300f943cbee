#pragma once

#include <QString>

namespace ADODB
{
class Connection;
}

/// The file of the catalogue: how a new one is made and how one is recognised.
namespace cataloguefile
{

inline constexpr int applicationId = 0x536F6E67; // "Song"
inline constexpr int formatVersion = 4;

/// Makes an empty catalogue with its six tables and indexes. The file must not be there yet. Throws
/// Error.
void create(const QString &file);

/// Looks at the bytes of a file that is to be opened, and at what lies beside it, without the
/// engine: whether it is a catalogue of this program, may be written, and can be given to the
/// engine at all. Throws Error; no file is touched.
void inspect(const QString &file);

/// After it was opened: whether nobody has locked it, it holds the six tables and nothing that a
/// new one does not hold, and is undamaged. With `thorough`, or when that is quick, every index is
/// compared with its table. Indexes that were made by another version of the program or of the sort
/// order are made anew. Throws Error; the file is then as it was.
void verify(ADODB::Connection &connection, bool thorough);

} // namespace cataloguefile
