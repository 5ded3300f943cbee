#include "shell/application.h"

#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"

#include <QLibraryInfo>
#include <QTranslator>

namespace
{

[[noreturn]] void endWithReport(const QString &text)
{
    errorBox(text, GetMessage("MsgSysErr"));
    gConnection.reset(); // rolls back
    // The objects of the screens are in the middle of their work: nothing of theirs may run any
    // more.
    std::_Exit(1);
}

} // namespace

bool Application::notify(QObject *receiver, QEvent *event)
{
    try {
        return QApplication::notify(receiver, event);
    } catch (const ADODB::Error &error) {
        endWithReport(error.numbered());
    } catch (const std::exception &error) {
        endWithReport(QString::fromUtf8(error.what()));
    }
}

void Application::translateQt()
{
    if (gLanguage != languageDutch)
        return;
    auto *translator = new QTranslator(this);
    if (translator->load(QStringLiteral("qtbase_nl"),
                         QLibraryInfo::path(QLibraryInfo::TranslationsPath)))
        installTranslator(translator);
}

void nameApplication()
{
    QCoreApplication::setApplicationName(QStringLiteral("songcase"));
    QCoreApplication::setApplicationVersion(QStringLiteral(SONGCASE_VERSION));
    QGuiApplication::setDesktopFileName(QStringLiteral("songcase"));
}
