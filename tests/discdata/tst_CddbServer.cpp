// Label: unit
#include "discdata/cddbserver.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/standinserver.h"

using Answer = StandInServer::Answer;

namespace
{

constexpr char record[] = "210 rock 1b03cb03 follows\r\n# xmcd\r\n# Revision: 4\r\n"
                          "DISCID=1b03cb03\r\nDTITLE=The Band / The Disc\r\nDYEAR=1999\r\n"
                          "DGENRE=Rock\r\nTTITLE0=One\r\nTTITLE1=Two\r\nTTITLE2=Three\r\n"
                          "EXTD=\r\nPLAYORDER=\r\n.\r\n";

} // namespace

/// Servers of the CDDB protocol, on real sockets.
class tst_CddbServer : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Form> mScreen;
    const TableOfContents mToc{{{150}, {20000}, {40000}}, 1, 73000};

    ServiceOptions options(const StandInServer &server) const
    {
        ServiceOptions all;
        all.cddbAddress = server.address();
        all.mail = u"joe@my.host.example"_s;
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
    }

    void finds_data()
    {
        const DataRows<QByteArray, Answer, int, int> row("query", "record", "found", "error");
        row("exact", "200 rock 1b03cb03 A / B\r\n", {record}, 1, 0);
        row("several", "210 list\r\nrock 1b03cb03 A / B\r\nfolk 1b03cb03 A / C\r\n.\r\n", {}, 2, 0);
        row("one inexact", "211 list\r\nrock 1d03ca04 A / B\r\n.\r\n", {record}, 1, 0);
        row("none", "202 No match\r\n", {}, 0, 0);
        row("list cut off", "210 list\r\nrock 1b03cb03 A / B\r\n", {}, 0, errServiceFailed);
        row("refusal", "500 Unknown developer email\r\n", {}, 0, errServiceRefused);
        row("HTML", "<html>Hello</html>", {}, 0, errServiceFailed);
        row("record cut off", "200 rock 1b03cb03 A / B\r\n",
            {.body = record, .chunked = true, .cutAt = 300}, 0, errServiceFailed);
        row("shut out", "200 rock 1b03cb03 A / B\r\n", {.body = "go away", .status = 403}, 0,
            errServiceRefused);
        row("silent", "200 rock 1b03cb03 A / B\r\n", {.silent = true}, 0, errHostNotFound);
    }

    void finds()
    {
        QFETCH(QByteArray, query);
        QFETCH(Answer, record);
        QFETCH(int, found);
        QFETCH(int, error);
        StandInServer server;
        server.answer("cddb query", query);
        server.answer("cddb read", record);
        CddbServer service(options(server));
        LongWork work(*mScreen);
        int number = 0;
        std::vector<DiscRecord> discs;
        try {
            discs = service.find(mToc, work);
        } catch (const Error &e) {
            number = e.Number;
        }
        QCOMPARE(number, error);
        QCOMPARE(int(discs.size()), found);
        QVERIFY(found != 1 || (discs[0].isWhole() && discs[0].tracks.size() == 3));
        QVERIFY(server.words()[0].contains("hello=joe my.host.example Songcase"));
    }

    void sends_data()
    {
        const DataRows<Answer, int> row("answer", "error");
        row("taken", {"200 OK, submission has been sent.\r\n"}, 0);
        row("header missing", {"500 Missing required header information.\r\n"}, errNotAccepted);
        row("header wrong", {"501 Invalid header information [email address].\r\n"},
            errNotAccepted);
        row("HTML", {.body = "<html>", .headers = {"Content-Type: text/html"}}, errServiceFailed);
    }

    void sends()
    {
        QFETCH(Answer, answer);
        QFETCH(int, error);
        StandInServer server;
        server.answer("cddb query", "200 rock 1b03cb03 A / B\r\n");
        server.answer("cddb read", record);
        server.answer("submit.cgi", answer);
        CddbServer service(options(server));
        LongWork work(*mScreen);
        const DiscRecord disc = service.find(mToc, work).front();
        int number = 0;
        try {
            service.send(disc, mToc, work);
        } catch (const Error &e) {
            number = e.Number;
        }
        QCOMPARE(number, error);
        const auto &request = server.requests.last();
        QCOMPARE(request.header("Category"), "rock");
        QCOMPARE(request.header("Submit-Mode"), "submit");
        QVERIFY(request.body.contains("# Revision: 5\n"));
        QVERIFY(request.body.contains(QByteArray("DISCID=" + request.header("Discid"))));
    }
};

QTEST_MAIN(tst_CddbServer)
#include "tst_CddbServer.moc"
