#pragma once

#include <QTcpServer>
#include <QTcpSocket>

/// A proxy on the loopback, for plain requests and for tunnels, that lets nobody through who does
/// not give its name and password.
class StandInProxy : public QTcpServer
{
    Q_OBJECT

public:
    StandInProxy(const QByteArray &user, const QByteArray &password);

    int passed = 0;  // requests that it let through
    int refused = 0; // those that came without name and password, or with wrong ones

protected:
    void incomingConnection(qintptr handle) override;

private:
    void read(QTcpSocket *client, QByteArray &soFar);
    void pass(QTcpSocket *client, const QByteArray &head, const QByteArray &rest);

    QByteArray mExpected; // the header; empty: no password
};
