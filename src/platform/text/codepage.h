#pragma once

#include <QByteArrayView>
#include <QString>

namespace text
{

/// The encodings that a text file of the user may have.
enum class Encoding { Utf8, Windows1252 };

/// Utf8 if the bytes are valid UTF-8 as a whole (a byte order mark or pure ASCII included), else
/// Windows-1252: files carry no mark that tells.
Encoding encodingOf(QByteArrayView bytes);

/// One piece of a file of that encoding as text. The five bytes that Windows-1252 leaves open
/// become the control characters of the same number, so that no byte is lost.
QString decode(QByteArrayView bytes, Encoding encoding);

/// The bytes without a leading UTF-8 byte order mark.
QByteArrayView withoutByteOrderMark(QByteArrayView bytes);

} // namespace text
