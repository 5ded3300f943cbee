// Label: unit
#include "discs/candidates.h"
#include "discs/discid.h"
#include "discs/genretable.h"
#include "discs/partofset.h"
#include "discs/recordjson.h"
#include "support/datarows.h"

namespace
{

// "150 450D 13800": offsets, data tracks marked, and the lead-out.
TableOfContents tocOf(const QString &text)
{
    TableOfContents toc;
    QStringList words = text.split(u' ');
    toc.leadOut = words.takeLast().toInt();
    for (const QString &word : words)
        toc.tracks.push_back({word.chopped(word.endsWith(u'D')).toInt(), word.endsWith(u'D')});
    return toc;
}

} // namespace

/// What both services' records are made of: ids, numbers of a set, genres, repeats, kept answers.
class tst_DiscValues : public QObject
{
    Q_OBJECT

private slots:
    // The ids are those that the libraries of both services give.
    void ids_data()
    {
        const DataRows<QString, QString, QString> row("table", "cddb", "musicBrainz");
        row("sound", "150 7500 20000 30000", "11018e03", "d2r1HCj07OMbkQ6VHBNvH2EWQTk-");
        row("one long track", "150 390000", "02144e01", "GiRcnSBs9dRAybu1cJ2n6T1vzM4-");
        row("seconds are cut", "224 7574 15074", "0300c602", "Ppdtq5gsebEc1Jp872qJx13pvjc-");
        row("data in front", "150D 7500 20000", "03010802", "22qM3RW0tfdqLBmZqJderAfNSF8-");
        row("data behind", "150 7500 30000D 40000", "07021303", "SQol_sC2TDmCxwVxlV18iu0tDrU-");
        row("data behind, offsets that cannot be", "150 7500 19000 30000D 40000", "11021304",
            "n2ZVbSfoz91d5d1MtNNbgnG6zjY-");
    }
    void ids()
    {
        QFETCH(QString, table);
        QTEST(cddbId(tocOf(table)), "cddb");
        QTEST(musicBrainzId(tocOf(table)), "musicBrainz");
    }

    void questions()
    {
        const TableOfContents toc = tocOf(u"150 450 13800D 20000"_s);
        QCOMPARE(cddbQuery(toc), cddbId(toc) + u" 3 150 450 13800 266"_s);
        QCOMPARE(musicBrainzToc(toc), u"1 2 2400 150 450"_s);
        QCOMPARE(cddbId({}) + musicBrainzId({}), QString());
    }

    void partsOfSets_data()
    {
        const DataRows<QString, QString, QString> row("title", "notes", "part");
        row("Title", "", "1/1 Title");
        row("Title (Disc 2 of 3)", "", "2/3 Title");
        row("Title [CD 2]", "", "2/2 Title");
        row("Title CD2", "", "2/2 Title");
        row("Title, Disc Two", "", "2/2 Title");
        row("Title (2/3)", "", "2/3 Title");
        row("Titel (schijf 2 van de 3)", "", "2/3 Titel");
        row("Titel - CD 1 van 2", "", "1/2 Titel");
        row("Titel (CD Zwei von Drei)", "", "2/3 Titel");
        row("Titre (disque 1 sur 2)", "", "1/2 Titre");
        row("Title (Disc 2: The Name)", "", "2/2 Title (Disc 2: The Name)");
        row("Disc 2", "", "2/2 Disc 2");
        row("Title (Disc 3 of 2)", "", "3/3 Title");
        row("said in the notes", "Title", "This is CD 2 of 4.", "2/4 Title");
        row("any number in the notes", "Title", "Track 2 of 4 from CD 3", "1/1 Title");
        row("Discovery 2", "", "1/1 Discovery 2");
        row("Title (Disc 0 of 0)", "", "1/1 Title (Disc 0 of 0)");
        row("Love of 3 Oranges", "", "1/1 Love of 3 Oranges");
        row("very long", QString(2000, u'(') + u"Disc 2", "",
            u"1/1 "_s + QString(2000, u'(') + u"Disc 2");
    }
    void partsOfSets()
    {
        QFETCH(QString, title);
        QFETCH(QString, notes);
        const PartOfSet part = partOfSet(title, notes);
        const QString said = part.number + u'/' + part.total + u' ' + part.title;
        QTEST(said, "part");
    }

