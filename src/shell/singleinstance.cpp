#include "shell/singleinstance.h"

#include "platform/desktop/programfolder.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFileInfo>
#include <QLocalSocket>
#include <QStandardPaths>
#include <sys/socket.h>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

constexpr int answerWithin = 2000; // milliseconds
constexpr char raiseWord[] = "raise\n", raisedWord[] = "raised\n";

// One name whatever road leads there; of a file that a first start has still to make, too.
QString realPath(const QString &path)
{
    const QFileInfo info(path);
    if (info.exists() || info.isRoot())
        return info.canonicalFilePath();
    return realPath(info.absolutePath()) + u'/' + info.fileName();
}

// In the folder that the system gives to this user alone for such things, if it has one.
QString serverFor(const QString &catalogue)
{
    const QString own = QStandardPaths::writableLocation(QStandardPaths::RuntimeLocation);
    const QByteArray hash =
        QCryptographicHash::hash(realPath(catalogue).toUtf8(), QCryptographicHash::Sha1);
    return (own.isEmpty() ? QDir::tempPath() : own) + u"/songcase-"_s +
           QString::fromLatin1(hash.toHex().left(16));
}

// What another user has put there may say anything.
bool listensForThisUser(const QLocalSocket &socket)
{
    ucred other = {};
    socklen_t size = sizeof other;
    return ::getsockopt(int(socket.socketDescriptor()), SOL_SOCKET, SO_PEERCRED, &other, &size) ==
               0 &&
           other.uid == ::geteuid();
}

} // namespace

SingleInstance::SingleInstance(const QString &programFolder)
    : mCatalogue(programfolder::catalogueIn(programFolder)), mServerName(serverFor(mCatalogue))
{
}

SingleInstance::~SingleInstance()
{
    mServer.close();
}

SingleInstance::Outcome SingleInstance::take()
{
    const auto outcome = mLock.take(mCatalogue);
    if (outcome == FileLock::Outcome::Held)
        return raiseTheFirst() ? Outcome::Raised : Outcome::InUse;
    // A catalogue that is not there yet, or cannot be written, tells that itself.
    if (outcome == FileLock::Outcome::Taken)
        mLock.markRunning(mCatalogue);
    listen();
    return Outcome::First;
}

void SingleInstance::listen()
{
    connect(&mServer, &QLocalServer::newConnection, this, [this] {
        QLocalSocket *caller = mServer.nextPendingConnection();
        connect(caller, &QLocalSocket::disconnected, caller, &QObject::deleteLater);
        connect(caller, &QLocalSocket::readyRead, this, [this, caller] {
            caller->write(raisedWord);
            caller->flush();
            emit raiseRequested();
        });
    });
    QLocalServer::removeServer(mServerName); // of a run that did not get to its end
    mServer.setSocketOptions(QLocalServer::UserAccessOption);
    mServer.listen(mServerName);
}

bool SingleInstance::raiseTheFirst() const
{
    QLocalSocket first;
    first.connectToServer(mServerName);
    if (!first.waitForConnected(answerWithin) || !listensForThisUser(first))
        return false;
    first.write(raiseWord);
    return first.waitForBytesWritten(answerWithin) && first.waitForReadyRead(answerWithin) &&
           first.readAll() == raisedWord;
}
