// Label: unit
#include "discs/xmcd.h"
#include "platform/error/error.h"
#include "support/datarows.h"

namespace
{

const QByteArray head =
    "# xmcd\n# Track frame offsets:\n#\t150\n#   7650 \n#\n# Disc length: 202 s\n# Revision: 4\n";

DiscRecord read(const QByteArray &lines)
{
    return readXmcd(head + lines).disc;
}

// "artist: title" of each track.
QString creditsOf(const DiscRecord &disc)
{
    QStringList all;
    for (const TrackRecord &track : disc.tracks)
        all << track.artist.name + u": "_s + track.title;
    return all.join(u'|');
}

TableOfContents tocOf(std::size_t tracks)
{
    TableOfContents toc;
    for (std::size_t i = 0; i < tracks; ++i)
        toc.tracks.push_back({int(150 + i * 7500)});
    toc.leadOut = int(150 + tracks * 7500);
    return toc;
}

} // namespace

/// Records of CDDB servers: what is read, and what is sent.
class tst_Xmcd : public QObject
{
    Q_OBJECT

private slots:
    void text_data()
    {
        const DataRows<QByteArray, QString> row("lines", "title");
        row("plain", "DTITLE=A / Title", "Title");
        row("line ends of Windows", "DTITLE=A / Title\r\nDYEAR=\r\n", "Title");
        row("goes on in a word", "DTITLE=A / Ti\nDYEAR=1999\nDTITLE=tle\n", "Title");
        row("goes on in an escape", "DTITLE=A / T\\\nDTITLE=nle\n", "T le");
        row("goes on in a letter", "DTITLE=A / Caf\xC3\nDTITLE=\xA9\n", "Café");
        row("escapes", "DTITLE=A / a\\tb\\nc\\\\nd\\x\\\n", "a b c\\nd\\x\\");
        row("code page", "DTITLE=A / Caf\xE9 \x93x\x94\n", "Café “x”");
        row("code page of another line", "DTITLE=A / \xC3\xA9\nTTITLE0=\xE9\n", "Ã©");
        row("signs of control", QByteArray("DTITLE=A / a\x01\x7F\0c\n", 17), "ac");
        row("signs of direction", "DTITLE=A / \u202Ea\u202C \u2067b\u2069\n", "a b");
        row("no sign", "DTITLE=x=y\n", "x=y");
        row("a sign without blanks", "DTITLE=A/B / C / D\n", "C / D");
        row("byte order mark", "DTITLE=A / \xEF\xBB\xBFTitle\n", "Title");
    }
    void text()
    {
        QFETCH(QByteArray, lines);
        QTEST(read(lines).title, "title");
    }

    void yearAndGenre_data()
    {
        const DataRows<QByteArray, QString> row("lines", "said");
        row("own keys", "DYEAR=1984\nDGENRE=Folk\nEXTD=YEAR: 1978 ID3G: 17\n", "1984 Folk");
        row("in the notes", "EXTD= YEAR: 1978 ID3G: 17\n", "1978 Rock");
        row("in the notes, first of the table", "EXTD=ID3G:  0\n", " Blues");
        row("above the table", "EXTD=ID3G: 255\n", " ");
        row("a part of it each", "DGENRE=x\nDYEAR=\nEXTD=YEAR: 1978 ID3G: 17\n", "1978 x");
        row("other numbers", "EXTD=MIDYEAR: 1978 YEAR: 19789\nDYEAR=0\n", " ");
        row("not a year", "DYEAR=199\n", " ");
    }
    void yearAndGenre()
    {
        QFETCH(QByteArray, lines);
        const DiscRecord disc = read("DTITLE=A / B\n" + lines);
        QTEST(QString(disc.year + u' ' + disc.genre), "said");
    }

    void comments_data()
    {
        const DataRows<QByteArray, QByteArray> row("head", "offsets and lengths");
        row("as usual", head, "150 7650 | 100000 100000 | 202 4");
        row("fall", "# Track frame offsets:\n#150\n#150\n# Disc length: 20\n", "| -1 -1 | 20 0");
        row("no length", "# Track frame offsets:\n#\n# 150\n# 900\n", "150 900 | 10000 -1 | 0 0");
        row("endless", "# Track frame offsets:\n#99999999999\n# Revision: 99999999999\n",
            "| -1 -1 | 0 0");
        row("numbers elsewhere", "# xmcd\n# 150\n# Track frame offsets: \n#\n#200\n#\n#300\n",
            "200 | -1 -1 | 0 0");
    }
    void comments()
    {
        QFETCH(QByteArray, head);
        const XmcdRecord got = readXmcd(head + "DTITLE=A / B\nTTITLE0=a\nTTITLE1=b\n");
        QByteArray said;
        for (const int offset : got.offsets)
            said += QByteArray::number(offset) + ' ';
        said += "| ";
        for (const TrackRecord &track : got.disc.tracks)
            said += QByteArray::number(track.length) + ' ';
        said += "| " + QByteArray::number(got.seconds) + ' ';
        said += QByteArray::number(got.disc.revision);
        QTEST(said, "offsets and lengths");
    }

