#pragma once

#include "tags/CddbID3Tag.h"

class SystemFile;

/// The tag at the beginning of a file.
struct FileTag {
    QByteArray bytes; // all of it, padding included; empty without one
    CddbID3Tag fields;
    bool isWhole =
        true; // false: damaged, or not at the beginning; it is read but not to be written
};

/// Throws Error (errFileFailed) where the file cannot be opened or read.
FileTag readTag(const QString &path);
FileTag readTag(const SystemFile &file);
