// Label: unit
#include "platform/error/error.h"
#include "platform/work/helperprogram.h"
#include "platform/work/longwork.h"
#include "platform/work/wait.h"
#include "services/messages.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"

#include <QApplication>
#include <QDeadlineTimer>
#include <QPushButton>
#include <QTcpServer>
#include <QTcpSocket>
#include <QThread>
#include <QTimer>
#include <atomic>

namespace
{

class Screen : public Form
{
public:
    Screen() : Form(u"frmWorking"_s) {}
};

QWidget *workWindow()
{
    const auto all = QApplication::topLevelWidgets();
    for (QWidget *w : all) {
        if (w->objectName() == "WorkWindow"_L1 && w->isVisible())
            return w;
    }
    return nullptr;
}

// Presses Cancel as soon as the window of the work has come.
void cancelByHand(QObject *context)
{
    auto *look = new QTimer(context);
    QObject::connect(look, &QTimer::timeout, context, [look] {
        if (QWidget *window = workWindow()) {
            look->stop();
            window->findChild<QPushButton *>()->click();
        }
    });
    look->start(5);
}

} // namespace

/// The one long work: who may begin one, what it shows, what it waits for, and how waits end.
class tst_LongWork : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Screen> mScreen, mOther;

    QByteArrayList linesOf(const char *script, HelperProgram::Limits limits,
                           HelperProgram::End &end)
    {
        LongWork work(*mScreen);
        HelperProgram helper(work, u"/bin/sh"_s, {u"-c"_s, QString::fromLatin1(script)}, limits);
        QByteArrayList lines;
        while (const auto line = helper.line())
            lines.append(*line);
        end = helper.end();
        return lines;
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mScreen = std::make_unique<Screen>();
        mOther = std::make_unique<Screen>();
    }

    void cleanup()
    {
        mDesktop->verifyAllCame();
        mScreen.reset();
        mOther.reset();
    }

    void oneAtATime()
    {
        QVERIFY(LongWork::mayBegin(*mScreen));
        {
            const LongWork work(*mScreen);
            QVERIFY(mScreen->isBusy() && !mOther->isBusy());
            QVERIFY(!mScreen->Unload());
            QVERIFY(!LongWork::mayBegin(*mScreen)); // in silence
            mDesktop->expectBox(GetMessage("xBusy"));
            QVERIFY(!LongWork::mayBegin(*mOther));
        }
        QVERIFY(LongWork::mayBegin(*mOther));
        const Form::Busy dialog(*mScreen);
        QVERIFY(!LongWork::mayBegin(*mScreen) && LongWork::mayBegin(*mOther));
    }

    void tellsEachPerCentOnce()
    {
        LongWork work(*mScreen);
        QList<int> shown;
        work.showPercent = [&](int percent) { shown.append(percent); };
        for (int i = 1; i <= 1000; ++i)
            QVERIFY(work.step(i, 1000));
        QCOMPARE(shown.size(), 101);
        QCOMPARE(shown.last(), 100);
        work.step(0, 0); // nothing to do is all done
        QCOMPARE(shown.size(), 101);
        work.cancel();
        QVERIFY(!work.step(1, 2));
    }

    void valuesFromAThread()
    {
        LongWork work(*mScreen);
        const auto here = QThread::currentThread();
        const auto other =
            work.valueOf<bool>([&](auto) { return QThread::currentThread() != here; });
        QVERIFY(other && *other);
        const auto fails = [](auto) -> int { throw Error(7, u"there"_s, u"no"_s); };
        QVERIFY_EXCEPTION_THROWN(work.valueOf<int>(fails), Error);
        QVERIFY(!workWindow());
    }

    // A thread that never comes to an end by itself.
    void cancelEndsAThread()
    {
        LongWork work(*mScreen, u"Reading"_s);
        cancelByHand(mScreen.get());
        const auto value = work.valueOf<int>([](const std::stop_token &stop) {
            while (!stop.stop_requested())
                QThread::yieldCurrentThread();
            return 1;
        });
        QVERIFY(!value && work.isCancelled() && !workWindow());
        QVERIFY(!work.valueOf<int>([](auto) { return 1; }));
    }

    void eachInItsOrder()
    {
        LongWork work(*mScreen);
        QList<qsizetype> taken;
        const auto square = [](qsizetype i, auto) {
            QThread::usleep(i % 7 == 0 ? 50 : 0);
            return i * i;
        };
        QVERIFY(work.eachOf<qsizetype>(1000, square, [&](qsizetype i, qsizetype &&value) {
            QCOMPARE(value, i * i);
            taken.append(i);
        }));
        QCOMPARE(taken.size(), 1000);
        QVERIFY(std::is_sorted(taken.begin(), taken.end()));
        const auto fails = [](qsizetype i, auto) {
            return i == 500 ? throw Error(7, u"there"_s, u"no"_s) : i;
        };
        QVERIFY_EXCEPTION_THROWN(work.eachOf<qsizetype>(1000, fails, [](auto, auto &&) {}), Error);
        QVERIFY(!workWindow());
    }

    // Of a dead medium nothing ever comes back.
    void cancelLeavesAThreadBehind()
    {
        const auto end = std::make_shared<std::atomic<bool>>(false);
        const auto hangs = [end](qsizetype i, auto) {
            while (i == 40 && !*end)
                QThread::yieldCurrentThread();
            return i;
        };
        LongWork work(*mScreen, u"Reading"_s);
        cancelByHand(mScreen.get());
        qsizetype taken = 0;
        QVERIFY(!work.eachOf<qsizetype>(100, hangs, [&](auto, auto &&) { ++taken; }));
        QCOMPARE(taken, 32);
        *end = true;
    }

    void stepsAreShownToo()
    {
        LongWork work(*mScreen, u"Renaming"_s);
        cancelByHand(mScreen.get());
        const QDeadlineTimer limit(10000);
        while (work.step(1, 3) && !limit.hasExpired())
            QThread::yieldCurrentThread();
        QVERIFY(work.isCancelled());
    }

    void cancelEndsASocket()
    {
        QTcpServer silent;
        QVERIFY(silent.listen(QHostAddress::LocalHost));
        QTcpSocket socket;
        socket.connectToHost(silent.serverAddress(), silent.serverPort());
        LongWork work(*mScreen);
        QVERIFY(work.waitFor(&socket, &QTcpSocket::connected, [] {}));
        cancelByHand(mScreen.get());
        bool aborted = false;
        QVERIFY(!work.waitFor(&socket, &QTcpSocket::readyRead, [&] { aborted = true; }));
        QVERIFY(aborted);
    }

    // The screen shows the progress: no window comes, and its own button cancels.
    void theScreenShowsIt()
    {
        LongWork work(*mScreen);
        work.showPercent = [](int) {};
        QTimer::singleShot(700, mScreen.get(), [&] {
            QVERIFY(!workWindow());
            work.cancel();
        });
        QTcpServer silent;
        QVERIFY(!work.waitFor(&silent, &QTcpServer::newConnection, [] {}));
    }

    // What the outer one waits for is there while the inner one still waits.
    void waitsEndLastInFirstOut()
    {
        LongWork outer(*mScreen);
        outer.showPercent = [](int) {};
        Wait wait(outer);
        QStringList ended;
        QTimer::singleShot(0, mOther.get(), [&] {
            LongWork inner(*mOther);
            inner.showPercent = [](int) {};
            QTcpServer never;
            QTimer::singleShot(0, &wait, [&] { wait.done(); });
            inner.waitFor(&never, &QTcpServer::newConnection, [&] { ended.append(u"inner"_s); });
        });
        QVERIFY(wait.run());
        ended.append(u"outer"_s);
        QCOMPARE(ended, texts("inner", "outer"));
    }

    void allAreCancelled()
    {
        LongWork outer(*mScreen), inner(*mOther);
        QTimer::singleShot(0, mOther.get(), &LongWork::cancelAll);
        QTcpServer never;
        QVERIFY(!inner.waitFor(&never, &QTcpServer::newConnection, [] {}));
        QVERIFY(outer.isCancelled());
    }

    void helperPrograms_data()
    {
        using End = HelperProgram::End;
        const DataRows<QByteArray, QByteArrayList, int> row("script", "lines", "end");
        row("lines", "echo a; echo; printf b", {"a", "", "b"}, int(End::Whole));
        row("it fails", "echo a; exit 3", {"a"}, int(End::Failed));
        row("it crashes", "kill -SEGV $$", {}, int(End::Crashed));
        row("it says nothing", "sleep 60", {}, int(End::TooSlow));
        row("it says too much", "yes | head -c 3000000", {}, int(End::TooMuch));
        row("one endless line", "head -c 3000000 /dev/zero", {}, int(End::TooMuch));
        row("it writes a file", "echo x > \"$HOME/x\"; echo no", {}, int(End::Crashed));
        row("its memory", "ulimit -v", {"131072"}, int(End::Whole));
    }

    void helperPrograms()
    {
        QFETCH(QByteArray, script);
        QFETCH(QByteArrayList, lines);
        QFETCH(int, end);
        qputenv("HOME", mDesktop->folder.toLocal8Bit());
        HelperProgram::End how{};
        const auto got = linesOf(script.constData(), {qint64(128) << 20, 1 << 20, 1, 5}, how);
        QCOMPARE(int(how), end);
        if (how != HelperProgram::End::TooMuch)
            QCOMPARE(got, lines);
    }

    void cancelKillsAHelper()
    {
        LongWork work(*mScreen);
        HelperProgram helper(work, u"/bin/sh"_s, {u"-c"_s, u"exec sleep 100"_s}, {});
        cancelByHand(mScreen.get());
        QVERIFY(!helper.line());
        QCOMPARE(int(helper.end()), int(HelperProgram::End::Cancelled));
        HelperProgram missing(work, u"/no/such/program"_s, {}, {});
        QVERIFY(!missing.line());
    }
};

QTEST_MAIN(tst_LongWork)
#include "tst_LongWork.moc"
