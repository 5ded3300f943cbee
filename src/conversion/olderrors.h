#pragma once

#include "platform/error/error.h"

/// Why an old catalogue cannot be taken over: the text of a key with a detail behind it.
Error oldDatabaseError(const char *key, const QString &detail = {});
