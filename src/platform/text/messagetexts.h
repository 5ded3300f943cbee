#pragma once

#include <QString>

namespace text
{

/// The text of a key of the message table, for the rooms below it. Until the table is there a text
/// is its key.
QString ofKey(const char *key);

using OfKey = QString (*)(const char *key);
void setKeys(OfKey texts);

} // namespace text
