#include "shell/program.h"

#include "platform/desktop/qtdesktop.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/MainScreen.h"
#include "shell/application.h"
#include "shell/endofprogram.h"
#include "shell/endsignals.h"
#include "shell/frmSplash.h"
#include "shell/singleinstance.h"
#include "shell/startup.h"

#include <QCommandLineParser>
#include <csignal>

using namespace Qt::StringLiterals;

namespace
{

void sayInUse()
{
    defaultInstance<frmSplash>().Unload();
    errorBox(GetMessage("xInUse"), GetMessage("MainScreen.Caption"));
}

// A file that must not grow, or a reader that has gone, is an error of the write and no reason to
// die. Handled rather than ignored, which programs that are started from here would inherit.
void outliveWrites()
{
    for (const int number : {SIGXFSZ, SIGPIPE})
        std::signal(number, [](int) {});
}

// What can be asked of the program without a display. All other words are the toolkit's.
void answerQuestions(int argc, char **argv)
{
    const QStringList questions{u"--version"_s, u"-v"_s, u"--help"_s, u"-h"_s};
    if (argc != 2 || !questions.contains(QString::fromLocal8Bit(argv[1])))
        return;
    const QCoreApplication application(argc, argv);
    QCommandLineParser options;
    options.setApplicationDescription(
        u"The catalogue of a private music collection. It is started without options; the "
        "catalogue lies in $SONGCASE_FOLDER, beside the program, or in your data folder."_s);
    options.addVersionOption();
    options.addHelpOption();
    options.process(application); // which ends
}

} // namespace

int runProgram(int argc, char **argv)
{
    outliveWrites();
    nameApplication();
    answerQuestions(argc, argv);
    Application application(argc, argv);
    QtDesktop desktop;
    Desktop::setCurrent(&desktop);
    application.setQuitOnLastWindowClosed(false);

    // Before any setting is written. The lock waits for the disk, so the splash comes first; a
    // program that runs already is asked before that.
    SingleInstance instance(desktop.programFolder());
    if (instance.raiseTheFirst())
        return 0;
    gLanguage = startup::storedLanguage();
    defaultInstance<frmSplash>().Show();
    defaultInstance<frmSplash>().waitUntilPainted();
    const auto outcome = instance.take();
    if (outcome == SingleInstance::Outcome::Raised)
        return 0;
    if (outcome == SingleInstance::Outcome::InUse) {
        sayInUse();
        return 1;
    }

    MainScreen mainScreen(instance.lastRunBroken());
    QObject::connect(&mainScreen, &MainScreen::unloaded, &application, &QCoreApplication::quit,
                     Qt::QueuedConnection);
    QObject::connect(&instance, &SingleInstance::raiseRequested, &mainScreen,
                     &MainScreen::bringToFront);
    QObject::connect(&mainScreen, &MainScreen::languageKnown, &application,
                     &Application::translateQt);
    EndSignals endSignals;
    EndOfProgram end(mainScreen);
    QObject::connect(&endSignals, &EndSignals::endRequested, &end, &EndOfProgram::request);
    QObject::connect(&application, &QGuiApplication::commitDataRequest, &end,
                     &EndOfProgram::request);
    if (!mainScreen.Load())
        return 1;
    return application.exec();
}
