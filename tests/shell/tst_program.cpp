// Label: journey
#include "catalogue/cataloguefile.h"
#include "support/testcatalogue.h"

#include <QProcess>
#include <QTest>

/// The real program, seen from outside.
class tst_program : public QObject
{
    Q_OBJECT

private slots:
    void answersWithoutADisplay()
    {
        for (const QString &question : {u"--version"_s, u"--help"_s}) {
            QProcess program;
            auto environment = QProcessEnvironment::systemEnvironment();
            environment.insert(u"QT_QPA_PLATFORM"_s, u"no such"_s);
            program.setProcessEnvironment(environment);
            program.start(qEnvironmentVariable("SONGCASE_BIN") + u"/bin/songcase"_s, {question});
            QVERIFY(program.waitForFinished());
            QCOMPARE(program.exitCode(), 0);
            QVERIFY(program.readAllStandardOutput().contains("songcase"));
        }
    }

    // A file that must not grow is an error like a full disk: told, and survived.
    void aLimitOfFileSizesKillsNobody()
    {
        const QTemporaryDir folder;
        cataloguefile::create(folder.filePath(u"Compact4.orv"_s));
        QProcess program;
        auto environment = QProcessEnvironment::systemEnvironment();
        environment.insert(u"SONGCASE_FOLDER"_s, folder.path());
        environment.insert(u"XDG_CONFIG_HOME"_s, folder.path());
        program.setProcessEnvironment(environment);
        const QString songcase = qEnvironmentVariable("SONGCASE_BIN") + u"/bin/songcase"_s;
        program.start(u"sh"_s, {u"-c"_s, u"ulimit -f 0; exec \"$0\""_s, songcase});
        QVERIFY(program.waitForStarted());
        // The lock of the settings is there: their first write is near.
        const QString lock = folder.filePath(u"songcase/settings.json.lock"_s);
        QTRY_VERIFY_WITH_TIMEOUT(QFile::exists(lock), 20000);
        program.terminate();
        QVERIFY(program.waitForFinished());
        QCOMPARE(program.exitStatus(), QProcess::NormalExit);
        QVERIFY(!QFile::exists(folder.filePath(u"songcase/settings.json"_s)));
    }
};

QTEST_GUILESS_MAIN(tst_program)
#include "tst_program.moc"
