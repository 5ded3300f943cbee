#pragma once

#include "discdata/httpclient.h"

#include <QTimer>
#include <memory>

/// One request on its way: collects the answer, and gives up where it gets too long or nothing
/// comes any more. Ends with this object, at the latest.
class HttpTransfer : public QObject
{
    Q_OBJECT

public:
    static constexpr qint64 longest = 4 << 20; // bytes of a body, decompressed

    HttpTransfer(QNetworkReply *reply, int silence);
    ~HttpTransfer() override;

    bool run(LongWork &work); // false: cancelled
    HttpAnswer answer() const;

private:
    void listenTo();
    void takeBytes();
    void stop(HttpAnswer::End end, const char *words);
    HttpAnswer::End endOfReply() const;
    bool isCutOff() const;

    std::unique_ptr<QNetworkReply> mReply;
    QTimer mSilence;
    QByteArray mBody;
    HttpAnswer mStopped; // with words: given up by this side
    bool mEncrypted = false;
};
