#pragma once

#include "tags/CddbID3Tag.h"

#include <vector>

/// The tags that the tracks of a disc of the catalogue give, in the order of their numbers. What
/// the catalogue does not know of a track is "?"; it has no copyright, label, comment and file id.
std::vector<CddbID3Tag> tagsOfDisc(qint64 cdId, qint64 discNo);

/// Of one track; throws Error where it is not there any more.
CddbID3Tag tagOfTrack(qint64 cdId, qint64 discNo, qint64 trackNo);
