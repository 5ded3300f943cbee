#pragma once

#include "discs/opaquetoc.h"

/// What stands where a disc was looked for.
struct FoundDisc {
    OpaqueToc toc;
    int tracks = 0;                // 0: no audio disc
    const char *problem = nullptr; // key of a text that says why, where there is more to say
    QString about;                 // what that text is about: a file
    bool cancelled = false;
};