    void genres()
    {
        GenreTable table;
        const QString rock = table.idOf(u" rock"_s);
        QCOMPARE(rock, u"17"_s);
        const QString own = table.idOf(u"Polder Blues"_s);
        QCOMPARE(table.idOf(u"POLDER BLUES"_s), own);
        QCOMPARE(table.nameOf(own), u"Polder Blues"_s);
        QVERIFY(table.idOf(u" "_s).isEmpty());
        for (const char *number : {"", "-1", "x", "99999999999"})
            QVERIFY(table.nameOf(QString::fromLatin1(number)).isEmpty());
        for (const QString &name : table.usualNames())
            QCOMPARE(table.nameOf(table.idOf(name)), name);
        QCOMPARE(genreAsWritten(u"drum and bass"_s), u"Drum & Bass"_s);
        QCOMPARE(genreAsWritten(u"écossais"_s), u"Écossais"_s);
        QCOMPARE(id3GenreName(-1) + id3GenreName(255), QString());
    }

    void cleanTexts_data()
    {
        const DataRows<QString, QString> row("foreign", "clean");
        row("ends", u" \ta\n"_s, "a");
        row("line ends", u"a\r\nb\u2028c"_s, "a b c");
        row("control", u"a\u0000\u009Fb"_s, "ab");
        row("half a letter", u"a"_s + QChar(0xD83C) + u"b"_s + QChar(0xDFB5), "ab");
        row("a letter of two", u"\U0001F3B5\n"_s, "\U0001F3B5");
        row("mark at the start", u"\uFEFFa"_s, "a");
        row("turned round", u"a\u202Eb\u2066c"_s, "abc");
        row("joined", u"क्\u200Dष"_s, "क्\u200Dष");
    }
    void cleanTexts()
    {
        QFETCH(QString, foreign);
        QTEST(cleanText(foreign), "clean");
    }

    void variousArtists()
    {
        for (const QString &name : texts("Various", "V.A.", "Diverse Künstler", "Artistes variés"))
            QVERIFY2(isVariousArtists(name), qPrintable(name));
        for (const QString &name : texts("", "Various Cruelties", "Sampler Sam"))
            QVERIFY2(!isVariousArtists(name), qPrintable(name));
    }

    void repeats()
    {
        DiscRecord disc, typed, hidden, other;
        disc.title = u"Ain’t – it…"_s;
        typed.title = u"Ain't - it..."_s;
        hidden = disc;
        hidden.discIds = texts("1b03cb03");
        other = disc;
        other.tracks.resize(1);
        const auto kept = withoutRepeats({disc, typed, hidden, other});
        QCOMPARE(kept.size(), 2u);
        QCOMPARE(kept[0], disc);
        QCOMPARE(kept[1], other);
    }

    void keptAnswers()
    {
        DiscRecord disc;
        disc.title = u"Café \"\n\u0000"_s;
        disc.tracks = {{u"a"_s, {u"X Y"_s, u"X"_s, u"Y"_s}, u"1999"_s, u"Rock"_s, u"n"_s, -1}};
        disc.discIds = texts("a", "b");
        const QByteArray json = toJson({disc, {}});
        QCOMPARE(recordsFromJson(json).value(), (std::vector<DiscRecord>{disc, {}}));
        QVERIFY(recordsFromJson(toJson({})).value().empty());
        for (qsizetype size = 0; size < json.size(); ++size)
            QVERIFY2(!recordsFromJson(json.first(size)), qPrintable(QString::number(size)));
    }

    void damagedAnswers_data()
    {
        const DataRows<QByteArray, QByteArray> row("part", "instead");
        row("\"version\":1", "\"version\":2");
        row("\"title\"", "\"titel\"");
        row("\"tracks\":[]", "\"tracks\":[null]");
        row("\"discIds\":[\"a\"]", "\"discIds\":[7]");
        row("\"isCompilation\":false", "\"isCompilation\":0");
        row("\"revision\":-1", "\"revision\":1.5");
        row("\"trackCount\":0", "\"trackCount\":1e99");
        row("no number", "\"trackCount\":0", "\"trackCount\":\"0\"");
    }
    void damagedAnswers()
    {
        QFETCH(QByteArray, part);
        QFETCH(QByteArray, instead);
        DiscRecord disc;
        disc.discIds = texts("a");
        QByteArray json = toJson({disc});
        QVERIFY(json.contains(part));
        QVERIFY(!recordsFromJson(json.replace(part, instead)));
    }
};

QTEST_APPLESS_MAIN(tst_DiscValues)
#include "tst_DiscValues.moc"
