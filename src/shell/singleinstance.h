#pragma once

#include "catalogue/cataloguelock.h"

#include <QLocalServer>
#include <QObject>

/// One running program per catalogue. The first holds the lock of the file and listens; a later one
/// asks the first to come to the front, and ends. The lock decides: the first listens where only
/// its own user can, so another user is told that the catalogue is in use.
class SingleInstance : public QObject
{
    Q_OBJECT

public:
    explicit SingleInstance(const QString &programFolder);
    ~SingleInstance() override;

    /// Whether a first one is there, and has come to the front. Quick when there is none.
    bool raiseTheFirst() const;

    enum class Outcome { First, Raised, InUse };
    Outcome take();

    /// Whether the run before this one on the same catalogue did not get to its end.
    bool lastRunBroken() const { return mLock.lastRunBroken(); }

    /// Where the first one listens.
    QString serverName() const { return mServerName; }

signals:
    void raiseRequested();

private:
    void listen();

    QString mCatalogue;
    QString mServerName;
    CatalogueLock mLock;
    QLocalServer mServer;
};
