#pragma once

#include "tags/CddbID3Tag.h"

/// Where the fields of a tag stand in a row of the Tags Processor, as its caller lays it out.
namespace tagrow
{

inline constexpr int fileName = 1; // sub-item
inline constexpr int firstTag = 2; // of the fields, in this order
inline constexpr TagField fields[] = {
    TagField::Album,     TagField::LeadArtist, TagField::Title, TagField::TrackPosition,
    TagField::PartOfSet, TagField::Year,       TagField::Genre, TagField::CopyrightHolder,
    TagField::Label,     TagField::Comments,   TagField::FileId};
inline constexpr int lastShownTag = firstTag + int(std::size(fields)) - 2; // the file id is hidden

} // namespace tagrow
