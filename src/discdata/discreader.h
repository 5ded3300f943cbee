#pragma once

#include "discdata/founddisc.h"

class LongWork;

/// Asks songcase-disc, the small program that may crash, hang or talk nonsense: then there is no
/// disc.
class DiscReader
{
public:
    /// patience: the seconds that it may be silent.
    DiscReader(LongWork &work, const QString &program, int patience)
        : mWork(work), mProgram(program), mPatience(patience)
    {
    }

    FoundDisc readImage(const QString &file);
    FoundDisc readDrive(const QString &device);

private:
    FoundDisc ask(const QStringList &arguments);

    LongWork &mWork;
    const QString mProgram;
    const int mPatience;
};
