#include "discdata/httpclient.h"

#include "discdata/httptransfer.h"
#include "platform/error/error.h"
#include "platform/work/longwork.h"

#include <QAuthenticator>
#include <QHostAddress>
#include <QNetworkProxy>
#include <QRandomGenerator>
#include <QSslConfiguration>

using namespace Qt::StringLiterals;

namespace
{

constexpr int mostRedirects = 5;
constexpr int longestPause = 30 * 1000; // milliseconds; who is told to wait longer gives up

// Where a user of the program finds those who make it.
constexpr char contact[] = "songcase@songcase.invalid";

bool isRedirect(const HttpAnswer &answer)
{
    const bool redirects = answer.status == 301 || answer.status == 302 || answer.status == 303 ||
                           answer.status == 307 || answer.status == 308;
    return answer.end == HttpAnswer::End::Answered && redirects;
}

// Never from what is encrypted to what is not.
bool mayGo(const QUrl &from, const QUrl &to)
{
    if (!to.isValid() || to.host().isEmpty())
        return false;
    return to.scheme() == "https"_L1 || (to.scheme() == "http"_L1 && from.scheme() == "http"_L1);
}

HttpAnswer cancelled()
{
    HttpAnswer answer;
    answer.end = HttpAnswer::End::Cancelled;
    return answer;
}

HttpAnswer wrongRedirect()
{
    HttpAnswer answer;
    answer.words = errorText("xServiceRedirect", {});
    return answer;
}

} // namespace

bool HttpAnswer::isTooBusy() const
{
    const bool gateway = status == 200 && isHtml();
    return end == End::Answered && (status == 429 || status >= 500 || gateway);
}

QByteArray HttpClient::userAgent()
{
    return QByteArray("Songcase/" SONGCASE_VERSION " ( ") + contact + " )";
}

HttpClient::HttpClient(const ServiceOptions &options, int retries, RequestPace::Pause pause)
    : mOptions(options),
      mRetries(retries),
      mPace(options.paceFolder, options.interval, std::move(pause))
{
    setProxy();
}

// Without one it is said that there is none: the system's settings are not the program's.
void HttpClient::setProxy()
{
    if (mOptions.proxyHost.isEmpty()) {
        mManager.setProxy(QNetworkProxy::NoProxy);
        return;
    }
    mManager.setProxy({QNetworkProxy::HttpProxy, mOptions.proxyHost, quint16(mOptions.proxyPort)});
    connect(&mManager, &QNetworkAccessManager::proxyAuthenticationRequired, this,
            [this](const QNetworkProxy &, QAuthenticator *to) {
                if (mProxyAsked || mOptions.proxyUser.isEmpty())
                    return; // the second question is the answer no
                mProxyAsked = true;
                to->setUser(mOptions.proxyUser);
                to->setPassword(mOptions.proxyPassword);
            });
}

HttpAnswer HttpClient::get(const QUrl &url, LongWork &work)
{
    return ask({url}, work);
}

HttpAnswer HttpClient::post(const QUrl &url, const Headers &headers, const QByteArray &body,
                            LongWork &work)
{
    return ask({url, true, headers, body}, work);
}

HttpAnswer HttpClient::ask(Request request, LongWork &work)
{
    for (int redirects = 0;; ++redirects) {
        HttpAnswer answer = askPatiently(request, work);
        if (!isRedirect(answer))
            return answer;
        QUrl to = request.url.resolved(QUrl::fromEncoded(answer.location));
        const bool sameServer = to.host() == request.url.host() && answer.status != 303;
        if (redirects == mostRedirects || answer.location.isEmpty() || !mayGo(request.url, to) ||
            (request.isPost && !sameServer))
            return wrongRedirect();
        to.setUserInfo({});
        request.url = to;
    }
}

HttpAnswer HttpClient::askPatiently(const Request &request, LongWork &work)
{
    for (int attempt = 0;; ++attempt) {
        HttpAnswer answer = askOnce(request, work);
        const int pause = pauseBefore(attempt, answer);
        if (!answer.isTooBusy() || attempt == mRetries || pause > longestPause)
            return answer;
        if (!mPace.pause(pause, work))
            return cancelled();
    }
}

// Longer each time, and not the same for all that wait. A server that is busy may say "after 0
// seconds".
int HttpClient::pauseBefore(int attempt, const HttpAnswer &answer) const
{
    const int own = mPace.interval() << qMin(attempt, 5);
    const int chance = int(QRandomGenerator::global()->bounded(own / 2 + 1));
    const int told = qMin(answer.retryAfter, longestPause / 1000 + 1) * 1000;
    return qMax(own, told) + chance;
}

HttpAnswer HttpClient::askOnce(const Request &request, LongWork &work)
{
    // A server of this machine's own need not be spared.
    const QString host = request.url.host();
    const bool isOwn = host == "localhost"_L1 || QHostAddress(host).isLoopback();
    if (!isOwn && !mPace.await(host, work))
        return cancelled();
    mProxyAsked = false;
    HttpTransfer transfer(start(request), mOptions.silence);
    return transfer.run(work) ? transfer.answer() : cancelled();
}

QNetworkReply *HttpClient::start(const Request &request)
{
    QNetworkRequest asked(request.url);
    asked.setRawHeader("User-Agent", userAgent());
    asked.setAttribute(QNetworkRequest::RedirectPolicyAttribute,
                       QNetworkRequest::ManualRedirectPolicy);
    asked.setAttribute(QNetworkRequest::CookieLoadControlAttribute, QNetworkRequest::Manual);
    asked.setAttribute(QNetworkRequest::CookieSaveControlAttribute, QNetworkRequest::Manual);
    asked.setAttribute(QNetworkRequest::Http2AllowedAttribute, false);
    asked.setDecompressedSafetyCheckThreshold(HttpTransfer::longest);
    if (!mOptions.extraCa.isEmpty()) {
        QSslConfiguration tls = asked.sslConfiguration();
        tls.addCaCertificates(QSslCertificate::fromData(mOptions.extraCa));
        asked.setSslConfiguration(tls);
    }
    for (const auto &[name, value] : request.headers)
        asked.setRawHeader(name, value);
    return request.isPost ? mManager.post(asked, request.body) : mManager.get(asked);
}
