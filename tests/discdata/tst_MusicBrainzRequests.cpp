// Label: unit
#include "discdata/musicbrainzserver.h"
#include "discs/discid.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/standinserver.h"
#include "support/testcatalogue.h"

using Answer = StandInServer::Answer;

namespace
{

constexpr char tracks[] = "\"tracks\":[{\"title\":\"One\",\"length\":264666},{\"title\":\"Two\","
                          "\"length\":266666},{\"title\":\"Three\",\"length\":440000}]";

QByteArray release(const QByteArray &id, const QByteArray &title = "The Disc")
{
    return "{\"id\":\"" + id + "\",\"title\":\"" + title +
           "\",\"artist-credit\":[{\"name\":\"The Band\"}],\"media\":[{\"position\":1,\"track-count\":3," +
           tracks + "}]}";
}

QByteArray byToc(const QByteArrayList &releases, int all)
{
    return "{\"release-count\":" + QByteArray::number(all) + ",\"releases\":[" +
           releases.join(',') + "]}";
}

// The answer {"id":"x","releases":[]}, packed.
const QByteArray packed =
    QByteArray::fromBase64("H4sIAAAAAAACA6tWykxRslKqUNJRKkrNSU0sTi1WsoqOrQUADL6hkBgAAAA=");

} // namespace

