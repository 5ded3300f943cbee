#pragma once

#include "platform/error/error.h"

/// Failures of tags that callers tell apart.
enum TagError : int {
    errTagNotAccessible = int(0x82FC100C), // no such file, no right to write it, in use
    errTagDamaged = int(0x82FC1001),       // not read whole, so not written
    errTagTooLong = int(0x82FC1002),       // more than a tag can hold
    errTagNotWritten = int(0x82FC1003),    // the disk failed; the file is as it was
    errFileNotMoved = int(0x82FC1004),
    errNameRefused = int(0x82FC1005),   // not moved: the disk cannot have such a name
    errChangeNotKept = int(0x82FC1006), // not done: the journal cannot be written
    errNotReplaced = int(0x82FC1007),   // not moved: another file has the name, and keeps it
};

/// The text of a key of the message table, the name of the file behind it.
Error tagError(TagError number, const char *key, const QString &path);
