#pragma once

#include "platform/error/error.h"

/// What a handler shows of a failed routine: one box with the error under the given title, then one
/// for each entry of the connection's Errors.
void showDatabaseErrors(const Error &error, const QString &title = {});
