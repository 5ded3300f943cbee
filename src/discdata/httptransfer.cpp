#include "discdata/httptransfer.h"

#include "platform/error/error.h"
#include "platform/work/longwork.h"

#include <QNetworkReply>

using namespace Qt::StringLiterals;

using End = HttpAnswer::End;

HttpTransfer::HttpTransfer(QNetworkReply *reply, int silence) : mReply(reply)
{
    mSilence.setSingleShot(true);
    mSilence.setInterval(silence);
    listenTo();
    mSilence.start();
}

HttpTransfer::~HttpTransfer()
{
    mReply->disconnect(this);
    mReply->abort();
}

// Each sign of life begins the silence anew.
void HttpTransfer::listenTo()
{
    const auto restart = [this] { mSilence.start(); };
    QNetworkReply *reply = mReply.get();
    connect(reply, &QNetworkReply::metaDataChanged, this, restart);
    connect(reply, &QNetworkReply::uploadProgress, this, restart);
    connect(reply, &QNetworkReply::encrypted, this, [=, this] {
        mEncrypted = true;
        restart();
    });
    connect(reply, &QNetworkReply::readyRead, this, [=, this] {
        restart();
        takeBytes();
    });
    connect(reply, &QNetworkReply::finished, &mSilence, &QTimer::stop);
    connect(&mSilence, &QTimer::timeout, this, [this] { stop(End::NotReached, "xServiceSilent"); });
}

void HttpTransfer::takeBytes()
{
    mBody += mReply->readAll();
    if (mBody.size() > longest)
        stop(End::Failed, "xServiceTooLong");
}

void HttpTransfer::stop(End end, const char *words)
{
    if (!mStopped.words.isEmpty())
        return;
    mStopped.end = end;
    mStopped.words = errorText(words, {});
    mReply->abort();
}

bool HttpTransfer::run(LongWork &work)
{
    if (!work.waitFor(mReply.get(), &QNetworkReply::finished, [this] { mReply->abort(); }))
        return false;
    if (mStopped.words.isEmpty() && mReply->isOpen())
        takeBytes();
    return true;
}

// What a server has closed before the handshake was done has not been reached.
End HttpTransfer::endOfReply() const
{
    const auto error = mReply->error();
    const int status = mReply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    const bool secure = mReply->url().scheme() == "https"_L1;
    if (error == QNetworkReply::NoError ||
        (error > QNetworkReply::UnknownProxyError && status >= 400))
        return isCutOff() || status < 200 ? End::Failed : End::Answered;
    if (error == QNetworkReply::ConnectionRefusedError)
        return End::NotConnected;
    if (error == QNetworkReply::ProxyAuthenticationRequiredError)
        return End::ProxyRefused;
    if (error == QNetworkReply::RemoteHostClosedError && secure && !mEncrypted)
        return End::NotReached;
    const bool begun = status > 0 || error == QNetworkReply::RemoteHostClosedError ||
                       error > QNetworkReply::UnknownProxyError;
    return begun ? End::Failed : End::NotReached;
}

// A body that was decompressed comes without the length of what was sent.
bool HttpTransfer::isCutOff() const
{
    bool told = false;
    const qint64 length = mReply->rawHeader("Content-Length").toLongLong(&told);
    return told && !mReply->hasRawHeader("Content-Encoding") && mBody.size() < length;
}

HttpAnswer HttpTransfer::answer() const
{
    if (!mStopped.words.isEmpty())
        return mStopped;
    HttpAnswer answer;
    answer.end = endOfReply();
    answer.status = mReply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    answer.type = mReply->rawHeader("Content-Type").trimmed().toLower();
    answer.location = mReply->rawHeader("Location");
    answer.retryAfter = qMax(0, mReply->rawHeader("Retry-After").toInt());
    if (answer.end == End::Answered) {
        answer.body = mBody;
        answer.words =
            mReply->attribute(QNetworkRequest::HttpReasonPhraseAttribute).toString().left(200);
    } else {
        answer.words = mReply->error() == QNetworkReply::NoError ? errorText("xServiceCutOff", {})
                                                                 : mReply->errorString();
    }
    return answer;
}
