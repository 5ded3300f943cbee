#pragma once

#include "platform/ado/recordset.h"

/// What the browser of the collection shows, read from the catalogue; no widgets. All throw
/// Error.
namespace browserlists
{

ADODB::RecordsetPtr compilations();   // Id, Titel
ADODB::RecordsetPtr albums();         // Id, Artiest, Titel
ADODB::RecordsetPtr mp3Collections(); // Id, Map, Album
qint64 trackCount();

/// Deletes a title with its discs, in one transaction; its tracks and artists are CleanOrphans'.
void deleteTitle(qint64 id);
void deleteMP3Collection(qint64 id); // an editor that is open on it knows

} // namespace browserlists