    void tracks()
    {
        const DiscRecord disc =
            read("DISCID=0200c902,, 0300c903\nDTITLE=A / B\nTTITLE01=x\nTTITLE1=b\nTTITLEx=y\n"
                 "EXTT0=note\nTTITLE=z\nPLAYORDER=2,1\n");
        QCOMPARE(creditsOf(disc), u"A: |A: xb"_s);
        QCOMPARE(disc.tracks[0].notes, u"note"_s);
        QCOMPARE(disc.discIds, texts("0200c902", "0300c903"));
        QCOMPARE(read("TTITLE98=last\n").tracks.size(), 99u);
        QCOMPARE(read("DTITLE=A / B\nEXTT99999=x\n").tracks.size(), 2u);
    }

    void refused_data()
    {
        const DataRows<QByteArray> row("record");
        row("empty", "");
        row("head alone", head);
        row("untitled", "DTITEL=x\nTTITLE0=\n");
        row("above 99", "DTITLE=A / B\nTTITLE99=x\n");
        row("far above", "DTITLE=A / B\nTTITLE99999999999=x\n");
    }
    void refused()
    {
        QFETCH(QByteArray, record);
        QVERIFY_THROWS_EXCEPTION(Error, readXmcd(record));
    }

    void samplers_data()
    {
        const DataRows<QByteArray, bool, QString> row("lines", "compilation", "credits");
        row("by name", "DTITLE=Various / T\nTTITLE0=X / a / b\nTTITLE1=c\n", true, "X: a / b|: c");
        row("in Dutch, hyphens", "DTITLE=Diverse artiesten / T\nTTITLE0=X - a\nTTITLE1=Y - b\n",
            true, "X: a|Y: b");
        row("by its titles", "DTITLE=T\nTTITLE0=X / a\nTTITLE1=Y / b\nTTITLE2=Z / c\n", true,
            "X: a|Y: b|Z: c");
        row("movements", "DTITLE=A / T\nTTITLE0=X / a\nTTITLE1=X / b\nTTITLE2=X / c\n", false,
            "A: X / a|A: X / b|A: X / c");
        row("an album", "DTITLE=A / T\nTTITLE0=a\nTTITLE1=b - c\n", false, "A: a|A: b - c");
    }
    void samplers()
    {
        QFETCH(QByteArray, lines);
        const DiscRecord disc = read(lines);
        QTEST(disc.isCompilation, "compilation");
        QTEST(creditsOf(disc), "credits");
    }

    void isTheSameWhenReadAgain_data()
    {
        const QString thousand = QString(400, u'€') + u"\\" + QString(300, u'x');
        const DataRows<QString, QString, bool> row("artist", "title", "compilation");
        row("escapes", "A\\n", "B\\\\", false);
        row("long", thousand, thousand, false);
        row("sampler", "Various", "B / C", true);
        row("letters of two units", QString(200, u'x') + u"\U0001F3B5\U0001F3B5", "音楽", false);
    }
    void isTheSameWhenReadAgain()
    {
        QFETCH(QString, artist);
        QFETCH(QString, title);
        QFETCH(bool, compilation);
        DiscRecord disc = read("DISCID=0500c802\nDYEAR=1999\nDGENRE=Folk\nTTITLE1=x\n");
        disc.artist.name = artist;
        disc.title = title;
        disc.isCompilation = compilation;
        disc.numberInSet = u"2"_s;
        disc.totalInSet = u"3"_s;
        disc.tracks[0].title = title;
        disc.tracks[0].notes = artist;
        disc.notes = title;
        for (TrackRecord &track : disc.tracks)
            track.artist.name = compilation ? u"X"_s : artist;
        const QByteArray sent = writeXmcd(disc, tocOf(2), u"Songcase"_s, u"1.0"_s);
        for (const QByteArray &line : sent.split('\n'))
            QVERIFY(line.size() < 256);
        QCOMPARE(readXmcd(sent).disc, disc);
        QVERIFY(sent.endsWith("\nPLAYORDER=\n"));
    }

    void notSent_data()
    {
        const DataRows<QString, QString, QString, QByteArray> row("artist", "title", "track",
                                                                  "why");
        row("fine", "A", "B", "c", "");
        row("no artist", " ", "B", "c", "xNotSentArtist");
        row("no title", "A", "\u202E \n", "c", "xNotSentTitle");
        row("untitled", "A", "B", "Track 01", "xNotSentUntitled");
        row("a number for a title", "A", "B", "1999", "");
        row("titled like it", "A", "B", "Track of my tears", "");
    }
    void notSent()
    {
        QFETCH(QString, artist);
        QFETCH(QString, title);
        QFETCH(QString, track);
        DiscRecord disc;
        disc.artist.name = artist;
        disc.title = title;
        disc.tracks.resize(1);
        disc.tracks[0].title = track;
        QTEST(QByteArray(notToBeSent(disc, tocOf(1))), "why");
        QCOMPARE(notToBeSent(disc, tocOf(2)), "xNotSentTracks");
    }
};

QTEST_APPLESS_MAIN(tst_Xmcd)
#include "tst_Xmcd.moc"
