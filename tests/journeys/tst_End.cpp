// Label: journey
#include "catalogue/cataloguefile.h"
#include "discdata/DiscEditor.h"
#include "platform/ado/connection.h"
#include "shell/program.h"
#include "support/importfixture.h"
#include "support/journey.h"
#include "textimport/frmImportBusy.h"

#include <QAction>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QProcess>
#include <QProgressBar>
#include <QPushButton>
#include <QStatusBar>
#include <QToolButton>
#include <csignal>
#include <unistd.h>

namespace
{

// ---- The other process: the real program, with a hand that brings it into a state, and a signal.

template <typename Object = QWidget> Object *find(const char *screen, const char *name)
{
    for (QWidget *widget : QApplication::allWidgets()) {
        if (widget->objectName() == QLatin1String(screen))
            return widget->findChild<Object *>(QLatin1String(name));
    }
    return nullptr;
}

void press(const char *screen, const char *button)
{
    if (auto *found = find<QAbstractButton>(screen, button))
        found->click();
}

void choose(const char *entry)
{
    find<QAction>("MainScreen", entry)->trigger();
}

bool boxIsOpen()
{
    return QApplication::activeModalWidget();
}

bool progressed(const char *screen, const char *bar)
{
    const auto *found = find<QProgressBar>(screen, bar);
    return found && found->isVisible() && found->value() > 0;
}

QString outputFile()
{
    return qEnvironmentVariable("SONGCASE_FOLDER") + u"/output.file"_s;
}

void chooseOutput()
{
    if (auto *dialog = qobject_cast<QFileDialog *>(QApplication::activeModalWidget())) {
        dialog->selectFile(outputFile());
        QMetaObject::invokeMethod(dialog, "accept");
    }
}

struct State {
    const char *name;
    void (*enter)();
    bool (*isThere)();
};

void import()
{
    chooseImport('C', qEnvironmentVariable("SONGCASE_FOLDER") + u"/in.txt"_s);
    defaultInstance<frmImportBusy>().ShowModal();
}

// A modal screen that asks before it goes.
void editDisc()
{
    DiscRecord disc;
    disc.tracks.resize(1);
    auto *editor = new DiscEditor(disc, {}, {});
    editor->findChild<QLineEdit *>(u"txtTitle"_s)->setText(u"Typed"_s);
    editor->ShowModal();
}

void never() {}
bool always()
{
    return true;
}

const State states[] = {
    {"idle", never, always},
    {"box", [] { choose("mnuNederlands"); }, boxIsOpen},
    {"question", [] { press("frmCDList", "cmdDelete"); }, boxIsOpen},
    {"help", [] { choose("mnuHelp"); }, always},
    {"about", [] { choose("Over"); }, boxIsOpen},
    {"file dialog",
     [] {
         choose("Import");
         press("frmImportWizard", "cmdBrowse");
     },
     boxIsOpen},
    {"unsaved",
     [] {
         choose("mnuCDInsert");
         find<QLineEdit>("frmCDRoot", "txtTitel")->setText(u"Typed"_s);
     },
     always},
    {"disc edited", editDisc, [] { return find("DiscEditor", "txtTitle") != nullptr; }},
    {"reading", import, [] { return progressed("frmImportBusy", "ImportProgressBar"); }},
    {"load",
     [] {
         import();
         press("frmImport", "StartDBImport");
     },
     [] { return progressed("frmImportDBBusy", "DBImportProgressBar"); }},
    {"export",
     [] {
         choose("mnuSearchArtistsTitles");
         press("frmSearchArtistsTitles", "cmdSearch");
         press("frmSearchArtistsTitles", "cmdExport");
     },
     [] {
         chooseOutput();
         const auto *bar = find<QStatusBar>("frmSearchArtistsTitles", "StatusBar");
         const QString message = bar ? bar->currentMessage() : QString();
         return message.contains(u'%') || message.contains(outputFile()); // done already
     }},
    {"pdf",
     [] {
         press("frmCDList", "cmdStartReport");
         press("CompilationReport", "cmdPdf");
     },
     [] {
         chooseOutput();
         const auto *cancel = find<QPushButton>("CompilationReport", "cmdCancel");
         return cancel && cancel->text().contains(u"Cancel"_s);
     }},
};

constexpr int logout = 0; // no signal: the session manager's word
int gSignal = SIGTERM;
const State *gState = nullptr; // none: the splash

void askForTheEnd()
{
    if (gSignal != logout) {
        ::kill(::getpid(), gSignal);
        return;
    }
    char manager = 0; // nobody has a session manager, nor asks this one anything
    QMetaObject::invokeMethod(qApp, "commitDataRequest", Qt::DirectConnection,
                              QGenericArgument("QSessionManager&", &manager));
}

void act()
{
    auto *hand = new QTimer(qApp);
    QObject::connect(hand, &QTimer::timeout, qApp, [hand, entered = false]() mutable {
        auto *timer = find<QTimer>("MainScreen", "Timer1");
        if (!timer)
            return;
        timer->setInterval(gState ? 0 : 60000);
        const bool up = !gState || find("frmCDList", "cmdDelete");
        if (up && !std::exchange(entered, up) && gState)
            QTimer::singleShot(0, qApp, gState->enter);
        else if (entered && (!gState || gState->isThere())) {
            hand->stop();
            askForTheEnd();
        }
    });
    if (QCoreApplication::arguments().value(1) == "--state"_L1)
        hand->start(1);
}
Q_COREAPP_STARTUP_FUNCTION(act)

int otherProcess(int argc, char **argv)
{
    const QString wanted = QString::fromLocal8Bit(argv[2]);
    for (const State &state : states) {
        if (wanted == QLatin1String(state.name))
            gState = &state;
    }
    gSignal = std::atoi(argv[3]);
    return runProgram(argc, argv);
}

} // namespace

