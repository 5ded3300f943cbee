#pragma once

#include "platform/files/systemfile.h"
#include "tags/CddbID3Tag.h"

#include <QString>

/// What a form knows of the file of a row.
struct FileMemory {
    enum State : quint8 {
        Unread,
        Read,       // the row holds the tag
        Unreadable, // there is a file that cannot be opened; the user was told
        Missing,    // no ordinary file has this name
        Left        // a reading was cancelled before it came to this one
    };
    State state = Unread;
    FileStamp stamp = {}; // of Read and Unreadable
};

/// What a look at one file has found.
struct FileFound {
    FileMemory memory = {};
    bool isNew = false;  // otherwise all is as it was remembered
    CddbID3Tag tag = {}; // of one that was read now
};

/// Looks at a file of a collection, and reads its tag unless it is as remembered. What is no
/// ordinary file is never opened. For a worker.
FileFound lookAtFile(const QString &folder, const QString &fileName, const FileMemory &remembered);
