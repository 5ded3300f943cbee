#pragma once

#include "platform/ado/recordset.h"

/// What the record tree shows, read from the catalogue one opened node at a time; no widgets. All
/// throw Error.
namespace recordnodes
{

/// ID and Artiest of those whose name begins with this letter, or with a digit.
ADODB::RecordsetPtr artists(const QString &letter);
ADODB::RecordsetPtr artistsWithDigit();

ADODB::RecordsetPtr tracks(const QString &artistId); // ID, Titel
ADODB::RecordsetPtr discs(const QString &trackId);   // ID of the link, Titel, Diskno, Trackno

/// The title that a link belongs to; id 0 if there is none any more.
struct Title {
    qint64 id = 0;
    bool isCompilation = false;
};
Title titleOf(const QString &linkId);

} // namespace recordnodes
