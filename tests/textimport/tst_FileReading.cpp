// Label: unit
#include "platform/ado/recordset.h"
#include "support/importfixture.h"
#include "textimport/filereading.h"

#include <QDir>

/// Bytes into rows. How a reading ended is told as "read", "data LINE: reason" for a fault in the
/// data, or "not readable, LINE" for what is no such file at all.
class tst_FileReading : public QObject
{
    Q_OBJECT

private:
    QString read(char format, const QByteArray &content)
    {
        return readFile(format, writeFile(mCatalogue->path("in.txt"), content));
    }

    QString readFile(char format, const QString &file)
    {
        chooseImport(format, file);
        FileReading reading;
        reading.step = [&](qint64 done, qint64 all) {
            mLabels.append(reading.label(all ? int(done * 100 / all) : 100));
            return true;
        };
        try {
            reading.run();
            return u"read"_s;
        } catch (const DataError &error) {
            return u"data %1: %2"_s.arg(error.line).arg(error.reason);
        } catch (const std::exception &) {
            return u"not readable, %1"_s.arg(reading.lineNumber());
        }
    }

    // The row of a track in a file of compilations.
    QString track(const QByteArray &line)
    {
        const QString end = read('C', "x\n" + line + '\n');
        return end == "read"_L1 ? importRows().value(0) : end;
    }

    std::unique_ptr<TestCatalogue> mCatalogue;
    QStringList mLabels;

private slots:
    void init()
    {
        gLanguage = languageEnglish;
        mCatalogue.reset(); // first: each one holds gConnection
        mCatalogue = std::make_unique<TestCatalogue>();
        mLabels.clear();
    }

    void formats_data()
    {
        const DataRows<char, QByteArray, QStringList> row("format", "content", "rows");
        const auto rows = texts("1|Abba|S.o.s.|Pop|1975|Hits|1|1|1", "2|Blur|Song 2|||Hits|1|1|2",
                                "3|Abba|Tiger|||Hits|1|2|1");
        row("A", 'A',
            "hits\n2\n2\nabba\ns.o.s.\nPop\n1975\nblur\nsong 2\n*\n*\n1\nabba\ntiger\n\n\n", rows);
        row("B", 'B', "p\nx\n2\n1\na\nRock\n1979\n1\nb\n\n",
            texts("1|P|A|Rock|1979|X|1|1|1", "2|P|B|||X|1|2|1"));
        row("C", 'C', "hits\nabba*s.o.s.*Pop*1975\nblur*song 2**\n\nabba*tiger**\n",
            QStringList(rows).replaceInStrings(u"Hits|1|"_s, u"Hits|2|"_s));
        row("D", 'D', "p\nx\na*Rock*1979\n*\nb**\n",
            texts("1|P|A|Rock|1979|X|2|1|1", "2|P|B|||X|2|2|1"));
        row("A, two CDs, a disc of no tracks", 'A', "x\n3\n0\n-1\n1\na\nb\n\n\ny\n1\n1\nc\nd\n\n\n",
            texts("1|A|B|||X|1|3|1", "2|C|D|||Y|2|1|1"));
        row("A, no disc is one disc", 'A', "x\n0\n1\na\nb\n\n\n", texts("1|A|B|||X|1|1|1"));
        row("A, counts that are rounded", 'A', "x\n 1e0 \n2.5\na\nb\n\n\nc\nd\n\n\n",
            texts("1|A|B|||X|1|1|1", "2|C|D|||X|1|1|2"));
        row("B, a new artist for each CD", 'B', "p\nx\n1\n1\na\n\n\nq\ny\n1\n1\nb\n\n\n",
            texts("1|P|A|||X|1|1|1", "2|Q|B|||Y|2|1|1"));
        row("C, the same title twice is one CD", 'C', "x\na*b**\nx\nc*d**\n",
            texts("1|A|B|||X|2|1|1", "2|C|D|||X|2|1|2"));
        row("C, titles are compared exactly", 'C', "x\na*b**\nX\nc*d**\n",
            texts("1|A|B|||X|2|1|1", "2|C|D|||X|3|1|1"));
        row("C, ends of discs before, between and twice", 'C',
            "*\n\nx\na*b**\n*\n\nc*d**\n*\ny\ne*f**\n",
            texts("1|A|B|||X|2|1|1", "2|C|D|||X|2|3|1", "3|E|F|||Y|3|1|1"));
        row("D, the same title by another artist is one CD", 'D', "p\nx\na**\nq\nx\nb**\n",
            texts("1|P|A|||X|2|1|1", "2|Q|B|||X|2|1|2"));
    }

    void formats()
    {
        QFETCH(char, format);
        QFETCH(QByteArray, content);
        QCOMPARE(read(format, content), u"read"_s);
        QTEST(importRows(), "rows");
    }

