#include "discdata/serviceerrors.h"

#include "discs/candidates.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype longestWords = 300;

} // namespace

Error serviceFailed(const QString &service, const char *key, const QString &detail)
{
    return {errServiceFailed, service, errorText(key, detail)};
}

QString serversWords(const QByteArray &said, const QString &spare)
{
    const QString line =
        QString::fromUtf8(said.left(4 * longestWords)).trimmed().section(u'\n', 0, 0);
    const QString words = cleanText(line).left(longestWords);
    return words.isEmpty() ? spare : words;
}

QString statusWords(const HttpAnswer &answer)
{
    const QString line = u"HTTP "_s + QString::number(answer.status) + u' ' + answer.words;
    return cleanText(line);
}

void requireAnswer(const HttpAnswer &answer, const QString &service)
{
    switch (answer.end) {
    case HttpAnswer::End::Answered:
        return;
    case HttpAnswer::End::NotConnected:
    case HttpAnswer::End::NotReached:
        throw Error(errHostNotFound, service, errorText("xServiceNotReached", answer.words));
    case HttpAnswer::End::ProxyRefused:
        throw Error(errServiceRefused, service, errorText("xProxyRefused", {}));
    case HttpAnswer::End::Cancelled:
        throw Error(errLookupCancelled, service, errorText("xServiceCancelled", {}));
    case HttpAnswer::End::Failed:
        break;
    }
    throw Error(errServiceFailed, service, answer.words);
}
