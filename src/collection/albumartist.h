#pragma once

#include <QString>

/// The artist of an album in the catalogue. All throw Error; the two that write run in the
/// transaction of the save.
namespace albumartist
{

/// The id of the one artist of this name; where there is none, or more than one, of a new row.
qint64 findOrMake(const QString &name);

QString nameOf(qint64 artist);

/// Points the links of an album at tracks of this artist, on all its discs. A track row belongs to
/// one artist and may stand on other discs, so it is never changed: the artist's own track of the
/// same title is taken, with its genre and year, or a copy of the old one made. Rows that nothing
/// points at any more are CleanOrphans'.
void moveTracks(qint64 cd, qint64 artist);

} // namespace albumartist
