// Label: unit
#include "platform/desktop/programfolder.h"
#include "support/datarows.h"

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
        // catalogue: beside the executable; told: $SONGCASE_FOLDER
        const DataRows<QString, QString, QString> row("catalogue", "told", "found");
        row("installed", "", "", "data/songcase");
        row("portable", "bin/Compact4.orv", "", "bin");
        row("portable, of an older generation", "bin/Compact3.orv", "", "bin");
        row("a catalogue above it", "Compact4.orv", "", "data/songcase");
        row("told, and portable", "bin/Compact4.orv", "mine", "mine");
    }

    void find()
    {
        QFETCH(const QString, catalogue);
        QFETCH(const QString, told);
        QFETCH(const QString, found);
        const QTemporaryDir folder;
        const QString root = QFileInfo(folder.path()).canonicalFilePath() + u'/';
        QVERIFY(QDir(root).mkpath(u"bin"_s));
        const QString program = root + u"bin/program"_s;
        QVERIFY(QFile::copy(QCoreApplication::applicationFilePath(), program));
        if (!catalogue.isEmpty())
            QVERIFY(QFile(root + catalogue).open(QIODevice::WriteOnly));

        QProcess run;
        auto environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"XDG_DATA_HOME"_s, root + u"data"_s);
        environment.insert(u"SONGCASE_FOLDER"_s, told.isEmpty() ? QString() : QString(root + told));
        run.setProcessEnvironment(environment);
        run.start(program, {u"tell"_s});
        QVERIFY(run.waitForFinished());
        QCOMPARE(QString::fromUtf8(run.readAllStandardOutput()), QString(root + found));
    }
};

int main(int argc, char **argv)
{
    QCoreApplication application(argc, argv);
    QCoreApplication::setApplicationName(u"songcase"_s);
    if (application.arguments().value(1) == "tell"_L1) {
        QTextStream(stdout) << programfolder::find();
        return 0;
    }
    tst_ProgramFolder test;
    return QTest::qExec(&test, argc, argv);
}

#include "tst_ProgramFolder.moc"