/// What MusicBrainz is asked, and what becomes of each kind of answer, on real sockets.
class tst_MusicBrainzRequests : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Form> mScreen;
    std::unique_ptr<LongWork> mWork;
    const TableOfContents mToc{{{150}, {20000}, {40000}}, 1, 73000};

    ServiceOptions options(const QString &address) const
    {
        ServiceOptions all;
        all.musicBrainzAddress = address;
        all.silence = 200;
        all.interval = 0;
        all.paceFolder = mDesktop->folder;
        return all;
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mScreen = std::make_unique<Form>(u"frmAsking"_s);
        mWork = std::make_unique<LongWork>(*mScreen);
        mWork->showPercent = [](int) {};
    }

    void cleanup()
    {
        mWork.reset();
        mScreen.reset();
    }

    void finds_data()
    {
        const QByteArray id = "{\"id\":\"" + musicBrainzId(mToc).toLatin1() + "\",\"releases\":[";
        const QByteArray one = id + release("a") + "]}";
        const DataRows<Answer, int, int> row("answer", "found", "error");
        row("by id", {one}, 1, 0);
        row("by id, two", {id + release("a") + ',' + release("b") + "]}"}, 2, 0);
        row("by lengths", {byToc({release("a")}, 1)}, 1, 0);
        row("by lengths, none", {byToc({}, 0)}, 0, 0);
        row("not known", {.body = "{\"error\":\"Not Found\"}", .status = 404}, 0, 0);
        row("another server",
            {.body = "<html>", .status = 404, .headers = {"Content-Type: text/html"}}, 0,
            errServiceFailed);
        row("fault of ours", {.body = "{\"error\":\"Invalid TOC\"}", .status = 400}, 0,
            errServiceFailed);
        row("forbidden", {.body = "{\"error\":\"go away\"}", .status = 403}, 0, errServiceRefused);
        row("busy for ever", {.body = "{\"error\":\"busy\"}", .status = 503}, 0, errServiceFailed);
        row("cut off in a chunk", {.body = one, .chunked = true, .cutAt = 400}, 0,
            errServiceFailed);
        row("empty", {.body = "", .headers = {"Content-Type: application/json"}}, 0,
            errServiceFailed);
        row("another shape", {"{\"count\":1}"}, 0, errServiceFailed);
        row("packed", {.body = packed, .headers = {"Content-Encoding: gzip"}}, 0, 0);
        row("packed, cut off", {.body = packed.left(30), .headers = {"Content-Encoding: gzip"}}, 0,
            errServiceFailed);
    }

    void finds()
    {
        QFETCH(Answer, answer);
        QFETCH(int, found);
        QFETCH(int, error);
        StandInServer server;
        server.answer("/ws/2/discid/" + musicBrainzId(mToc).toLatin1(), answer);
        MusicBrainzServer service(options(server.address()));
        std::vector<DiscRecord> discs;
        QCOMPARE(numberOf([&] { discs = service.find(mToc, *mWork); }), error);
        QCOMPARE(int(discs.size()), found);
        for (const DiscRecord &disc : discs)
            QVERIFY(disc.isWhole() && disc.tracks.size() == 3 && disc.service == service.name());
        const auto &request = server.requests.front();
        QVERIFY(request.target.contains("toc=1+3+73000+150+20000+40000&cdstubs=no&inc="));
        QVERIFY(request.target.endsWith("&fmt=json"));
        QVERIFY(request.header("User-Agent").startsWith("Songcase/"));
        QVERIFY(request.header("Accept-Encoding").contains("gzip"));
    }

    // What has a first track other than 1, the service takes for invalid.
    void asksNothingInVain()
    {
        StandInServer server;
        MusicBrainzServer service(options(server.address()));
        QVERIFY(service.find({{{150}, {20000}}, 2, 73000}, *mWork).empty());
        QVERIFY(service.find({}, *mWork).empty());
        QVERIFY(service.search({}, *mWork).empty());
        QVERIFY(server.requests.isEmpty());
    }

    void waitsForABusyServer()
    {
        StandInServer server;
        server.answer("/ws/2/", {.body = "{}", .status = 503, .headers = {"Retry-After: 0"}});
        server.answer("/ws/2/", {.body = "<html>", .headers = {"Content-Type: text/html"}});
        server.answer("/ws/2/", byToc({release("a")}, 1));
        MusicBrainzServer service(options(server.address() + u"//"_s));
        QCOMPARE(service.find(mToc, *mWork).size(), 1U);
        QCOMPARE(server.requests.size(), 3);
    }

    void pages_data()
    {
        const DataRows<int, Answer, int> row("all", "second", "found");
        row("more", 3, {byToc({release("c")}, 3)}, 3);
        row("no more", 2, {}, 2);
        row("the rest does not come", 3, {.body = "", .status = 503}, 2);
        row("the count was wrong", 3, {byToc({}, 3)}, 2);
    }

    void pages()
    {
        QFETCH(int, all);
        QFETCH(Answer, second);
        QFETCH(int, found);
        StandInServer server;
        server.answer("&offset=2", second);
        server.answer("/ws/2/", byToc({release("a"), release("b")}, all));
        MusicBrainzServer service(options(server.address()));
        QCOMPARE(int(service.find(mToc, *mWork).size()), found);
    }

    // A release that was merged with another stands there; titles are words and no syntax.
    void searchesAndCompletes()
    {
        StandInServer server;
        server.answer(
            "release?query=",
            "{\"releases\":[{\"id\":\"old\",\"title\":\"C++\",\"media\":[{\"track-count\":3}]}]}");
        server.answer(
            "release/old?",
            {.body = "moved", .status = 301, .headers = {"Location: /ws/2/release/new?fmt=json"}});
        server.answer("release/new?", release("new"));
        MusicBrainzServer service(options(server.address()));
        const auto found = service.search({u"A & \"B\""_s, u"C++"_s, {}}, *mWork);
        QCOMPARE(found.size(), 1U);
        QVERIFY(!found[0].isWhole());
        QVERIFY(server.requests[0].target.contains(
            "query=artist%3A%22A%20%26%20%5C%22B%5C%22%22%20AND%20release%3A%22C%2B%2B%22&limit="));
        const DiscRecord disc = service.complete(found[0], *mWork);
        QVERIFY(disc.isWhole());
        QCOMPARE(disc.title, u"The Disc"_s);
        QCOMPARE(disc.tracks.size(), 3U);
        server.answer("release/gone?", {.body = "{}", .status = 404});
        DiscRecord gone = found[0];
        gone.keyA = u"gone"_s;
        QCOMPARE(numberOf([&] { service.complete(gone, *mWork); }), int(errNothingFound));
    }
};

QTEST_MAIN(tst_MusicBrainzRequests)
#include "tst_MusicBrainzRequests.moc"
