#pragma once

#include <QObject>
#include <QPointer>
#include <QTimer>

class MainScreen;
class QWidget;

/// Brings the program to its end when the system asks for it (a logout, SIGTERM), whatever it is
/// doing. What stands open then is refused, what runs is cancelled, and once no routine waits any
/// more the frame closes as by hand: screens may ask, and a person has a few seconds for each
/// answer. After that, or when a screen refuses, it ends all the same.
class EndOfProgram : public QObject
{
    Q_OBJECT

public:
    explicit EndOfProgram(MainScreen &frame);

    void request();

private:
    void step();
    void close();
    void refuseWhatStandsOpen();

    MainScreen &mFrame;
    QTimer mStep;
    QPointer<QWidget> mOpen; // the box or modal screen on top
    int mOpenFor = 0;        // milliseconds
    bool mAsking = false;    // the frame was closed: what opens now is for a person to answer
};