/// The system ends the program, whatever it is doing: it goes within seconds, with nothing
/// half-written.
class tst_End : public QObject
{
    Q_OBJECT

private:
    static constexpr int rows = 30000;

    static void fill(TestCatalogue &catalogue)
    {
        catalogue.exec(
            u"insert into Artiesten values (1,'Anna');"
            "with recursive n(i) as (select 1 union all select i+1 from n where i < %1) "
            "insert into Tracks select i, 1, 'Song '||i, null, null from n;"
            "insert into CDTitels select id, 'Disc '||id, null, 'V', null, null from Tracks;"
            "insert into CompactDiscs select id, id, 1, 1, id, null from Tracks"_s.arg(rows));
    }

private slots:
    void endsInEachState_data()
    {
        const DataRows<QByteArray, int> row("state", "signal");
        row("splash", SIGTERM);
        row("idle", SIGHUP);
        row("box", SIGTERM);
        row("question", SIGTERM);
        row("help", SIGINT);
        row("about", SIGTERM);
        row("file dialog", SIGTERM);
        row("unsaved", SIGTERM);
        row("disc edited", SIGTERM);
        row("reading", SIGTERM);
        row("load", SIGHUP);
        row("export", SIGTERM);
        row("pdf", SIGTERM);
        row("logout, box open", "box", logout);
        row("logout, typed", "unsaved", logout);
        row("logout in a load", "load", logout);
    }

    void endsInEachState()
    {
        QFETCH(QByteArray, state);
        QFETCH(int, signal);
        TestCatalogue catalogue;
        fill(catalogue);
        writeFile(catalogue.path("in.txt"), "x\n" + QByteArray("a*b**\n").repeated(100000));
        gConnection->Close();
        QProcess program;
        QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"SONGCASE_FOLDER"_s, QFileInfo(catalogue.file()).path());
        environment.insert(u"XDG_CONFIG_HOME"_s, catalogue.path("config"));
        environment.insert(u"XDG_DATA_HOME"_s, catalogue.path("data"));
        program.setProcessEnvironment(environment);
        program.setProcessChannelMode(QProcess::MergedChannels);
        program.start(QCoreApplication::applicationFilePath(),
                      {u"--state"_s, QString::fromLatin1(state), QString::number(signal)});
        QVERIFY(program.waitForStarted());
        const bool ended = program.waitForFinished(40000);
        const QByteArray said = program.readAll();
        program.kill();
        program.waitForFinished();
        QVERIFY2(ended, said);
        QCOMPARE(program.exitStatus(), QProcess::NormalExit);
        QCOMPARE(program.exitCode(), 0);
        openConnection(catalogue.file());
        cataloguefile::verify(*gConnection, true);
        QCOMPARE(catalogue.count("select count(*) from CompactDiscs"), rows);
        QCOMPARE(catalogue.count("select count(*) from CDTitels where Titel='Typed'"), 0);
        QCOMPARE(QFileInfo::exists(catalogue.path("Unsaved")), state == "unsaved"); // its copy
        // An output that was quicker than the signal is whole.
        const QByteArray output = readFile(catalogue.path("output.file"));
        QVERIFY(output == "none" || output.count('\n') == rows || output.endsWith("%%EOF\n"));
    }
};

int main(int argc, char **argv)
{
    if (argc == 4 && qstrcmp(argv[1], "--state") == 0)
        return otherProcess(argc, argv);
    QApplication application(argc, argv);
    tst_End test;
    return QTest::qExec(&test, argc, argv);
}

#include "tst_End.moc"
