#pragma once

#include <QString>

inline constexpr int languageEnglish = 1;
inline constexpr int languageDutch = 19;

/// The text of a key in the language of the run (gLanguage). A key that no table has gives
/// "Unknown" or "Onbekend"; any language but the two gives the empty text. Lines break at CR.
QString GetMessage(QLatin1String key);
QString GetMessage(QLatin1String key, int language); // for controls that have one of their own
inline QString GetMessage(const char *key)
{
    return GetMessage(QLatin1String(key));
}
