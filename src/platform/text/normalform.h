#pragma once

#include <QString>
#include <string_view>

namespace text
{

/// UTF-8 in NFC: the form in which the catalogue keeps texts.
QByteArray nfc(QStringView s);

/// Whether UTF-8 is in NFC whatever it says: it has nothing from U+0300 on.
bool surelyNfc(std::string_view utf8);

/// UTF-8 as it is; U+FEFF at its start, which Qt takes for the mark of a file, is a character like
/// any other.
QString fromUtf8(std::string_view utf8);

} // namespace text
