// Label: unit
#include "discs/musicbrainzanswer.h"
#include "platform/error/error.h"
#include "support/datarows.h"

namespace
{

// JSON is written with ' for ".
QByteArray json(QByteArray text)
{
    return text.replace('\'', '"');
}

// Three tracks of 4, 6 and 8 seconds.
const TableOfContents three{{{150}, {450}, {900}}, 1, 1500};

QByteArray credit(const QByteArray &name, const QByteArray &more = {})
{
    return "[{'name':'" + name + "','artist':{'id':'x'" + more + "}}]";
}

QByteArray track(const QByteArray &title, int length, const QByteArray &more = {})
{
    return "{'title':'" + title + "','length':" + QByteArray::number(length) + more + '}';
}

QByteArray medium(int position, const QByteArrayList &tracks, const QByteArray &more = {})
{
    return "{'position':" + QByteArray::number(position) +
           ",'track-count':" + QByteArray::number(tracks.size()) + ",'tracks':[" +
           tracks.join(',') + ']' + more + '}';
}

QByteArray release(const QByteArray &title, const QByteArrayList &media,
                   const QByteArray &more = {})
{
    return "{'id':'r-" + title + "','title':'" + title + "','media':[" + media.join(',') + ']' +
           more + '}';
}

QByteArray found(const QByteArrayList &releases, const QByteArray &more = {})
{
    return "{'releases':[" + releases.join(',') + ']' + more + '}';
}

QByteArray near(int off)
{
    return medium(1, {track("a", 4000 + off), track("b", 6000), track("c", 8000 - off)});
}

DiscRecord only(const QByteArray &releaseText, int mediumNumber = 1)
{
    return musicBrainzRelease(json(releaseText), mediumNumber);
}

std::vector<DiscRecord> discsOf(const QByteArrayList &pages, const TableOfContents &toc = three)
{
    QByteArrayList answers;
    for (const QByteArray &page : pages)
        answers << json(page);
    return musicBrainzDiscs(answers, toc);
}

QString titlesOf(const DiscRecord &disc)
{
    QStringList all;
    for (const TrackRecord &track : disc.tracks)
        all << track.title;
    return all.join(u' ');
}

QString namesOf(const std::vector<DiscRecord> &discs)
{
    QStringList all;
    for (const DiscRecord &disc : discs)
        all << disc.title + u' ' + disc.numberInSet + u'/' + disc.totalInSet;
    return all.join(u", "_s);
}

} // namespace

/// Answers of the web service in JSON.
class tst_MusicBrainz : public QObject
{
    Q_OBJECT

private slots:
    void refused_data()
    {
        const QByteArray whole = found({release("A", {near(0)})});
        const DataRows<QByteArray> row("answer");
        row("empty", "");
        row("cut", whole.chopped(1));
        row("a list", "[" + whole + "]");
        row("an error", "{'error':'Not Found'}");
        row("releases null", "{'releases':null}");
        row("deep", QByteArray(5000, '['));
        row("deep inside", "{'releases':" + QByteArray(3000, '[') + QByteArray(3000, ']') + '}');
    }
    void refused()
    {
        QFETCH(QByteArray, answer);
        QVERIFY_THROWS_EXCEPTION(Error, discsOf({answer}));
        QVERIFY_THROWS_EXCEPTION(Error, musicBrainzSearch(json(answer)));
        QVERIFY_THROWS_EXCEPTION(Error, only(answer));
        QCOMPARE(musicBrainzPage(json(answer)).listed, 0);
    }

    void otherTypesAreNothing()
    {
        const QByteArray wrong =
            "{'id':7,'title':['x'],'date':1999,'barcode':null,'artist-credit':{'name':'x'},"
            "'release-group':[],'label-info':[null,7,{'label':null}],'genres':'rock',"
            "'media':[null,{'position':'1','tracks':[null,7,{'length':'x','recording':[]}]}]}";
        const auto discs = musicBrainzSearch(json("{'releases':[null,7," + wrong + "]}"));
        QCOMPARE(namesOf(discs), u" 1/2,  2/2"_s);
        QCOMPARE(discs[1].tracks.size(), 3u);
        QCOMPARE(discs[1].tracks[2].length, -1);
        QVERIFY(discs[1].artist.name.isEmpty() && discs[1].year.isEmpty());
        QVERIFY(musicBrainzSearch(json("{'releases':[{'media':{}}]}")).empty());
    }

