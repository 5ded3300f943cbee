// Label: unit
#include "platform/desktop/programfolder.h"

#include <QProcess>
#include <QTemporaryDir>
#include <QtTest>

/// Where a program looks for its catalogue goes by where it lies itself, so each case runs a copy
/// of this test in a folder of its own, which only tells what it has found.
class tst_ProgramFolder : public QObject
{
    Q_OBJECT

private slots:
    void find_data()
    {
        QTest::addColumn<QString>("catalogue"); // beside the executable
        QTest::addColumn<QString>("told");      // $SONGCASE_FOLDER
        QTest::addColumn<QString>("found");
        QTest::newRow("installed") << ""
                                   << ""
                                   << "data/songcase";
        QTest::newRow("portable") << "bin/Compact4.orv"
                                  << ""
                                  << "bin";
        QTest::newRow("portable, of an older generation") << "bin/Compact3.orv"
                                                          << ""
                                                          << "bin";
        QTest::newRow("a catalogue above it") << "Compact4.orv"
                                              << ""
                                              << "data/songcase";
        QTest::newRow("told, and portable") << "bin/Compact4.orv"
                                            << "mine"
                                            << "mine";
    }

    void find()
    {
        QFETCH(const QString, catalogue);
        QFETCH(const QString, told);
        QFETCH(const QString, found);
        const QTemporaryDir folder;
        const QString root = QFileInfo(folder.path()).canonicalFilePath() + u'/';
        QVERIFY(QDir(root).mkpath(QStringLiteral("bin")));
        const QString program = root + QStringLiteral("bin/program");
        QVERIFY(QFile::copy(QCoreApplication::applicationFilePath(), program));
        if (!catalogue.isEmpty())
            QVERIFY(QFile(root + catalogue).open(QIODevice::WriteOnly));

        QProcess run;
        auto environment = QProcessEnvironment::systemEnvironment();
        environment.insert(QStringLiteral("XDG_DATA_HOME"), root + QStringLiteral("data"));
        environment.insert(QStringLiteral("SONGCASE_FOLDER"),
                           told.isEmpty() ? QString() : QString(root + told));
        run.setProcessEnvironment(environment);
        run.start(program, {QStringLiteral("tell")});
        QVERIFY(run.waitForFinished());
        QCOMPARE(QString::fromUtf8(run.readAllStandardOutput()), QString(root + found));
    }
};

int main(int argc, char **argv)
{
    QCoreApplication application(argc, argv);
    QCoreApplication::setApplicationName(QStringLiteral("songcase"));
    if (application.arguments().value(1) == QLatin1String("tell")) {
        QTextStream(stdout) << programfolder::find();
        return 0;
    }
    tst_ProgramFolder test;
    return QTest::qExec(&test, argc, argv);
}

#include "tst_ProgramFolder.moc"
