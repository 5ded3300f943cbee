#pragma once

#include "platform/error/error.h"

namespace ADODB
{

/// The error for a result code of SQLite; message is the engine's own, in English.
Error engineError(int code, const QString &message);

} // namespace ADODB
