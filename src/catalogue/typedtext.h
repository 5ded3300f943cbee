#pragma once

#include <QString>

/// How a text that somebody typed or pasted is kept, in the fields at the head of a record and in
/// the cells of its tracks alike.
namespace typedtext
{

struct Kept {
    QString text;
    bool cut = false; // it was too long
};

/// One line: blanks for line ends, tabs and the like, none around it, NFC, as much of it as there
/// is room for. A text that is as it was before stays so, whatever it is like.
Kept keep(const QString &typed, const QString &before = {});

/// How many characters (UTF-16 units) may be typed over such a text: 255, or as many as it has
/// already, for another program may have stored more.
int room(const QString &before);

} // namespace typedtext
