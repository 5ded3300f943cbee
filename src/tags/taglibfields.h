#pragma once

#include "tags/CddbID3Tag.h"

#include <optional>

/// The fields of a file's ID3v2 tag as TagLib reads them, wherever the tag stands and however
/// damaged it is; nothing for a file without one. Throws Error (errFileFailed) for a file that
/// cannot be opened.
std::optional<CddbID3Tag> fieldsByTagLib(const QString &path);
