#pragma once

#include "discs/discrecord.h"

/// "Artist / title" at the first " / " with blanks on both sides. `isSplit` is false without one;
/// all is in `title` then.
struct SplitTitle {
    QString artist, title;
    bool isSplit = false;
};
SplitTitle splitTitle(const QString &text, const QString &sign = QStringLiteral(" / "));

/// Finds out whether a record without such a mark is a compilation, and takes the artists of its
/// tracks out of their titles; the tracks of an album get the artist of the disc.
void findCompilation(DiscRecord &disc);
