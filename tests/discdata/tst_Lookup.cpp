// Label: unit
#include "discdata/lookup.h"
#include "discs/discid.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/fulldisk.h"
#include "support/scripteddesktop.h"
#include "support/standinserver.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QTimer>

using Answer = StandInServer::Answer;

namespace
{

constexpr char record[] = "210 rock 1b03cb03 follows\r\n# xmcd\r\n# Revision: 4\r\n"
                          "DISCID=1b03cb03\r\nDTITLE=The Band / Of CDDB\r\nDYEAR=1999\r\n"
                          "DGENRE=Rock\r\nTTITLE0=One\r\nTTITLE1=Two\r\nTTITLE2=Three\r\n"
                          "EXTD=\r\nPLAYORDER=\r\n.\r\n";
constexpr char exact[] = "200 rock 1b03cb03 The Band / Of CDDB\r\n";
constexpr char several[] = "210 list\r\nrock 1b03cb03 The Band / Of CDDB\r\n"
                           "folk 1b03cb03 The Band / Another\r\n.\r\n";
constexpr char noMatch[] = "202 No match\r\n";
constexpr char refusal[] = "500 Unknown developer email\r\n";

const QByteArray ofMusicBrainz =
    "{\"release-count\":1,\"releases\":[{\"id\":\"a\",\"title\":\"Of MusicBrainz\",\"artist-credit\":"
    "[{\"name\":\"The Band\"}],\"media\":[{\"position\":1,\"track-count\":3,\"tracks\":[{\"title\":\"One\"},"
    "{\"title\":\"Two\"},{\"title\":\"Three\"}]}]}]}";
const QByteArray nothing = "{\"release-count\":0,\"releases\":[]}";

} // namespace

