#include "platform/work/helperprogram.h"

#include "platform/work/longwork.h"

#include <QCoreApplication>
#include <QDir>
#include <sys/resource.h>

using namespace Qt::StringLiterals;

namespace
{

// Runs in the child: only what may be called between fork and exec.
void limit(int what, qint64 to)
{
    const rlimit both{rlim_t(to), rlim_t(to)};
    setrlimit(__rlimit_resource(what), &both);
}

} // namespace

QString HelperProgram::placeOf(const QString &name)
{
    return QDir::cleanPath(QCoreApplication::applicationDirPath() + u"/../libexec/songcase/"_s +
                           name);
}

HelperProgram::HelperProgram(LongWork &work, const QString &program, const QStringList &arguments,
                             const Limits &limits)
    : mWork(work), mLimits(limits)
{
    mProcess.setChildProcessModifier([limits] {
        limit(RLIMIT_AS, limits.memory);
        limit(RLIMIT_CPU, limits.work);
        limit(RLIMIT_FSIZE, 0);
        limit(RLIMIT_CORE, 0);
    });
    mSilence.setSingleShot(true);
    mSilence.setInterval(limits.silence * 1000);
    connect(&mProcess, &QProcess::readyReadStandardOutput, this, &HelperProgram::came);
    connect(&mProcess, &QProcess::finished, this, &HelperProgram::came);
    connect(&mProcess, &QProcess::errorOccurred, this, &HelperProgram::came);
    connect(&mSilence, &QTimer::timeout, this, &HelperProgram::came);
    mProcess.setStandardInputFile(QProcess::nullDevice());
    mProcess.start(program, arguments, QIODevice::ReadOnly);
}

HelperProgram::~HelperProgram()
{
    mProcess.kill();
    mProcess.waitForFinished();
}

std::optional<QByteArray> HelperProgram::line()
{
    while (!mEnded && !mProcess.canReadLine()) {
        if (!awaitMore())
            return {};
    }
    if (mEnded && !mProcess.bytesAvailable())
        return {};
    QByteArray line = mProcess.readLine();
    mRead += line.size();
    if (mRead > mLimits.output) {
        stop(End::TooMuch);
        return {};
    }
    if (line.endsWith('\n'))
        line.chop(1);
    return line;
}

// False: it ended, and nothing is left to read.
bool HelperProgram::awaitMore()
{
    if (mProcess.state() == QProcess::NotRunning) {
        finish();
        return mProcess.bytesAvailable() > 0;
    }
    if (mProcess.bytesAvailable() > mLimits.output) {
        stop(End::TooMuch);
        return false;
    }
    mSilence.start();
    if (!mWork.waitFor(this, &HelperProgram::came, [this] { stop(End::Cancelled); }))
        return false;
    if (mSilence.isActive())
        return true;
    stop(End::TooSlow);
    return false;
}

void HelperProgram::stop(End end)
{
    mEnded = true;
    mEnd = end;
    mProcess.kill();
    mProcess.waitForFinished();
    mProcess.readAll();
}

void HelperProgram::finish()
{
    mEnded = true;
    if (mProcess.error() == QProcess::FailedToStart)
        mEnd = End::NotStarted;
    else if (mProcess.exitStatus() == QProcess::CrashExit)
        mEnd = End::Crashed;
    else
        mEnd = mProcess.exitCode() == 0 ? End::Whole : End::Failed;
}
