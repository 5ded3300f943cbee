// Label: unit
#include "discdata/filelookup.h"
#include "discdata/filelookupid.h"
#include "platform/files/nativename.h"
#include "platform/work/longwork.h"
#include "support/datarows.h"
#include "support/madesound.h"
#include "support/scripteddesktop.h"
#include "support/standinserver.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QTimer>

namespace
{

const QByteArray release = "0b0b0b0b-0000-4000-8000-000000000001";

QByteArray track(const QByteArray &title, int length)
{
    return "{\"title\":\"" + title + "\",\"length\":" + QByteArray::number(length) + "}";
}

// A release with one medium; `tracks` as its JSON.
QByteArray releaseOf(const QByteArray &title, const QByteArray &tracks, int count = 3)
{
    return "{\"id\":\"" + release + "\",\"title\":\"" + title +
           "\",\"artist-credit\":[{\"name\":\"Nora\"}],\"media\":[{\"position\":1,\"track-count\":" +
           QByteArray::number(count) + tracks + "}]}";
}

const QByteArray threeTracks = ",\"tracks\":[" + track("One", 10000) + "," + track("Two", 20000) +
                               "," + track("Three", 30000) + "]";
const QByteArray whole = releaseOf("Harbour", threeTracks);
const QByteArray candidate = releaseOf("Harbour", {});
const QByteArray longer = releaseOf("Harbour, and more", {}, 4);
const QByteArray offset = ",\"track-offset\":2,\"track\":[{}]";

QByteArray listOf(const QByteArray &name, const QByteArrayList &items)
{
    return "{\"release-count\":" + QByteArray::number(items.size()) + ",\"" + name + "\":[" +
           items.join(',') + "]}";
}

const QByteArray nothing = listOf("releases", {});

QString hex(const QString &owner, const QByteArray &id)
{
    return owner + u'=' + QString::fromLatin1(id.toHex());
}

} // namespace

