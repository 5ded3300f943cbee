#pragma once

#include <QObject>

class QSocketNotifier;

/// Turns SIGTERM, SIGINT and SIGHUP (the end of a session) into a signal of the event loop, so that
/// the program can end in an orderly way.
class EndSignals : public QObject
{
    Q_OBJECT

public:
    EndSignals();
    ~EndSignals() override;

signals:
    void endRequested();

private:
    QSocketNotifier *mNotifier = nullptr;
};
