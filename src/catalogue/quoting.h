#pragma once

#include <QString>

// The only ways in which values enter a statement.

/// The text between single quotes, each one inside doubled.
QString quoted(const QString &text);

/// The same, or the word NULL for an empty text.
QString quotedOrNull(const QString &text);

/// The number as it stands, or the word NULL for an empty text. The text must be numeric.
QString numberOrNull(const QString &text);

/// Each single quote doubled, for statements that bring their own quotes.
QString doubled(QString text);
