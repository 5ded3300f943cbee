#include "shell/application.h"

#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QLibraryInfo>
#include <QTranslator>

using namespace Qt::StringLiterals;

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
    } catch (const Error &error) {
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
    if (translator->load(u"qtbase_nl"_s, QLibraryInfo::path(QLibraryInfo::TranslationsPath)))
        installTranslator(translator);
}

void nameApplication()
{
    QCoreApplication::setApplicationName(u"songcase"_s);
    QCoreApplication::setApplicationVersion(u"" SONGCASE_VERSION ""_s);
    QGuiApplication::setDesktopFileName(u"songcase"_s);
}