/// The order of the services, what is told of refusals, and the answers that are kept.
class tst_Lookup : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Form> mScreen;
    std::unique_ptr<LongWork> mWork;
    std::unique_ptr<StandInServer> mCddb, mMusicBrainz;
    std::shared_ptr<Refusals> mRefusals;
    ServiceOptions mOptions;
    QStringList mTold;
    const TableOfContents mToc{{{150}, {20000}, {40000}}, 1, 73000};

    // "off" hangs up for good, nobody listens there any more.
    static void lay(StandInServer &server, const QByteArray &part, const QByteArray &answer)
    {
        if (answer == "off")
            server.close();
        else
            server.answer(part, answer);
    }

    QString folder() const { return mDesktop->folder + u"/Answers"_s; }

    // The services as a new session has them, in the same run of the program.
    std::unique_ptr<Lookup> session()
    {
        auto made = std::make_unique<Lookup>(mOptions, KeptAnswers(folder(), 3), mRefusals);
        made->tellRefusal = [this](const QString &words) { mTold.append(words); };
        return made;
    }

    // "title" of what is found, several parted by "|", with the day of a kept answer; "none"; or
    // the number of the error, from errHostNotFound 8.
    QString found()
    {
        Lookup::Found found;
        if (const int error = numberOf([&] { found = session()->find(mToc, *mWork); }))
            return QString::number(error & 0xffff, 16);
        QStringList titles;
        for (const DiscRecord &disc : found.candidates)
            titles.append(disc.title + (disc.isWhole() ? QString() : u" (to read)"_s));
        const QString day = found.keptOn ? u" of "_s + found.keptOn->toString(Qt::ISODate) : u""_s;
        const QString sure = found.isDoubtful ? u" (doubtful)"_s : u""_s;
        return titles.isEmpty() ? u"none"_s : titles.join(u'|') + sure + day;
    }

    // Both services are gone.
    void goOffline()
    {
        mCddb->close();
        mMusicBrainz->close();
        mDesktop->time = mDesktop->time.addDays(1);
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mScreen = std::make_unique<Form>(u"frmAsking"_s);
        mWork = std::make_unique<LongWork>(*mScreen);
        mWork->showPercent = [](int) {};
        mCddb = std::make_unique<StandInServer>();
        mCddb->answer("cddb read rock 1b03cb03", record);
        mMusicBrainz = std::make_unique<StandInServer>();
        mRefusals = std::make_shared<Refusals>();
        mTold.clear();
        mOptions = {};
        mOptions.cddbAddress = mCddb->address();
        mOptions.musicBrainzAddress = mMusicBrainz->address();
        mOptions.mail = u"joe@my.host.example"_s;
        mOptions.silence = 200;
        mOptions.interval = 0;
        mOptions.paceFolder = mDesktop->folder;
    }

    void cleanup()
    {
        mWork.reset();
        mScreen.reset();
    }

    void theFirstThatKnowsDecides_data()
    {
        const DataRows<QByteArray, QByteArray, QString, int> row("musicBrainz", "cddb", "found",
                                                                 "askedCddb");
        row("the first knows", ofMusicBrainz, exact, "Of MusicBrainz", 0);
        row("the first does not", nothing, exact, "Of CDDB", 2);
        row("the first is off", "off", exact, "Of CDDB", 2);
        row("the first talks nonsense", "<html>", exact, "Of CDDB", 2);
        row("several", nothing, several, "Of CDDB (to read)|Another (to read)", 1);
        row("close, as many tracks", nothing, "211 list\r\nrock 1b03cc03 A / B\r\n.\r\n", "Of CDDB",
            2);
        row("close, fewer tracks", nothing, "211 list\r\nrock 1b03cc02 A / B\r\n.\r\n",
            "Of CDDB (doubtful)", 2);
        // They look the same in the list, so the user could not choose: two pressings of one
        // record.
        row("repeats", nothing,
            "210 list\r\nrock 1b03cb03 A / Don't\r\nrock 1b03cb03 A / Don’t\r\n.\r\n", "Of CDDB",
            2);
        row("neither", nothing, noMatch, "none", 1);
        row("off, and not known", "off", noMatch, "none", 1);
        row("not known, and off", nothing, "off", "8", 0);
        row("both off", "off", "off", "8", 0);
        row("not known, and cut off", nothing, "210 list\r\nrock 1b03cb03 A / B", "1004", 1);
        row("not known, and cut in the id", nothing, "200 rock 1b0", "1004", 1);
        row("not known, and refused", nothing, refusal, "1003", 1);
        row("off, and refused", "off", refusal, "1003", 1);
    }

    void theFirstThatKnowsDecides()
    {
        QFETCH(QByteArray, musicBrainz);
        QFETCH(QByteArray, cddb);
        lay(*mMusicBrainz, "discid", musicBrainz);
        lay(*mCddb, "cddb query", cddb);
        mCddb->answer("1b03cc03", record);
        mCddb->answer("1b03cc02", QByteArray(record).replace("TTITLE2=Three\r\n", ""));
        QTEST(found(), "found");
        QTEST(int(mCddb->requests.size()), "askedCddb");
    }

    void theUserSetsTheOrder()
    {
        mMusicBrainz->answer("discid", ofMusicBrainz);
        mCddb->answer("cddb query", exact);
        mOptions.order = texts("cddb", "musicbrainz");
        QCOMPARE(found(), u"Of CDDB"_s);
        mOptions.mail.clear(); // without one it is not asked
        QCOMPARE(found(), u"Of MusicBrainz"_s);
        QVERIFY(QDir(folder()).removeRecursively());
        mOptions.order = texts("cddb");
        QCOMPARE(found(), u"1002"_s);
        mOptions.order.clear();
        QCOMPARE(found(), u"8"_s);
        QCOMPARE(mMusicBrainz->requests.size(), 1);
    }

    void aRefusalIsToldOnce()
    {
        mCddb->answer("cddb query", refusal);
        mMusicBrainz->answer("discid", ofMusicBrainz);
        mMusicBrainz->answer("discid", nothing);
        mOptions.order = texts("cddb", "musicbrainz");
        QCOMPARE(found(), u"Of MusicBrainz"_s);
        QCOMPARE(mTold, texts("Unknown developer email"));
        QCOMPARE(found(), u"1003"_s); // nothing else came of it: told again
        QCOMPARE(mTold.size(), 2);
        QCOMPARE(mCddb->requests.size(), 1);
        mOptions.mail = u"jane@my.host.example"_s; // another may be let in
        QCOMPARE(found(), u"1003"_s);
        QCOMPARE(mCddb->requests.size(), 2);
    }

    void answersAreKept()
    {
        mMusicBrainz->answer("discid", nothing);
        mCddb->answer("cddb query", several);
        const auto chosen = session()->find(mToc, *mWork).candidates[0];
        QVERIFY(!session()->complete(chosen, *mWork).keptOn);
        goOffline();
        QCOMPARE(found(), u"Of CDDB (to read)|Another (to read) of 2026-11-22"_s);
        const Lookup::Whole whole = session()->complete(chosen, *mWork);
        QCOMPARE(whole.keptOn, QDate(2026, 11, 22));
        QCOMPARE(whole.disc.tracks.size(), 3U);
        DiscRecord other = chosen;
        other.keyA = u"folk"_s; // nobody has read it
        QCOMPARE(numberOf([&] { session()->complete(other, *mWork); }), int(errHostNotFound));
    }

    // Who says today that it knows nothing, is believed.
    void newerKnowledgeCounts()
    {
        mMusicBrainz->answer("discid", ofMusicBrainz);
        mMusicBrainz->answer("discid", nothing);
        mCddb->answer("cddb query", noMatch);
        QCOMPARE(found(), u"Of MusicBrainz"_s);
        QCOMPARE(found(), u"none"_s);
        goOffline();
        QCOMPARE(found(), u"Of MusicBrainz of 2026-11-22"_s);
    }

    void damageIsNoAnswer_data()
    {
        const DataRows<int> row("cut"); // bytes
        row("at the end", 1);
        row("in the midst", 100);
        row("whole", 100000);
        row("of a letter", 0);
    }

    void damageIsNoAnswer()
    {
        QFETCH(int, cut);
        mMusicBrainz->answer("discid", ofMusicBrainz);
        QCOMPARE(found(), u"Of MusicBrainz"_s);
        goOffline();
        const QStringList files = QDir(folder()).entryList(QDir::Files);
        const QString file = folder() + u'/' + files[0];
        const QByteArray whole = readFile(file);
        const QByteArray changed = QByteArray(whole).replace("Of MusicBrainz", "of musicbrainz");
        writeFile(file, cut == 0 ? changed : whole.chopped(std::min(cut, int(whole.size()))));
        QCOMPARE(found(), u"8"_s);
        writeFile(file, whole);
        QCOMPARE(found(), u"Of MusicBrainz of 2026-11-22"_s);
    }

    void onlySoMany()
    {
        const KeptAnswers kept(folder(), 3);
        const std::vector<DiscRecord> records(1);
        for (int day = 1; day <= 5; ++day) {
            kept.keep(u"question "_s + QString::number(day), records);
            const QFileInfoList all = QDir(folder()).entryInfoList(QDir::Files, QDir::Time);
            for (const QFileInfo &info : all) { // as if a day had gone by
                QFile file(info.filePath());
                QVERIFY(file.open(QIODevice::ReadWrite));
                QVERIFY(file.setFileTime(info.lastModified().addDays(-1),
                                         QFileDevice::FileModificationTime));
            }
        }
        QCOMPARE(QDir(folder()).entryList(QDir::Files).size(), 3);
        QVERIFY(!kept.find(u"question 2"_s) && kept.find(u"question 3"_s));
        kept.keep(u"question 5"_s, {});
        QVERIFY(kept.find(u"question 5"_s));
        QVERIFY(!KeptAnswers({}).find(u"question 5"_s));
    }

    // What cannot be kept stands in nobody's way.
    void aDiskThatTakesNothing()
    {
        mMusicBrainz->answer("discid", ofMusicBrainz);
        {
            const FullDisk full(16);
            QCOMPARE(found(), u"Of MusicBrainz"_s);
        }
        QVERIFY(QDir(folder()).entryList(QDir::Files).isEmpty());
    }

    // Whatever the order; and who refuses is not asked again.
    void discsGoToTheSenderAlone_data()
    {
        const DataRows<int, int> row("status", "error");
        row("taken", 200, 0);
        row("refused", 403, int(errServiceRefused));
    }

    void discsGoToTheSenderAlone()
    {
        QFETCH(int, status);
        mMusicBrainz->answer("discid", ofMusicBrainz);
        mCddb->answer("submit.cgi",
                      {.body = "200 OK, submission has been sent.\r\n", .status = status});
        mOptions.order = texts("musicbrainz");
        const auto services = session();
        DiscRecord disc = services->find(mToc, *mWork).candidates[0];
        disc.category = u"rock"_s;
        for (int i = 0; i < 2; ++i)
            QTEST(numberOf([&] { services->send(disc, mToc, *mWork); }), "error");
        QCOMPARE(mMusicBrainz->requests.size(), 1);
        QCOMPARE(mCddb->requests.size(), status == 200 ? 2 : 1);
        QVERIFY(mCddb->requests[0].body.contains("DTITLE=The Band / Of MusicBrainz\n"));
        QVERIFY(mTold.isEmpty()); // by who sends
    }

    void cancelEndsAll()
    {
        mOptions.silence = 60000;
        mMusicBrainz->answer("discid", {.silent = true});
        connect(mMusicBrainz.get(), &StandInServer::asked, this, [this] { mWork->cancel(); });
        QCOMPARE(found(), u"1001"_s);
        QVERIFY(mCddb->requests.isEmpty());
    }

    void cancelWhileItWaitsForItsTurn()
    {
        mOptions.interval = 60000;
        mMusicBrainz->answer("discid", nothing);
        mCddb->answer("cddb query", several);
        mOptions.order = texts("cddb");
        const auto chosen = session()->find(mToc, *mWork).candidates[0];
        QTimer::singleShot(0, this, [this] { mWork->cancel(); });
        QCOMPARE(numberOf([&] { session()->complete(chosen, *mWork); }), int(errLookupCancelled));
        QCOMPARE(mCddb->requests.size(), 1);
    }

    // Without a scheme https comes first; where nobody listens there at all, http.
    void anAddressWithoutScheme()
    {
        const QHostAddress own(u"127.77.0.1"_s);
        mCddb->close();
        QTcpServer https;
        if (!mCddb->listen(own, 80) || !https.listen(own, 443))
            QSKIP("needs the ports 80 and 443");
        https.close();
        mCddb->answer("cddb query", exact);
        mOptions.order = texts("cddb");
        mOptions.cddbAddress = own.toString();
        QCOMPARE(found(), u"Of CDDB"_s);
        mOptions.cddbAddress = u"https://"_s + own.toString();
        QCOMPARE(found(), u"Of CDDB of 2026-11-22"_s);
        QCOMPARE(mCddb->requests.size(), 2);
    }
};

QTEST_MAIN(tst_Lookup)
#include "tst_Lookup.moc"
