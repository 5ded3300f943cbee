#pragma once

#include "discdata/discservice.h"
#include "discdata/httpclient.h"

/// How failures are told, in one way for both services.

/// errServiceFailed with the text of a key; the detail stands behind it.
Error serviceFailed(const QString &service, const char *key, const QString &detail = {});

/// What a server says itself, for the user: one line without control signs. `spare` where it says
/// nothing.
QString serversWords(const QByteArray &said, const QString &spare);

/// "HTTP 503 Service Unavailable"
QString statusWords(const HttpAnswer &answer);

/// Throws where there is no answer, for whatever reason.
void requireAnswer(const HttpAnswer &answer, const QString &service);

/// What `read` makes of an answer's bytes; errServiceFailed where it does not understand them.
template <typename Read> auto understood(const QString &service, const Read &read)
{
    try {
        return read();
    } catch (const Error &) {
        throw serviceFailed(service, "xServiceStrange");
    }
}