    void byId()
    {
        const QByteArray own = ",'discs':[{'id':'other'},{'id':'it'}]";
        const QByteArray box =
            release("Box", {medium(1, {track("film", 1)}, ",'format':'DVD-Video','discs':[]"),
                            near(99999), medium(3, {track("x", 1)}, own)});
        const QByteArray byCount = release("Count", {medium(1, {}), near(99999)});
        const QByteArray none = release("None", {medium(1, {track("x", 1)})});
        const auto discs = discsOf({found({box, byCount, none}, ",'id':'it'")});
        QCOMPARE(namesOf(discs), u"Box 3/3, Count 1/2"_s);
        QCOMPARE(discs[0].trackCount, 1);
    }

    void byLengths()
    {
        const QByteArray table = ",'discs':[{'sectors':1500,'offsets':[150,451,900]}]";
        const QByteArray first =
            found({release("Far", {near(10'001)}), release("Second", {near(200)}),
                   release("Wrong", {"{'discs':[{'sectors':-5,'offsets':[9,8,7]}]}"})});
        const QByteArray second =
            found({release("First", {medium(1, {}), medium(2, {}, table)}),
                   release("Nothing", {medium(1, {})}), release("Count", {medium(1, {"{}"})})});
        QCOMPARE(namesOf(discsOf({first, second})), u"First 2/2, Second 1/1"_s);
        TableOfContents dataBehind = three;
        dataBehind.tracks.push_back({1500 + 11400, true});
        dataBehind.leadOut = 20000;
        QCOMPARE(namesOf(discsOf({found({release("A", {near(0)})})}, dataBehind)), u"A 1/1"_s);
    }

    void aStub()
    {
        const QByteArray answer = "{'title':'T','artist':'Various','tracks':[" +
                                  track("a", 5, ",'artist':'X'") + ",{'title':'b'}]}";
        const DiscRecord disc = discsOf({answer}).at(0);
        QVERIFY(disc.isWhole() && disc.isCompilation);
        QCOMPARE(disc.tracks.at(0).artist.name, u"X"_s);
        QCOMPARE(disc.tracks.at(1).length, -1);
    }

    void yearsAndGenres_data()
    {
        const DataRows<QByteArray, QString> row("fields", "said");
        row("of the music", ",'date':'1984','release-group':{'first-release-date':'1977-02'}",
            "1977 ");
        row("of the issue", ",'date':'1984-05-17','release-group':{'first-release-date':''}",
            "1984 ");
        row("unknown", ",'date':'?-05'", " ");
        row("no date", ",'date':null", " ");
        const QByteArray group = ",'release-group':{'genres':[{'name':'folk','count':9}]}";
        row("most votes", ",'genres':[{'name':'pop','count':1},{'name':'hip hop','count':3}]",
            " Hip-Hop");
        row("of the group", ",'genres':[]" + group, " Folk");
        row("unusual", ",'genres':[{'name':'americana'}]" + group, " Americana");
    }
    void yearsAndGenres()
    {
        QFETCH(QByteArray, fields);
        const DiscRecord disc = only(release("T", {near(0)}, fields));
        QTEST(QString(disc.year + u' ' + disc.genre), "said");
    }

    void names_data()
    {
        const DataRows<QByteArray, QString> row("credit", "name, first, last");
        row("person", credit("Bowie", ",'type':'Person','name':'X','sort-name':'Bowie, David'"),
            "Bowie|David|Bowie");
        row("person of one name", credit("Cher", ",'type':'Person','sort-name':'Cher'"), "Cher||");
        row("group", credit("Beatles", ",'type':'Group','sort-name':'Beatles, The'"), "Beatles||");
        row("not told, turned round",
            credit("David Bowie", ",'name':'David Bowie','sort-name':'Bowie, David'"),
            "David Bowie|David|Bowie");
        row("not told, a list", credit("E", ",'name':'A, B & C','sort-name':'A, B & C'"), "E||");
        row("not told, an article", credit("The Who", ",'name':'The Who','sort-name':'Who, The'"),
            "The Who||");
        row("two persons",
            "[{'name':'A','joinphrase':' feat. ','artist':{'type':'Person','sort-name':'A, B'}},"
            "{'name':'C'}]",
            "A feat. C||");
        row("control signs", credit("A\\u0000\\nB"), "A B||");
    }
    void names()
    {
        QFETCH(QByteArray, credit);
        const ArtistName artist =
            only(release("T", {near(0)}, ",'artist-credit':" + credit)).artist;
        const QString said = artist.name + u'|' + artist.first + u'|' + artist.last;
        QTEST(said, "name, first, last");
    }

    void samplersAreKnownById()
    {
        const QByteArray byId = "[{'name':'Verschiedene','artist':"
                                "{'id':'89ad4ac3-39f7-470e-963a-56509c546377'}}]";
        const QByteArray tracks = track(
            "a", 1, ",'artist-credit':[{'name':'X'}],'recording':{'first-release-date':'1965-01'}");
        const QByteArray credits = ",'artist-credit':" + byId;
        const DiscRecord disc = only(release("T", {medium(1, {tracks})}, credits));
        QVERIFY(disc.isCompilation);
        QCOMPARE(disc.tracks.at(0).artist.name, u"X"_s);
        QCOMPARE(disc.tracks.at(0).year, u"1965"_s);
        const DiscRecord other =
            only(release("T", {near(0)}, ",'artist-credit':[{'name':'Various Artists'}]"));
        QVERIFY(!other.isCompilation);
        QCOMPARE(other.tracks.at(0).artist.name, u"Various Artists"_s);
    }

    void whatIsHeard_data()
    {
        const QByteArray film = track("film", 1, ",'recording':{'video':true}");
        const QByteArray data = track("[data track]", 1), sound = track("sound", 1);
        const QByteArray pregap = ",'pregap':{'title':'hidden'},'data-tracks':[{'title':'d'}]";
        const DataRows<QByteArray, QString> row("medium", "tracks");
        row("data in front", medium(1, {data, sound}), "sound");
        row("films beside sound", medium(1, {sound, film}), "sound");
        row("films alone", medium(1, {film, film}), "film film");
        row("hidden and data", medium(1, {sound}, pregap), "sound");
        row("title of the recording", medium(1, {track("", 1, ",'recording':{'title':'r'}")}), "r");
        row("none", medium(1, {}), "");
    }
    void whatIsHeard()
    {
        QFETCH(QByteArray, medium);
        const DiscRecord disc = only(release("T", {medium}));
        QTEST(titlesOf(disc), "tracks");
        QCOMPARE(disc.isWhole(), !disc.tracks.empty());
    }

    void asksForOneMedium()
    {
        const QByteArrayList many(500, track("x", 1));
        const QByteArray answer = release("T", {medium(1, {}), medium(3, many)});
        QCOMPARE(only(answer, 3).tracks.size(), 99u); // as many as a disc has
        QVERIFY_THROWS_EXCEPTION(Error, only(answer, 2));
    }

    void wordsOfASearch()
    {
        QCOMPARE(musicBrainzQuery({u"AC/DC \"x\\"_s, u" a+b "_s, u"\n"_s}),
                 u"artist:\"AC/DC \\\"x\\\\\" AND release:\"a+b\""_s);
        QCOMPARE(musicBrainzQuery({}), QString());
    }
};

QTEST_APPLESS_MAIN(tst_MusicBrainz)
#include "tst_MusicBrainz.moc"
