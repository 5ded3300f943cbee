#include "platform/desktop/openaddress.h"

#include <QDesktopServices>
#include <QElapsedTimer>
#include <QProcess>
#include <QUrl>
#include <unistd.h>

using namespace Qt::StringLiterals;

namespace
{

constexpr qint64 searchAtMost = 10000; // milliseconds; what ends later was a browser

// Without an owner: the end of the object would be the end of a browser that runs in it.
QProcess *makeOpener()
{
    auto *opener = new QProcess;
    opener->setStandardInputFile(QProcess::nullDevice());
    opener->setStandardOutputFile(QProcess::nullDevice());
    opener->setStandardErrorFile(QProcess::nullDevice());
    opener->setChildProcessModifier([] { ::setsid(); });
    return opener;
}

} // namespace

void openInBrowser(const QString &url, const std::function<void()> &notOpened)
{
    QProcess *opener = makeOpener();
    QElapsedTimer since;
    since.start();
    QObject::connect(opener, &QProcess::finished, opener, [=](int code, auto status) {
        opener->deleteLater();
        const bool failed = code != 0 || status == QProcess::CrashExit;
        if (failed && since.elapsed() < searchAtMost)
            notOpened();
    });
    QObject::connect(opener, &QProcess::errorOccurred, opener, [=](QProcess::ProcessError error) {
        if (error != QProcess::FailedToStart)
            return;
        opener->deleteLater();
        if (!QDesktopServices::openUrl(QUrl(url)))
            notOpened();
    });
    opener->start(u"xdg-open"_s, {url});
}
