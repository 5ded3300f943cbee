// Label: unit
#include "discdata/httpclient.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/standinproxy.h"
#include "support/standinserver.h"

#include <QTimer>

using End = HttpAnswer::End;
using Answer = StandInServer::Answer;

/// The services and what carries them, on real sockets.
class tst_Services : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Form> mScreen;
    ServiceOptions mOptions; // without pauses

    HttpAnswer got(const QString &address, int retries = 0)
    {
        LongWork work(*mScreen);
        work.showPercent = [](int) {};
        HttpClient client(mOptions, retries);
        return client.get(QUrl(address), work);
    }

    void useProxy(const StandInProxy &proxy, const QString &password)
    {
        mOptions.proxyHost = u"127.0.0.1"_s;
        mOptions.proxyPort = proxy.serverPort();
        mOptions.proxyUser = password.isEmpty() ? QString() : u"joe"_s;
        mOptions.proxyPassword = password;
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mScreen = std::make_unique<Form>(u"frmAsking"_s);
        mOptions = {};
        mOptions.mail = u"joe@my.host.example"_s;
        mOptions.silence = 200;
        mOptions.interval = 0;
        mOptions.paceFolder = mDesktop->folder;
    }

    void cleanup()
    {
        mDesktop->verifyAllCame();
        mScreen.reset();
    }

    void answersOfHttp_data()
    {
        const QByteArray large((4 << 20) + 1, 'x');
        const DataRows<Answer, int> row("answer", "end");
        row("whole", {"abc"}, int(End::Answered));
        row("empty", {""}, int(End::Answered));
        row("error with a body", {.body = "abc", .status = 500}, int(End::Answered));
        row("not found", {.body = "abc", .status = 404}, int(End::Answered));
        row("in chunks", {.body = "a long text in pieces", .chunked = true}, int(End::Answered));
        row("without length", {.body = "abc", .withoutLength = true}, int(End::Answered));
        row("wants a password", {.body = "abc", .status = 401}, int(End::Answered));
        row("cut in the body", {.body = QByteArray(500, 'x'), .cutAt = 400}, int(End::Failed));
        row("cut in the head", {.body = "abc", .cutAt = 30}, int(End::Failed));
        row("cut in the first line", {.body = "abc", .cutAt = 5}, int(End::Failed));
        row("cut at once", {.body = "abc", .cutAt = 0}, int(End::Failed));
        row("too long", {large}, int(End::Failed));
        row("endless", {.body = QByteArray(100000, 'x'), .endless = true}, int(End::Failed));
        row("silent from the start", {.body = "abc", .silent = true}, int(End::NotReached));
        row("silent in between", {.body = QByteArray(500, 'x'), .cutAt = 300, .silent = true},
            int(End::NotReached));
    }

    void answersOfHttp()
    {
        QFETCH(Answer, answer);
        QFETCH(int, end);
        StandInServer server;
        server.answer("/", answer);
        const HttpAnswer answered = got(server.address() + u"/a"_s);
        QCOMPARE(int(answered.end), end);
        QCOMPARE(answered.body, answered.end == End::Answered ? answer.body : QByteArray());
        if (answered.end == End::Answered)
            QCOMPARE(answered.status, answer.status);
        QVERIFY(answered.end == End::Answered || !answered.words.isEmpty());
    }

    void redirects_data()
    {
        const DataRows<QByteArray, int, bool> row("location", "end", "fromHttps");
        row("further", "/there", int(End::Answered), false);
        row("further, encrypted", "/there", int(End::Answered), true);
        row("out of the encrypted", "http://127.0.0.1/there", int(End::Failed), true);
        row("in circles", "/here", int(End::Failed), false);
        row("to a file", "file:///etc/passwd", int(End::Failed), false);
        row("to nowhere", "", int(End::Failed), false);
    }

    void redirects()
    {
        QFETCH(QByteArray, location);
        QFETCH(int, end);
        QFETCH(bool, fromHttps);
        StandInServer server(fromHttps ? StandInServer::Tls::Own : StandInServer::Tls::None);
        mOptions.extraCa = StandInServer::certificate();
        server.answer("/here",
                      {.body = "old", .status = 301, .headers = {"Location: " + location}});
        server.answer("/there", "new");
        const HttpAnswer answered = got(server.address() + u"/here"_s);
        QCOMPARE(int(answered.end), end);
        QCOMPARE(answered.body, end == int(End::Answered) ? "new" : "");
        QVERIFY(server.requests.size() <= 6);
    }

    void aBusyServerIsAskedAgain()
    {
        StandInServer server;
        server.answer("/", {.body = "busy", .status = 503, .headers = {"Retry-After: 0"}});
        server.answer("/", {.body = "<html>", .headers = {"Content-Type: text/html"}});
        server.answer("/", "fine");
        QCOMPARE(got(server.address(), 0).status, 503);
        QCOMPARE(got(server.address(), 3).body, "fine");
        QCOMPARE(server.requests.size(), 3);
        QVERIFY(server.requests[0].header("User-Agent").startsWith("Songcase/"));
    }

    void tlsIsNotToBeFooled()
    {
        StandInServer server(StandInServer::Tls::Own);
        server.answer("/", "secret");
        QCOMPARE(int(got(server.address()).end), int(End::NotReached)); // nobody vouches for it
        mOptions.extraCa = StandInServer::certificate();
        QCOMPARE(got(server.address()).body, "secret");
        QCOMPARE(int(got(server.address(u"localhost"_s)).end), int(End::NotReached));
        QCOMPARE(server.requests.size(), 1);
    }

    void proxies_data()
    {
        const DataRows<QString, int, bool> row("password", "end", "tls");
        row("right", "open sesame", int(End::Answered), false);
        row("right, tunnel", "open sesame", int(End::Answered), true);
        row("none", "", int(End::ProxyRefused), false);
        row("wrong", "open barley", int(End::ProxyRefused), false);
        row("wrong, tunnel", "open barley", int(End::ProxyRefused), true);
    }

    void proxies()
    {
        QFETCH(QString, password);
        QFETCH(int, end);
        QFETCH(bool, tls);
        StandInServer server(tls ? StandInServer::Tls::Own : StandInServer::Tls::None);
        server.answer("/", "fine");
        mOptions.extraCa = StandInServer::certificate();
        StandInProxy proxy("joe", "open sesame");
        useProxy(proxy, password);
        QCOMPARE(int(got(server.address() + u"/a"_s).end), end);
        QCOMPARE(server.requests.size(), end == int(End::Answered) ? 1 : 0);
        QCOMPARE(proxy.passed, server.requests.size());
        for (const auto &request : std::as_const(server.requests))
            QVERIFY(!request.head.contains("uthorization"));
    }

    void nobodyThere()
    {
        StandInServer server;
        const QString address = server.address();
        StandInProxy proxy({}, {});
        useProxy(proxy, {});
        server.close();
        proxy.close();
        QCOMPARE(int(got(address).end), int(End::NotConnected)); // no proxy
        mOptions.proxyHost.clear();
        QCOMPARE(int(got(address).end), int(End::NotConnected));
    }

    void cancelEndsARequest()
    {
        mOptions.silence = 60000;
        StandInServer server;
        server.answer("/", {.body = "abc", .silent = true});
        LongWork work(*mScreen);
        work.showPercent = [](int) {};
        connect(&server, &StandInServer::asked, &server, [&] { work.cancel(); });
        HttpClient client(mOptions, 3);
        QCOMPARE(int(client.get(QUrl(server.address()), work).end), int(End::Cancelled));
        QCOMPARE(int(client.get(QUrl(server.address()), work).end), int(End::Cancelled));
        QCOMPARE(server.requests.size(), 1);
    }

    // Two copies of the program, and a clock that somebody sets back.
    void oneRequestASecond()
    {
        QList<int> waits;
        const auto pause = [&](int milliseconds, LongWork &) {
            waits.append(milliseconds);
            return true;
        };
        LongWork work(*mScreen);
        RequestPace one(mDesktop->folder, 1000, pause), other(mDesktop->folder, 1000, pause);
        QVERIFY(one.await(u"a"_s, work) && other.await(u"a"_s, work) && one.await(u"a"_s, work));
        QVERIFY(other.await(u"b"_s, work));
        QCOMPARE(waits, QList<int>({1000, 2000}));
        mDesktop->time = mDesktop->time.addMSecs(2400);
        QVERIFY(other.await(u"a"_s, work));
        mDesktop->time = mDesktop->time.addDays(-1);
        QVERIFY(other.await(u"a"_s, work));
        QCOMPARE(waits, QList<int>({1000, 2000, 600}));
    }
};

QTEST_MAIN(tst_Services)
#include "tst_Services.moc"
