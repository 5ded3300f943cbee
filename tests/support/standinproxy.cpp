#include "support/standinproxy.h"

#include <QHostAddress>
#include <QUrl>
#include <memory>

namespace
{

constexpr char refusal[] = "HTTP/1.1 407 Proxy Authentication Required\r\n"
                           "Proxy-Authenticate: Basic realm=\"stand-in\"\r\n"
                           "Content-Length: 0\r\nConnection: close\r\n\r\n";

void join(QTcpSocket *from, QTcpSocket *to)
{
    QObject::connect(from, &QTcpSocket::readyRead, to, [=] { to->write(from->readAll()); });
    QObject::connect(from, &QTcpSocket::disconnected, to, &QTcpSocket::disconnectFromHost);
    QObject::connect(from, &QTcpSocket::disconnected, from, &QObject::deleteLater);
}

// The proxy's own headers go no further, and the server gets a path.
QByteArray asForServer(const QByteArray &head, const QUrl &url)
{
    QByteArrayList lines = head.split('\n');
    const QByteArrayList first = lines[0].split(' ');
    lines[0] =
        first[0] + ' ' + url.toEncoded(QUrl::RemoveScheme | QUrl::RemoveAuthority) + " HTTP/1.1\r";
    lines.removeIf([](const QByteArray &line) { return line.toLower().startsWith("proxy-"); });
    return lines.join('\n') + "\r\n\r\n";
}

} // namespace

StandInProxy::StandInProxy(const QByteArray &user, const QByteArray &password)
{
    if (!user.isEmpty())
        mExpected = "Proxy-Authorization: Basic " + QByteArray(user + ':' + password).toBase64();
    listen(QHostAddress::LocalHost);
}

void StandInProxy::incomingConnection(qintptr handle)
{
    auto *client = new QTcpSocket(this);
    client->setSocketDescriptor(handle);
    connect(client, &QTcpSocket::disconnected, client, &QObject::deleteLater);
    connect(client, &QTcpSocket::readyRead, this,
            [=, this, soFar = std::make_shared<QByteArray>()] { read(client, *soFar); });
}

void StandInProxy::read(QTcpSocket *client, QByteArray &soFar)
{
    soFar += client->readAll();
    const qsizetype end = soFar.indexOf("\r\n\r\n");
    if (end < 0)
        return;
    const QByteArray head = soFar.left(end), rest = soFar.mid(end + 4);
    soFar.clear();
    if (mExpected.isEmpty() || head.contains(mExpected))
        return pass(client, head, rest);
    ++refused;
    client->write(refusal);
    client->disconnectFromHost();
}

void StandInProxy::pass(QTcpSocket *client, const QByteArray &head, const QByteArray &rest)
{
    ++passed;
    client->disconnect(this);
    const QByteArray method = head.left(head.indexOf(' '));
    const QByteArray target = head.split(' ').value(1);
    const bool tunnel = method == "CONNECT";
    const QUrl url = QUrl::fromEncoded(tunnel ? "tunnel://" + target : target);
    auto *server = new QTcpSocket(this);
    join(client, server);
    join(server, client);
    connect(server, &QTcpSocket::connected, client, [=] {
        if (tunnel)
            client->write("HTTP/1.1 200 Connected\r\n\r\n");
        else
            server->write(asForServer(head, url) + rest);
    });
    server->connectToHost(url.host(), quint16(url.port()));
}
