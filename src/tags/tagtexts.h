#pragma once

#include <QByteArray>
#include <QStringList>

// How texts stand in the frames of a tag, and what the program makes of them.

/// Without the blanks and zero bytes at its ends: fields of fixed length are filled with them.
QString withoutFilling(const QString &text);

/// The texts of a frame, the first byte of which tells how they are written: 0 ISO 8859-1, 1 UTF-16
/// with a byte order mark, 2 UTF-16 with the highest byte first, 3 UTF-8. A zero ends each but the
/// last.
QStringList frameTexts(const QByteArray &content);

/// The rest behind `count` texts that a zero ends, with their encoding before it.
QByteArray behindTexts(const QByteArray &content, int count);

/// A text in the smallest encoding that all programs read, for the version of a tag. The first byte
/// tells which; what `alsoHolds` must fit into it too.
QByteArray encodedText(const QString &text, int version);

/// "03/09" is 3/9.
QString withoutZeros(const QString &numbers);

/// "17" and "(17)" are Rock, "(17)Hard rock" is both, "((x)" is "(x)".
QStringList genreNames(const QString &genre);
