#pragma once

#include <QProcess>
#include <QTimer>
#include <optional>

class LongWork;

/// A small program of ours that reads what cannot be trusted: damaged files, drives, foreign
/// images. It is a process of its own with limits, may write no file, and talks in lines on its
/// standard output. It ends with this object, at the latest.
class HelperProgram : public QObject
{
    Q_OBJECT

public:
    struct Limits {
        qint64 memory = qint64(512) << 20; // bytes, of addresses
        qint64 output = qint64(256) << 20; // bytes
        int silence = 60;                  // seconds without a line
        int work = 600;                    // seconds of the processor
    };

    /// Where a program of ours is: from the place of this one, so that both can be moved.
    static QString placeOf(const QString &name);

    HelperProgram(LongWork &work, const QString &program, const QStringList &arguments,
                  const Limits &limits);
    ~HelperProgram() override;

    /// The next line without its end; nothing when it has ended, however that came about.
    std::optional<QByteArray> line();

    enum class End { Whole, Failed, Crashed, NotStarted, TooSlow, TooMuch, Cancelled };
    End end() const { return mEnd; } // once line() has given nothing
    int exitCode() const { return mProcess.exitCode(); }
    QByteArray errors() { return mProcess.readAllStandardError(); }

signals:
    void came(); // something: a line, the end, or too long nothing

private:
    void stop(End end);
    void finish();
    bool awaitMore();

    LongWork &mWork;
    const Limits mLimits;
    QProcess mProcess;
    QTimer mSilence;
    qint64 mRead = 0;
    End mEnd = End::Whole;
    bool mEnded = false;
};
