#include "tags/CddbID3Tag.h"

#include "platform/error/error.h"
#include "platform/files/ordinaryfile.h"
#include "tags/tagfile.h"

const char *const ownFileIdOwner = "songcase";

// Tags that are not as they should be, or do not stand at the beginning, are left to TagLib, which
// makes something of most.
void CddbID3Tag::LoadFromFile(const QString &path, int)
{
    if (!isOrdinaryFile(path))
        throw makeError(errFileFailed, path);
    *this = readTag(path).fields;
}
