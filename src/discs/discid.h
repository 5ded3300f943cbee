#pragma once

#include "discs/toc.h"

/// The id of a disc at CDDB-type services: 8 hexadecimal digits. Data tracks count.
QString cddbId(const TableOfContents &toc);

/// The arguments of a query there: id, number of tracks, offsets, seconds; blanks between.
QString cddbQuery(const TableOfContents &toc);

/// The arguments of a query of which only such an id is known: its tracks and its seconds, the
/// tracks of one length.
QString cddbQueryOfId(const QString &id);

/// How many tracks the disc of such an id has; 0 where it is no such id.
int tracksOfCddbId(const QString &id);

/// The id of a disc at MusicBrainz: 28 characters. Data tracks at the end do not count.
QString musicBrainzId(const TableOfContents &toc);

/// The table as MusicBrainz takes it: first, last, lead-out, offsets; blanks between.
QString musicBrainzToc(const TableOfContents &toc);

/// The table as MusicBrainz counts it: without data tracks at the end, the lead-out before them.
TableOfContents withoutDataBehind(TableOfContents toc);
