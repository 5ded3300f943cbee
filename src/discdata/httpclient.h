#pragma once

#include "discdata/requestpace.h"
#include "discdata/serviceoptions.h"

#include <QNetworkAccessManager>
#include <QUrl>

class LongWork;
class QNetworkReply;

/// What became of a request.
struct HttpAnswer {
    enum class End {
        Answered,     // whole, whatever its status
        NotConnected, // nobody listens there, or where the proxy should be
        NotReached,   // no such name, no network, no proxy, no TLS that can be trusted, silence
        ProxyRefused, // name or password
        Failed,       // cut off, too long, sent round in circles or where it may not go
        Cancelled,
    };
    End end = End::Failed;
    int status = 0;
    QByteArray type; // Content-Type
    QByteArray body; // empty unless whole
    QString words;   // for the user: what went wrong, or what stands behind the status

    QByteArray location;
    int retryAfter = 0; // seconds

    bool isHtml() const { return type.startsWith("text/html"); }
    bool isTooBusy() const; // worth asking again a little later
};

/// Asks servers by HTTP. To the caller a request is synchronous; the work lets the program paint
/// and can be cancelled meanwhile. Nothing is kept or sent that nobody asked for: no cookies, no
/// cache, no credentials, no proxy but the one that is set; and what TLS does not trust is not
/// used.
class HttpClient : public QObject
{
    Q_OBJECT

public:
    using Headers = QList<std::pair<QByteArray, QByteArray>>;

    /// `retries`: how often a server that is too busy is asked again.
    HttpClient(const ServiceOptions &options, int retries,
               RequestPace::Pause pause = RequestPace::pauseFor);

    HttpAnswer get(const QUrl &url, LongWork &work);

    /// The record goes to this server alone: a redirect to another is not followed.
    HttpAnswer post(const QUrl &url, const Headers &headers, const QByteArray &body,
                    LongWork &work);

    static QByteArray userAgent();

private:
    struct Request {
        QUrl url;
        bool isPost = false;
        Headers headers = {};
        QByteArray body = {};
    };
    HttpAnswer ask(Request request, LongWork &work);
    HttpAnswer askPatiently(const Request &request, LongWork &work);
    HttpAnswer askOnce(const Request &request, LongWork &work);
    QNetworkReply *start(const Request &request);
    void setProxy();
    int pauseBefore(int attempt, const HttpAnswer &answer) const;

    ServiceOptions mOptions;
    int mRetries;
    RequestPace mPace;
    QNetworkAccessManager mManager;
    bool mProxyAsked = false;
};
