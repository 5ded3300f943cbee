#pragma once

#include "tags/CddbID3Tag.h"

/// What a tag becomes when fields get other values.
struct SplicedTag {
    QByteArray bytes;
    bool isChanged = false;
};

/// `tag`: the bytes of a whole tag, empty for a file without one; it gets version 2.3 then. Only
/// frames of fields that differ from `current`, what is read from it, are replaced; all others keep
/// their bytes and their order. It keeps its size where it can; where it cannot it grows by whole
/// blocks of a disk, so that the sound behind it can be shared and not copied.
/// A comment that says what it is about, and identifiers of other programs, are nobody's field:
/// they stay. Throws Error: errTagDamaged, errTagTooLong.
SplicedTag splicedTag(const QByteArray &tag, const CddbID3Tag &current, const CddbID3Tag &wanted);

/// What a file reads that was given `wanted`: the fields as they are read, and instead of an
/// identifier that the program does not write, the one that is there.
CddbID3Tag asRead(const CddbID3Tag &wanted, const CddbID3Tag &current);
