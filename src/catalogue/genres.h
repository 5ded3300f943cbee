#pragma once

#include <QStringList>

/// The genres that the screens offer in a language (19 Dutch, any other English), in the order of
/// their lists. Nothing binds a record to them: a genre is any text, stored as it was entered and
/// never translated.
const QStringList &genres(int language);
