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

/// Looks at the bytes of a file that is to be opened, without the engine: whether it is a catalogue
/// of this program, and may be written. Throws Error; the file is not touched.
void inspect(const QString &file);

/// After it was opened: whether nobody has locked it, all six tables are there and, with `thorough`
/// or when that is quick, whether it is undamaged. Indexes that were made under another version of
/// the sort order are made anew. Throws Error.
void verify(ADODB::Connection &connection, bool thorough);

} // namespace cataloguefile
