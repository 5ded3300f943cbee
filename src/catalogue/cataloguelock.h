#pragma once

#include "platform/files/filelock.h"

/// One running program per catalogue: the lock belongs to the file itself, so that neither another
/// name of it nor another user leads past it, and dies with its holder. A mark beside the file
/// tells for as long as this object lives that a program runs on it; a mark that is there before is
/// of a run that did not get to its end.
class CatalogueLock
{
public:
    CatalogueLock() = default;
    ~CatalogueLock();
    CatalogueLock(CatalogueLock &&other) noexcept;
    CatalogueLock &operator=(CatalogueLock &&other) noexcept;

    FileLock::Outcome take(const QString &catalogue);

    /// Sets the mark, of a catalogue whose lock was taken.
    void markRunning(const QString &catalogue);
    bool lastRunBroken() const { return mLastRunBroken; }

private:
    FileLock mLock;
    QString mMark;
    bool mLastRunBroken = false;
};