    void faults_data()
    {
        const DataRows<char, QByteArray, QString> row("format", "content", "end");
        const char *number = "data 2: Number expected but not found!";
        row("A, count in words", 'A', "x\ntwo\n", number);
        row("A, count beyond all bounds", 'A', "x\n1e999\n", "data 2: The number is too large!");
        row("A, too many discs", 'A', "x\n10000\n", "data 2: The number is too large!");
        row("A, as many as there may be", 'A', "x\n9999\n",
            "data 3: Number expected but not found!");
        row("A, tracks beyond 32 bits", 'A', "x\n1\n2147483648\n",
            "data 3: The number is too large!");
        row("C, too many discs", 'C', "x\na*b**\n" + QByteArray(9999, '\n') + "c*d**\n",
            "data 10002: The number is too large!");
        row("C, of another title", 'C', "x\na*b**\n" + QByteArray(9999, '\n') + "y\n*d**\n",
            "data 10003: Found empty line, whereas artist is obligatory!");
        row("A, second count", 'A', "x\n1\n1 track\n", "data 3: Number expected but not found!");
        row("A, empty line at the end", 'A', "x\n1\n1\na\nb\n\n\n\n",
            "data 8: Found empty line, whereas title is obligatory!");
        row("A, no artist", 'A', "x\n1\n1\n\nb\n\n\n",
            "data 4: Found empty line, whereas artist is obligatory!");
        row("A, ends before the second disc", 'A', "x\n2\n1\na\nb\n\n\n",
            "data 8: Number expected but not found!");
        row("A, year", 'A', "x\n1\n1\na\nb\n\n1900\n", "data 7: Invalid year found!");
        row("B, no artist", 'B', "\nx\n",
            "data 1: Found empty line, whereas artist is obligatory!");
        row("B, no title", 'B', "p\nx\n1\n1\n\n",
            "data 5: Found empty line, whereas title is obligatory!");
        row("C, no artist", 'C', "x\n\n*b**\n",
            "data 3: Found empty line, whereas artist is obligatory!");
        row("C, no main title", 'C', "a*b**\n",
            "data 1: Found empty line, whereas title is obligatory!");
        row("C, artist before main title", 'C', "*b**\n",
            "data 1: Found empty line, whereas artist is obligatory!");
        row("C, two stars and no artist", 'C', "x\n*b*\n", "not readable, 2");
        row("C, a fourth star", 'C', "x\na*b*c*1985*\n", "data 2: Invalid year found!");
        row("C, titles alone", 'C', "x\ny\nz\n", "not readable, 3");
        row("D, no album title", 'D', "p\n\na*b*1985\n",
            "data 3: Found empty line, whereas title is obligatory!");
        row("D, a star in the album title", 'D', "p\nx*y\n",
            "data 2: Hoofdtitel mag het teken * niet bevatten!");
        row("D, an artist at the end", 'D', "p", "not readable, 2");
        row("binary", 'A', "\x89PNG\r\n\x1a\n\x01\xff\xfe", number);
    }

    void faults()
    {
        QFETCH(char, format);
        QFETCH(QByteArray, content);
        QTEST(read(format, content), "end");
    }

    void fields_data()
    {
        const DataRows<QString, QString> row("artist", "kept");
        const auto as = [](int n) { return QString(n, u'a'); };
        row("capitals", "AC/DC  the ÉCOLE", "Ac/dc  The École");
        row("capitals of two units", "𐐨𐐨 ßa", "𐐀𐐨 ßa");
        row("double quotes", "\"a\" b\"", "''a'' B''");
        row("256 characters", as(256), u'A' + as(254));
        row("cut before quotes are doubled", as(254) + u"\"\""_s, u'A' + as(253) + u"''"_s);
        row("a pair at the cut", as(254) + u"😀"_s, u'A' + as(253));
        row("a pair before the cut", as(253) + u"😀x"_s, u'A' + as(252) + u"😀"_s);
    }

    void fields()
    {
        QFETCH(QString, artist);
        QFETCH(QString, kept);
        QCOMPARE(track(artist.toUtf8() + "*t**"), u"1|"_s + kept + u"|T|||X|2|1|1"_s);
    }

    void filesThatGiveNothing()
    {
        writeFile(mCatalogue->path("empty.txt"), {});
        writeFile(mCatalogue->path("mark.txt"), "\xEF\xBB\xBF");
        QDir().mkpath(mCatalogue->path("folder.txt"));
        read('C', "x\na*b**\n"); // must not be seen again
        for (const char format : {'A', 'B', 'C', 'D'}) {
            for (const char *name : {"missing.txt", "empty.txt", "mark.txt"})
                QCOMPARE(readFile(format, mCatalogue->path(name)), u"read"_s);
            QCOMPARE(readFile(format, mCatalogue->path("folder.txt")), u"not readable, 0"_s);
            QVERIFY(importRows().isEmpty());
        }
    }

    // The word behind the percentage is Dutch in both languages, except where a reader takes it
    // from the table.
    void progress()
    {
        read('B', "p\nx\n1\n1\na\n\n\n1");
        QCOMPARE(mLabels.first(9),
                 texts("0% ingelezen", "12% ingelezen", "25% ingelezen", "37% ingelezen",
                       "50% ingelezen", "62% read", "75% read", "87% read", "100% ingelezen"));
    }
};

QTEST_MAIN(tst_FileReading)
#include "tst_FileReading.moc"
