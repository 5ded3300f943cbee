#pragma once

#include "discs/discrecord.h"
#include "discs/toc.h"

#include <QByteArrayView>
#include <functional>
#include <optional>

/// What the sheet beside the image of a disc says: a cue sheet, or a text of cdrdao.
struct DiscSheet {
    TableOfContents toc; // no tracks where a file that counts could not be measured
    DiscRecord known;    // titles and names; trackCount holds whatever became of the table
    QString missing;     // the first file that could not be measured
};

enum class LengthIn { Bytes, Frames };

/// Measures a file that a sheet names: in bytes where it holds raw sectors, in frames of 1/75 s
/// where it is sound in a format of its own. Nothing if there is no such file.
using LengthOfFile = std::function<std::optional<qint64>(const QString &name, LengthIn unit)>;

namespace discsheet
{

/// The text of a sheet: UTF-16 or UTF-8 by their mark, else UTF-8 or Windows-1252.
QString decoded(QByteArrayView bytes);

/// "mm:ss:ff" as frames; nothing if it is none.
std::optional<qint64> framesOf(const QString &minutesSecondsFrames);

/// Fills in what follows from the rest: whose the tracks are, how long they are, how many, and
/// whether it is a compilation. False if no disc can have such a table.
bool complete(DiscSheet &sheet);

} // namespace discsheet
