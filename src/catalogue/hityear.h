#pragma once

#include <QString>

/// Whether a text is a year in the sense of the editors: exactly 4 characters, numeric in the loose
/// way ("1e10" passes), above 1900. The empty text is none.
bool isHitYear(const QString &text);
