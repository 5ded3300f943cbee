#pragma once

#include "discdata/founddisc.h"

class Form;
class LongWork;

/// The control of a screen that opens a disc: in a drive, or as an image, a sheet or a folder of
/// sound files. While it opens the screen is busy, the program paints, and the user can cancel; so
/// "Open" belongs into a command that has asked LongWork::mayBegin.
class MMControl
{
public:
    explicit MMControl(Form &screen);
    ~MMControl(); // closes
    MMControl(const MMControl &) = delete;
    MMControl &operator=(const MMControl &) = delete;

    QString DeviceType;
    QString FileName;  // "0": no drive at all
    SearchWords Words; // where no disc is at hand, in the place of FileName
    bool Notify = false, Wait = false, Shareable = false; // taken, and nothing hangs on them

    /// "Open" reads the disc that FileName tells, "Close" forgets it.
    void Command(const QString &what);

    int DeviceID() const { return mDevice; }     // 0: not open
    int Tracks() const { return mFound.tracks; } // 0: no audio disc, for whatever reason

    /// Why there are no tracks, as a sentence for the user; empty where there is no more to say
    /// than that there is no audio CD.
    QString problem() const;

    /// Whether the user had enough of waiting.
    bool wasCancelled() const { return mFound.cancelled; }

    /// The program that reads drives and images, and how long it may be silent.
    QString reader;
    int patience = 60; // seconds

private:
    void open();
    void close();
    FoundDisc read(LongWork &work) const;

    Form &mScreen;
    FoundDisc mFound;
    int mDevice = 0;
};

/// What was read from an open device. Empty, so that it is no table, from one that is closed.
OpaqueToc tocOfDevice(int deviceId);
