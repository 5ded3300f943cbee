#pragma once

#include "tags/filechange.h"

/// Whether somebody may write a file: what root, who may write all, has to ask.
bool isForWriting(const SystemFile &file);

/// A change of the bytes at the beginning of a file for others, in four steps: it is planned, told
/// to the journal, prepared and performed. At any moment the file is the old one or the new one, or
/// mendHead() makes it so.
struct HeadChange {
    FileChange change;
    QByteArray oldBytes; // InPlace: those that are written over; else the whole old head
    QByteArray newBytes; // the same of the new one

    /// What the journal keeps.
    QByteArray kept() const;
};

/// `file` has no links in its name, and began with `oldHead` when it was as `before` says. The way
/// follows from the lengths of the heads, and from what the file is: one with several names, in a
/// folder that cannot be written, or of another owner, keeps its place.
HeadChange plannedHead(const SystemFile &file, const FileStamp &before, const QByteArray &oldHead,
                       const QByteArray &newHead);

/// For a change that goes Through: writes the copy of the new file, synced, before the journal is
/// told.
void prepareHead(const HeadChange &head, const SystemFile &file);

/// Throws Error; mendHead() tells then what has become of the file. A Beside that finds it cannot
/// give the new file what the old one has (owner, rights) throws NoWayBeside with the file
/// untouched.
struct NoWayBeside {
};
void performHead(const HeadChange &head, SystemFile &file);

/// What a change that was begun has left: puts the file right where it is neither. `back`: the
/// change has failed, so bytes that a disk may not have taken are not trusted, and the old ones
/// written again.
enum class Mended {
    Old,
    New,
    Foreign, // something else has written the file since: it is left alone
    NotNow   // the file, or what is needed to mend it, cannot be reached
};
Mended mendHead(const FileChange &change, const QByteArray &kept, bool back = false);
