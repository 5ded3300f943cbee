#pragma once

#include "platform/error/error.h"
#include "platform/text/messagetexts.h"

/// An answer or a file that is none of ours: the text of a key of the message table, and what is
/// wrong with it.
inline Error notUnderstood(const char *key, const QString &detail = {})
{
    return {errSyntax, QStringLiteral("discs"), errorText(key, detail)};
}
