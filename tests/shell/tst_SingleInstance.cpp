// Label: unit
#include "shell/singleinstance.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QSignalSpy>
#include <QTest>
#include <thread>

using Outcome = SingleInstance::Outcome;

/// One running program per catalogue.
class tst_SingleInstance : public QObject
{
    Q_OBJECT

private:
    QString lockFile() const
    {
        const QDir folder = QFileInfo(mDesktop->settings).dir();
        return folder.filePath(folder.entryList({u"songcase-*.lock"_s}).value(0));
    }

    std::unique_ptr<ScriptedDesktop> mDesktop;

private slots:
    void init() { mDesktop = std::make_unique<ScriptedDesktop>(); }
    void cleanup() { mDesktop.reset(); }

    void aSecondStartBringsTheFirstUp()
    {
        {
            SingleInstance first(mDesktop->folder);
            QCOMPARE(first.take(), Outcome::First);
            QSignalSpy raised(&first, &SingleInstance::raiseRequested);
            std::atomic<int> outcome = -1;
            std::thread second([&] { outcome = int(SingleInstance(mDesktop->folder).take()); });
            const bool answered = QTest::qWaitFor([&] { return outcome >= 0; });
            second.join();
            QVERIFY(answered);
            QCOMPARE(Outcome(outcome.load()), Outcome::Raised);
            QCOMPARE(raised.count(), 1);
        }
        SingleInstance next(mDesktop->folder);
        QCOMPARE(next.take(), Outcome::First);
        QVERIFY(!next.lastRunBroken());
    }

    void aRunThatDidNotEndIsNoticed()
    {
        QString lock;
        {
            SingleInstance first(mDesktop->folder);
            QCOMPARE(first.take(), Outcome::First);
            lock = lockFile();
        }
        writeFile(lock, "999999999\nsongcase\n" + QSysInfo::machineHostName().toUtf8() + "\n");
        SingleInstance next(mDesktop->folder);
        QCOMPARE(next.take(), Outcome::First);
        QVERIFY(next.lastRunBroken());
    }

    void aFirstThatDoesNotAnswer()
    {
        SingleInstance first(mDesktop->folder);
        QCOMPARE(first.take(), Outcome::First);
        // Nothing handles events here, so the first is as good as hung.
        QCOMPARE(SingleInstance(mDesktop->folder).take(), Outcome::InUse);
    }
};

QTEST_MAIN(tst_SingleInstance)
#include "tst_SingleInstance.moc"
