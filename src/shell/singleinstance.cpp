#include "shell/singleinstance.h"

#include "platform/desktop/desktop.h"

#include <QCryptographicHash>
#include <QDir>
#include <QFileInfo>
#include <QLocalSocket>

using namespace Qt::StringLiterals;

namespace
{

constexpr int answerWithin = 2000; // milliseconds
constexpr char raiseWord[] = "raise\n", raisedWord[] = "raised\n";

QString nameFor(const QString &folder)
{
    const QByteArray hash = QCryptographicHash::hash(QFileInfo(folder).absoluteFilePath().toUtf8(),
                                                     QCryptographicHash::Sha1);
    return u"songcase-"_s + QString::fromLatin1(hash.toHex().left(16));
}

} // namespace

SingleInstance::SingleInstance(const QString &programFolder) : mServerName(nameFor(programFolder))
{
    const QString beside = QFileInfo(Desktop::current().settingsFile()).absolutePath();
    QDir().mkpath(beside);
    mLockName = beside + QDir::separator() + mServerName + u".lock"_s;
}

SingleInstance::~SingleInstance()
{
    mServer.close();
}

SingleInstance::Outcome SingleInstance::take()
{
    const bool lockThere = QFileInfo::exists(mLockName);
    mLock = std::make_unique<QLockFile>(mLockName);
    mLock->setStaleLockTime(0); // held as long as its process lives, however long that is
    if (!mLock->tryLock(0)) {
        // A folder that cannot be written holds no locks: the catalogue itself will tell.
        if (mLock->error() != QLockFile::LockFailedError)
            return Outcome::First;
        return raiseTheFirst() ? Outcome::Raised : Outcome::InUse;
    }
    mLastRunBroken = lockThere;
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
    return Outcome::First;
}

bool SingleInstance::raiseTheFirst() const
{
    QLocalSocket first;
    first.connectToServer(mServerName);
    if (!first.waitForConnected(answerWithin))
        return false;
    first.write(raiseWord);
    return first.waitForBytesWritten(answerWithin) && first.waitForReadyRead(answerWithin);
}
