#pragma once

#include <QHostAddress>
#include <QSslSocket>
#include <QTcpServer>

/// Stands in for a server of the network: a real one, on the loopback, that answers each request
/// with what was laid down for it. Plain or with TLS, for which it has a certificate of its own.
///
///     StandInServer server;
///     server.answer("cddb query", "202 No match\r\n");
///     options.cddbAddress = server.address();
class StandInServer : public QTcpServer
{
    Q_OBJECT

public:
    enum class Tls { None, Own };
    explicit StandInServer(Tls tls = Tls::None);

    struct Answer {
        QByteArray body = {};
        int status = 200;
        QByteArrayList headers = {}; // "Location: /elsewhere"
        bool chunked = false;
        bool withoutLength = false;
        qsizetype cutAt = -1; // bytes of the whole, header included, behind which it hangs up
        bool silent = false;  // from there on (or from the start) it says nothing and stays
        bool endless = false; // the body comes again and again
    };

    struct Request {
        QByteArray method;
        QByteArray target; // as it came
        QByteArray words;  // the same without escapes, + as a blank
        QByteArray head;   // request line and headers
        QByteArray body;
        QByteArray header(const QByteArray &name) const; // its value, as it came
    };

    /// For requests whose words contain `part`, and of several that fit the one that was laid down
    /// first. More than one for the same part are given one after the other, the last one for ever.
    /// What nothing was laid down for is answered with 404.
    void answer(const QByteArray &part, const Answer &answer);
    void answer(const QByteArray &part, const QByteArray &body)
    {
        this->answer(part, Answer{body});
    }

    QList<Request> requests;
    QByteArrayList words() const; // of all requests

    QString address(const QString &host = QStringLiteral("127.0.0.1")) const; // with scheme
    static QByteArray certificate();                                          // PEM, for 127.0.0.1

signals:
    void asked();

protected:
    void incomingConnection(qintptr handle) override;

private:
    struct Laid {
        QByteArray part;
        QList<Answer> answers;
    };
    void read(QSslSocket *socket, QByteArray &soFar);
    Answer next(const Request &request);
    void give(QSslSocket *socket, const Answer &answer);

    Tls mTls;
    QList<Laid> mLaid;
};