/// Which disc a file is from: what is asked, in which order, and what counts as sure.
class tst_FileLookup : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Form> mScreen;
    std::unique_ptr<StandInServer> mServer;
    ServiceOptions mOptions;

    QString folder() const { return mDesktop->folder + u"/Nora - Harbour (1985)"_s; }

    // "title #track", "title | title" of candidates, "none", or the number of the error.
    QString found(const std::function<FileLookup::Found(FileLookup &lookup)> &ask)
    {
        LongWork work(*mScreen);
        Lookup services(mOptions, KeptAnswers({}));
        FileLookup lookup(services, work);
        FileLookup::Found found;
        if (const int error = numberOf([&] { found = ask(lookup); }))
            return QString::number(error & 0xffff, 16);
        if (found.disc)
            return found.disc->title + u" #"_s + QString::number(found.track);
        QStringList titles;
        for (const DiscRecord &disc : found.candidates)
            titles.append(disc.title);
        return titles.isEmpty() ? u"none"_s : titles.join(u" | "_s);
    }
    QString foundByFile(const QString &name)
    {
        const QString path = folder() + u'/' + name;
        return found([&](FileLookup &lookup) { return lookup.byFile(path); });
    }

    // What was asked, in order: "toc", "release: words", "recording: words", "read".
    QStringList asked() const
    {
        QStringList all;
        for (const QByteArray &words : mServer->words()) {
            const QString query =
                QString::fromUtf8(words).section(u"query="_s, 1).section(u'&', 0, 0);
            if (words.contains("discid/"))
                all.append(u"toc"_s);
            else if (query.isEmpty())
                all.append(u"read"_s);
            else
                all.append((words.contains("/recording?") ? u"recording: "_s : u"release: "_s) +
                           query);
        }
        return all;
    }

    void makeFiles(const QStringList &names)
    {
        int seconds = 0;
        for (const QString &name : names)
            makeSounds(folder(), {{name, 1000 * (seconds += 10)}});
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mScreen = std::make_unique<Form>(u"frmAsking"_s);
        mServer = std::make_unique<StandInServer>();
        mOptions = {};
        mOptions.order = QStringList(u"musicbrainz"_s);
        mOptions.musicBrainzAddress = mServer->address();
        mOptions.silence = 200;
        mOptions.interval = 0;
        mOptions.paceFolder = mDesktop->folder;
        QVERIFY(QDir().mkpath(folder()));
    }
    void cleanup() { mScreen.reset(); }

    void namesOfFiles_data()
    {
        const DataRows<QString, QString> row("path", "parts"); // artist|title|track|album|year
        row("/m/03 - Nora - One.mp3", "Nora|One|3|m|");
        row("/m/03-Nora-One.MP3", "Nora|One|3|m|");
        row("/m/Nora-One.mp3", "Nora|One|0|m|");
        row("/m/03_Nora_-_One_(live).mp3", "Nora|One (live)|3|m|");
        row("/m/A-ha - Take on me.mp3", "A-ha|Take on me|0|m|");
        row("/m/Nora - Harbour - 03 - One.mp3", "Nora|One|3|Harbour|");
        row("/m/Nora - 99 Lights.mp3", "Nora|99 Lights|0|m|");
        row("/m/1-03 One.mp3", "|One|3|m|");
        row("/m/03. One - Two.mp3", "One|Two|3|m|");
        row("/m/Track 03.mp3", "||3|m|");
        row("/m/1999.mp3", "|1999|0|m|");
        row("/m/no sign of anything.mp3", "|no sign of anything|0|m|");
        row("/m/---.mp3", "||0|m|");
        row("/m/Zoë - Été (1985)/CD 2/07 Été.mp3", "|Été|7|Été|1985");
        row("/m/1985 - Harbour/7.mp3", "||7|Harbour|1985");
    }
    void namesOfFiles()
    {
        QFETCH(QString, path);
        const FileNameParts parts = filenameParts(path);
        QTEST((QStringList{parts.artist, parts.title, QString::number(parts.track), parts.album,
                           parts.year}
                   .join(u'|')),
              "parts");
    }

    void byPlayingTimes_data()
    {
        // What the look-up by table gives; what is found, and what was asked.
        const DataRows<QByteArray, QString, int> row("answer", "found", "requests");
        row("one disc", listOf("releases", {whole}), "Harbour #2", 1);
        row("two", listOf("releases", {whole, releaseOf("Haven", threeTracks)}), "Harbour | Haven",
            1);
        row("another number", listOf("releases", {longer}), "none", 3);
    }
    void byPlayingTimes()
    {
        QFETCH(QByteArray, answer);
        makeFiles({u"1 a.mp3"_s, u"02 b.MP3"_s, u"10 c.mp3"_s});
        mServer->answer("discid/", answer);
        mServer->answer("query=", nothing);
        mServer->answer("release/" + release, whole);
        QTEST(foundByFile(u"02 b.MP3"_s), "found");
        QTEST(int(mServer->requests.size()), "requests");
    }

    // As an older system wrote them. The toolkit does not list them.
    void namesThatAreNoUtf8()
    {
        makeFiles({u"1.mp3"_s, u"2.mp3"_s, u"3.mp3"_s});
        const QByteArray name = nativeName(folder()) + "/2 \xC9t\xE9.mp3";
        QCOMPARE(std::rename(nativeName(folder() + u"/2.mp3"_s), name), 0);
        mServer->answer("discid/", listOf("releases", {whole}));
        QCOMPARE(foundByFile(nameOfNative("2 \xC9t\xE9.mp3")), u"Harbour #2"_s);
    }

    // The disc comes out to the frame where encoders tell what they have added; where they do not,
    // parts of a frame do not add up.
    void tableOfPlayingTimes()
    {
        for (const Added added : {Added::Told, Added::NotTold}) {
            for (const QString &name : texts("1.mp3", "2.mp3", "3.mp3"))
                writeFile(folder() + u'/' + name, silentMP3(10013, added)); // 751 frames
            mServer->answer("", nothing);
            foundByFile(u"1.mp3"_s);
        }
        QVERIFY(mServer->words().first().contains("toc=1 3 2403 150 901 1652&"));
        QVERIFY(mServer->words().join().contains("toc=1 3 2401 150 900 1651&"));
    }

    // In the order of the names the lengths are those of no disc.
    void byNumbersOfTags()
    {
        for (int number = 1; number <= 3; ++number)
            writeFile(folder() + u'/' + QChar(u'z' - number) + u".mp3"_s,
                      id3Tag({{"TRCK", QString::number(number)}}) + silentMP3(10000 * number));
        mServer->answer("discid/", nothing);
        mServer->answer("discid/", listOf("releases", {whole}));
        QCOMPARE(foundByFile(u"y.mp3"_s), u"Harbour #1"_s);
        QCOMPARE(asked(), texts("toc", "toc"));
    }

    void byWords_data()
    {
        const DataRows<QString, QByteArray, QByteArray, QString, QString> row(
            "name", "releases", "recordings", "found", "question");
        const QByteArray none = listOf("recordings", {});
        const QByteArray ofTrack =
            listOf("recordings", {"{\"artist-credit\":[{\"name\":\"Nora\"}],\"releases\":[" +
                                  releaseOf("Hits", offset) + "]}"});
        row("02 Two.mp3", listOf("releases", {candidate}), none, "Harbour #2", "read");
        row("Nora-Three.mp3", listOf("releases", {candidate}), none, "Harbour #3", "read");
        row("Nora-Four.mp3", listOf("releases", {candidate}), none, "Harbour", "read");
        row("Nora-One.mp3", listOf("releases", {candidate, longer}), none,
            "Harbour | Harbour, and more", "release: artist:\"Nora\" AND release:\"Harbour\"");
        row("05 - Nora - Whatever.mp3", nothing, ofTrack, "Harbour #3", "read");
        row("Nora \"N\"-a\\b.mp3", nothing, none, "none",
            "recording: recording:\"a\\\\b\" AND artist:\"Nora \\\"N\\\"\"");
        row("02.mp3", nothing, none, "none", "release: artist:\"Nora\" AND release:\"Harbour\"");
    }
    void byWords()
    {
        QFETCH(QString, name);
        QFETCH(QByteArray, releases);
        QFETCH(QByteArray, recordings);
        makeFiles({name});
        mServer->answer("discid/", nothing);
        mServer->answer("/recording?", recordings);
        mServer->answer("/release?", releases);
        mServer->answer("release/" + release, whole);
        QTEST(foundByFile(name), "found");
        QFETCH(QString, question);
        QVERIFY2(asked().contains(question), asked().join(u'\n').toUtf8());
    }

    void tagsBeforeTheName()
    {
        writeFile(folder() + u"/x-y.mp3"_s,
                  id3Tag({{"TPE1", u"Zoë"_s}, {"TIT2", u"Été"_s}}) + silentMP3(10000));
        mServer->answer("", nothing);
        mServer->answer("/recording?", listOf("recordings", {}));
        QCOMPARE(foundByFile(u"x-y.mp3"_s), u"none"_s);
        QCOMPARE(asked().mid(0, 2), texts("release: artist:\"Zoë\" AND release:\"Harbour\"",
                                          "recording: recording:\"Été\" AND artist:\"Zoë\""));
    }

    void byId_data()
    {
        const DataRows<QString, QByteArray, QString> row("id", "answer", "found");
        const QByteArray own = "musicbrainz:" + release + ":1:";
        const QByteArray media = "{\"releases\":[" + releaseOf("Hits", offset) + "]}";
        row("ours", hex(u"songcase"_s, own + "3"), whole, "Harbour #3");
        row("of a longer disc", hex(u"songcase"_s, own + "4"), whole, "none");
        row("not there any more", hex(u"songcase"_s, own + "1"), "404", "none");
        row("no answer", hex(u"songcase"_s, own + "1"), "off", "8");
        row("of MusicBrainz", hex(u"http://musicbrainz.org"_s, release), media, "Harbour #3");
        row("number 0", hex(u"songcase"_s, own + "0"), whole, "garbage");
        row("garbage of ours", hex(u"songcase"_s, "musicbrainz:../x:1:1"), whole, "garbage");
        row("another service", hex(u"songcase"_s, "else:a:1:1"), whole, "garbage");
        row("of somebody else", hex(u"www.example"_s, release), whole, "garbage");
        row("no id", "y", whole, "garbage");
        row("no owner", "=", whole, "garbage");
    }
    void byId()
    {
        QFETCH(QString, id);
        QFETCH(QByteArray, answer);
        const bool missing = answer == "404";
        mServer->answer("recording/", answer);
        mServer->answer("release/",
                        StandInServer::Answer{missing ? answer : whole, missing ? 404 : 200});
        if (answer == "off")
            mServer->close();
        const auto known = trackOfFileId(id);
        const QString got =
            known ? found([&](FileLookup &lookup) { return lookup.byId(*known); }) : u"garbage"_s;
        QTEST(got, "found");
    }

    // The query that a CDDB server wants before each read is made of the id.
    void byIdAtCddb()
    {
        mOptions.order = QStringList(u"cddb"_s);
        mOptions.cddbAddress = mServer->address();
        mOptions.mail = u"joe@my.host.example"_s;
        mServer->answer("cddb query 0f003c03 3 150 1650 3150 62", "202 No match\r\n");
        mServer->answer(
            "cddb read rock 0f003c03",
            "210 rock 0f003c03\r\n# xmcd\r\nDISCID=0f003c03\r\nDTITLE=Nora / Harbour\r\n"
            "TTITLE0=One\r\nTTITLE1=Two\r\nTTITLE2=Three\r\nEXTD=\r\nPLAYORDER=\r\n.\r\n");
        const auto id = trackOfFileId(hex(u"songcase"_s, "cddb:rock:0f003c03:2"));
        QVERIFY(id);
        QCOMPARE(found([&](FileLookup &lookup) { return lookup.byId(*id); }), u"Harbour #2"_s);
    }

    void oneOfAsManyTracks()
    {
        mOptions.order = QStringList(u"cddb"_s);
        mOptions.cddbAddress = mServer->address();
        mOptions.mail = u"joe@my.host.example"_s;
        makeFiles({u"1.mp3"_s, u"2.mp3"_s});
        mServer->answer("cddb query", "211 close\r\nrock 0f003c03 A / B\r\njazz 0f003c02 C / D\r\n"
                                      "misc 0f003c01 E / F\r\n.\r\n");
        mServer->answer("cddb read jazz", "210 jazz 0f003c02\r\n# xmcd\r\nDTITLE=C / D\r\n"
                                          "TTITLE0=One\r\nTTITLE1=Two\r\n.\r\n");
        QCOMPARE(foundByFile(u"2.mp3"_s), u"D #2"_s);
    }

    // One that cannot be reached is asked once, not for each of the questions.
    void servicesThatFail_data()
    {
        const DataRows<QByteArray, QString> row("fault", "found");
        row("off", "8");
        row("silent", "8");
        row("table fails", "Harbour #2");
        row("dies behind the search", "1004");
    }
    void servicesThatFail()
    {
        QFETCH(QByteArray, fault);
        makeFiles({u"01 One.mp3"_s, u"02 Two.mp3"_s, u"03 Three.mp3"_s});
        if (fault == "off")
            mServer->close();
        else
            mServer->answer("discid/",
                            StandInServer::Answer{.body = "{", .silent = fault == "silent"});
        mServer->answer("/release?", listOf("releases", {candidate}));
        if (fault == "table fails")
            mServer->answer("release/", whole);
        else
            mServer->answer("release/", StandInServer::Answer{.body = whole, .cutAt = 200});
        QTEST(foundByFile(u"02 Two.mp3"_s), "found");
        QVERIFY(fault != "silent" || mServer->requests.size() == 1);
    }

    void folderWithoutADisc()
    {
        makeFiles({u"01 One.mp3"_s, u"02 Two.mp3"_s});
        writeFile(folder() + u"/03 Three.mp3"_s, "no sound"); // without it, it is another disc
        mServer->answer("query=", nothing);
        QCOMPARE(foundByFile(u"02 Two.mp3"_s), u"none"_s);
        QCOMPARE(foundByFile(u"gone.mp3"_s), u"none"_s);
        QVERIFY(!asked().contains(u"toc"_s));
    }

    void userCancels()
    {
        makeFiles({u"01 One.mp3"_s, u"02 Two.mp3"_s});
        mServer->answer("", StandInServer::Answer{.silent = true});
        mOptions.silence = 60000;
        connect(mServer.get(), &StandInServer::asked, mScreen.get(), [] { LongWork::cancelAll(); });
        QCOMPARE(foundByFile(u"02 Two.mp3"_s), u"1001"_s);
    }
};

QTEST_MAIN(tst_FileLookup)
#include "tst_FileLookup.moc"
