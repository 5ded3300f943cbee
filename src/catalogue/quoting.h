#pragma once

#include "platform/ado/command.h"

// The only ways in which values enter a statement: those of a command as parameters, all others
// between quotes.

/// The text between single quotes, each one inside doubled.
QString quoted(const QString &text);

/// The same, or the word NULL for an empty text.
QString quotedOrNull(const QString &text);

/// The number as it stands, or the word NULL for an empty text. The text must be numeric.
QString numberOrNull(const QString &text);

/// Each single quote doubled, for statements that bring their own quotes.
QString doubled(QString text);

/// For a command: NULL for an empty text.
ADODB::Parameter textOrNull(std::string_view text);

/// For a command: a number as it is read and typed, NULL for an empty text. Throws Error.
ADODB::Parameter wholeOrNull(std::string_view digits);

/// What a text comes to that is put between single quotes as it stands: two inside are one, and a
/// single one breaks the statement, which fails as the engine would fail it.
std::string undoubled(ADODB::Connection &connection, std::string_view text);
