#pragma once

#include "discdata/founddisc.h"

class LongWork;

/// Asks songcase-disc, the small program that may crash, hang or talk nonsense: then there is no
/// disc.
class DiscReader
{
public:
    DiscReader(LongWork &work, const QString &program) : mWork(work), mProgram(program) {}

    FoundDisc readImage(const QString &file);
    FoundDisc readDrive(const QString &device);

private:
    LongWork &mWork;
    const QString mProgram;
};
