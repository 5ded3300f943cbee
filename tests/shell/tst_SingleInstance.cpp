// Label: unit
#include "catalogue/cataloguefile.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "shell/singleinstance.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QLocalSocket>
#include <QSignalSpy>
#include <QTest>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

using Outcome = SingleInstance::Outcome;

/// One running program per catalogue.
class tst_SingleInstance : public QObject
{
    Q_OBJECT

private:
    QString path(const char *name) const { return mDesktop->folder + u'/' + QLatin1String(name); }
    QString catalogue() const { return path("Compact4.orv"); }

    std::unique_ptr<ScriptedDesktop> mDesktop;

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        cataloguefile::create(catalogue());
    }
    void cleanup() { mDesktop.reset(); }

    // To the first it is the same catalogue, whatever the second one calls it.
    void aSecondStartBringsTheFirstUp_data()
    {
        const DataRows<QString> row("road");
        row("the same", "");
        row("a linked folder", "folder");
        row("a linked file", "file");
    }

    void aSecondStartBringsTheFirstUp()
    {
        QFETCH(QString, road);
        QString other = mDesktop->folder;
        if (road == "folder"_L1)
            QVERIFY(QFile::link(mDesktop->folder, other = path("linked")));
        if (road == "file"_L1) {
            QVERIFY(QDir().mkpath(other = path("folder")));
            QVERIFY(QFile::link(catalogue(), other + u"/Compact4.orv"_s));
        }
        {
            SingleInstance first(mDesktop->folder);
            QCOMPARE(first.take(), Outcome::First);
            QSignalSpy raised(&first, &SingleInstance::raiseRequested);
            std::atomic<int> outcome = -1;
            std::thread second([&] { outcome = int(SingleInstance(other).take()); });
            const bool answered = QTest::qWaitFor([&] { return outcome >= 0; });
            second.join();
            QVERIFY(answered);
            QCOMPARE(Outcome(outcome.load()), Outcome::Raised);
            QCOMPARE(raised.count(), 1);
        }
        SingleInstance next(other);
        QCOMPARE(next.take(), Outcome::First);
        QVERIFY(!next.lastRunBroken());
    }

    // The lock is the kernel's and on the file: no second name of the file leads past it, and what
    // the engine locks, opens and closes meanwhile does not drop it.
    void theLockBelongsToTheFile()
    {
        SingleInstance first(mDesktop->folder);
        QCOMPARE(first.take(), Outcome::First);
        openConnection(catalogue());
        gConnection->Execute(u"insert into artiesten values (1,'x')"_s);
        gConnection->Close();
        QVERIFY(QDir().mkpath(path("hard")));
        const QString second = path("hard/Compact4.orv");
        QCOMPARE(::link(QFile::encodeName(catalogue()).constData(),
                        QFile::encodeName(second).constData()),
                 0);
        QCOMPARE(SingleInstance(path("hard")).take(), Outcome::InUse);
    }

    // Its program was killed; what it has left behind locks nobody out and tells of it.
    void aRunThatDidNotEndIsNoticed_data()
    {
        const DataRows<QByteArray> row("left");
        row("as it was left", "");
        row("zeros", QByteArray(64, 0));
        row("of another machine", "1\nsongcase\nrenamed\n");
    }

    void aRunThatDidNotEndIsNoticed()
    {
        QFETCH(QByteArray, left);
        const pid_t child = fork();
        QVERIFY(child >= 0);
        if (child == 0) {
            const bool first = SingleInstance(mDesktop->folder).take() == Outcome::First;
            auto *killed = new SingleInstance(mDesktop->folder);
            _exit(first && killed->take() == Outcome::First ? 0 : 1);
        }
        int status = -1;
        QCOMPARE(waitpid(child, &status, 0), child);
        QCOMPARE(status, 0);
        const auto marks = QDir(mDesktop->folder).entryInfoList({u"*.running"_s});
        QCOMPARE(marks.size(), 1);
        writeFile(marks.first().filePath(), left);
        {
            SingleInstance next(mDesktop->folder);
            QCOMPARE(next.take(), Outcome::First);
            QVERIFY(next.lastRunBroken());
        }
        QCOMPARE(QDir(mDesktop->folder).entryList(QDir::Files), texts("Compact4.orv"));
    }

    void aFirstThatDoesNotAnswer()
    {
        SingleInstance first(mDesktop->folder);
        QCOMPARE(first.take(), Outcome::First);
        // Nothing handles events here, so the first is as good as hung.
        QCOMPARE(SingleInstance(mDesktop->folder).take(), Outcome::InUse);
    }

    // Who listens under our name without being us must not end a start in silence.
    void aForeignListener_data()
    {
        const DataRows<QByteArray> row("says");
        row("our word, as another user", "raised\n");
        row("something else", "hello\n");
    }

    void aForeignListener()
    {
        QFETCH(QByteArray, says);
        const bool otherUser = says == "raised\n";
        if (otherUser && geteuid() != 0)
            QSKIP("only the super-user can be two users");
        // A system without folders of one's own: all meet in one place.
        qputenv("XDG_RUNTIME_DIR", QFile::encodeName(catalogue()));
        qputenv("TMPDIR", QFile::encodeName(mDesktop->folder));
        QFile::setPermissions(mDesktop->folder, QFile::Permissions(0x7755));
        SingleInstance probe(mDesktop->folder);
        QLocalServer foreign;
        connect(&foreign, &QLocalServer::newConnection, &foreign, [&] {
            auto *caller = foreign.nextPendingConnection();
            connect(caller, &QIODevice::readyRead, caller, [=] {
                caller->write(says);
                caller->flush();
            });
        });
        foreign.setSocketOptions(QLocalServer::WorldAccessOption);
        foreign.listen(probe.serverName());
        QVERIFY2(foreign.isListening(), qPrintable(foreign.errorString()));
        std::atomic<int> raised = -1;
        std::thread start([&] {
            if (otherUser && syscall(SYS_setresuid, -1, 65534, -1) != 0) // of this thread alone
                raised = 2;
            else
                raised = int(probe.raiseTheFirst());
        });
        const bool answered = QTest::qWaitFor([&] { return raised >= 0; });
        start.join();
        QVERIFY(answered);
        QCOMPARE(raised.load(), 0);
        QVERIFY(foreign.serverName().startsWith(mDesktop->folder));
    }
};

QTEST_MAIN(tst_SingleInstance)
#include "tst_SingleInstance.moc"
