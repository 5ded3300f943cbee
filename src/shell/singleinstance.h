#pragma once

#include <QLocalServer>
#include <QLockFile>
#include <QObject>
#include <memory>

/// One running program per catalogue. The first holds a lock and listens; a later one asks the
/// first to come to the front, and ends.
class SingleInstance : public QObject
{
    Q_OBJECT

public:
    /// Lock and server are named after the folder of the catalogue and lie beside the settings.
    explicit SingleInstance(const QString &programFolder);
    ~SingleInstance() override;

    /// Whether a first one is there, and has come to the front. Quick when there is none.
    bool raiseTheFirst() const;

    enum class Outcome { First, Raised, InUse };
    Outcome take();

    /// Whether the run before this one on the same catalogue did not get to its end.
    bool lastRunBroken() const { return mLastRunBroken; }

signals:
    void raiseRequested();

private:
    QString mServerName;
    QString mLockName;
    std::unique_ptr<QLockFile> mLock;
    QLocalServer mServer;
    bool mLastRunBroken = false;
};
