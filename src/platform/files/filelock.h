#pragma once

#include <QString>

/// The kernel's own lock on an open file. It belongs to the file, whatever road led to it, and
/// ends with the process that holds it, however that ends: what such a file contains, or that it
/// was left behind, locks nobody out. It covers one byte far behind any content, so the locks that
/// SQLite takes on the same file are not touched, and closing the file elsewhere does not drop it.
class FileLock
{
public:
    FileLock() = default;
    ~FileLock();
    FileLock(FileLock &&other) noexcept;
    FileLock &operator=(FileLock &&other) noexcept;

    enum class Outcome {
        Taken,
        Held,
        Unusable
    }; // Held: by another; Unusable: no such file, no right

    /// For a file that is there.
    Outcome take(const QString &file);

    /// For a file that is there for the lock alone: made where it is missing, and left there, for a
    /// name that comes and goes can be locked by two. Waits for another to let go.
    Outcome takeWithin(const QString &lockFile, int milliseconds);

    /// Whether it is taken, of the file that has this name now.
    bool isOf(const QString &file) const;

    /// The same lock for a file that is open for writing already, until that is closed.
    static Outcome takeFor(int handle);

private:
    Outcome take(const QString &file, int flags);

    int mHandle = -1;
};
