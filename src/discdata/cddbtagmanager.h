#pragma once

#include "discdata/cddbobjects.h"
#include "tags/CddbID3Tag.h"
#include "tags/filechanges.h"

#include <optional>

class CDDBControl;

/// Brings MP3 files and the discs of the services together: which disc a file is from, the tag that
/// a track of a disc has, and the tag into its file. From GetTagManager of a control.
class CddbTagManager
{
public:
    explicit CddbTagManager(CDDBControl &control) : mControl(control) {}

    /// The disc of an MP3 file, if one alone fits, and the number of the file's track on it. Else
    /// nothing, and the control's GetFileMatches has what may fit. Throws Error as the control's
    /// other look-ups.
    CddbDiscPtr LookupByFile(const QString &path, int flags, int &track);

    /// All fields that the disc tells of this track, from 1: the others are empty. Of a track that
    /// is not on it the disc's alone.
    CddbID3Tag TagForTrack(const CddbDisc &disc, int track) const;

    /// Throws Error; errTagNotAccessible where the file cannot be written. It can be taken back.
    void SaveTagToFile(const CddbID3Tag &tag, const QString &path, int flags);

    /// Saves of many files, for as long as this object lives: one undo takes them back together.
    class Batch
    {
    public:
        /// `where`: the folder, in words of the user.
        Batch(CddbTagManager &manager, const QString &where,
              const std::vector<std::pair<QString, CddbID3Tag>> &tags);
        ~Batch() { mManager.mChanges.reset(); }
        Batch(const Batch &) = delete;
        Batch &operator=(const Batch &) = delete;

    private:
        CddbTagManager &mManager;
    };

private:
    CDDBControl &mControl;
    std::optional<FileChanges> mChanges; // of a batch
};
