#pragma once

#include <QString>

namespace text
{

/// Whether the text is a number in the sense of numeric.h; the empty text is none.
bool isNumeric(QStringView s);

/// The first letter of each word a capital, all others small. Words are parted by blanks and
/// control characters only; the mapping is letter by letter, so "ß" stays and the length never
/// changes.
QString properCase(const QString &s);

/// At most `length` UTF-16 units from the start; a pair of surrogates is never split.
QString cutTo(const QString &s, qsizetype length);

/// A text whose line ends are CR, LF or both, with LF alone: what labels and boxes can show.
QString withLineFeeds(QString s);

} // namespace text
