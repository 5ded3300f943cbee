// Label: unit
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/importfixture.h"
#include "support/testcatalogue.h"
#include "textimport/filereading.h"

#include <QDir>
#include <QTest>

/// Bytes into rows. How a reading ended is told as "read", "data LINE: reason" for a fault in the
/// data, or "not readable, LINE" for what is no such file at all.
class tst_FileReading : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void formats_data();
    void formats();
    void faults_data();
    void faults();
    void fields_data();
    void fields();
    void years_data();
    void years();
    void encodings_data();
    void encodings();
    void idsFollowTheCatalogue();
    void filesThatGiveNothing_data();
    void filesThatGiveNothing();
    void oneLineOfMegabytes();
    void rowsBeforeAFaultAreKept();
    void progress_data();
    void progress();
    void fields_areThoseOfTheTable();

private:
    QString read(char format, const QByteArray &content);
    QString readFile(char format, const QString &file);
    QString track(const QByteArray &line);

    std::unique_ptr<TestCatalogue> mCatalogue;
    QStringList mLabels;
};

void tst_FileReading::init()
{
    gLanguage = languageEnglish;
    mCatalogue.reset(); // first: each one holds gConnection
    mCatalogue = std::make_unique<TestCatalogue>();
    mLabels.clear();
}

QString tst_FileReading::read(char format, const QByteArray &content)
{
    return readFile(format, writeFile(mCatalogue->path(QStringLiteral("in.txt")), content));
}

QString tst_FileReading::readFile(char format, const QString &file)
{
    chooseImport(format, file);
    FileReading reading;
    reading.show = [this](int, const QString &label) { mLabels.append(label); };
    try {
        reading.run();
        return QStringLiteral("read");
    } catch (const DataError &error) {
        return QStringLiteral("data %1: %2").arg(error.line).arg(error.reason);
    } catch (const std::exception &) {
        return QStringLiteral("not readable, %1").arg(reading.lineNumber());
    }
}

void tst_FileReading::formats_data()
{
    QTest::addColumn<char>("format");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QStringList>("rows");
    const QStringList best = texts("1|Dire Straits|Walk Of Life|Rock|1985|The Best Of 1985|1|1|1",
                                   "2|A-ha|Take On Me|||The Best Of 1985|1|1|2",
                                   "3|Dosikfu|Into The Groove|Pop|1985|The Best Of 1985|1|2|1");
    const QStringList wall = texts("1|Pink Floyd|In The Flesh?|Rock|1979|The Wall|2|1|1",
                                   "2|Pink Floyd|The Thin Ice|Rock|1979|The Wall|2|1|2",
                                   "3|Pink Floyd|Hey You|Rock|1979|The Wall|2|2|1");
    QTest::newRow("A") << 'A'
                       << QByteArray("The Best Of 1985\n2\n2\nDire Straits\nWalk Of Life\nRock\n"
                                     "1985\nA-Ha\nTake On Me\n*\n*\n1\nDosikfu\nInto The Groove\n"
                                     "Pop\n1985\n")
                       << best;
    QTest::newRow("B") << 'B'
                       << QByteArray("Pink Floyd\nThe Wall\n2\n2\nIn The Flesh?\nRock\n1979\n"
                                     "The Thin Ice\nRock\n1979\n1\nHey You\nRock\n1979")
                       << QStringList(wall)
                              .replaceInStrings(QStringLiteral("|2|1|"), QStringLiteral("|1|1|"))
                              .replaceInStrings(QStringLiteral("|2|2|"), QStringLiteral("|1|2|"));
    QTest::newRow("C") << 'C'
                       << QByteArray("The Best Of 1985\nDire Straits*Walk Of Life*Rock*1985\n"
                                     "A-Ha*Take On Me**\n\nDosikfu*Into The Groove*Pop*1985\n")
                       << QStringList(best).replaceInStrings(QStringLiteral("1985|1|"),
                                                             QStringLiteral("1985|2|"));
    QTest::newRow("D") << 'D'
                       << QByteArray("Pink Floyd\nThe Wall\nIn The Flesh?*Rock*1979\n"
                                     "The Thin Ice*Rock*1979\n*\nHey You*Rock*1979\n")
                       << wall;
    QTest::newRow("A, two CDs, a disc of no tracks")
        << 'A' << QByteArray("x\n3\n0\n-1\n1\na\nb\n\n\ny\n1\n1\nc\nd\n\n\n")
        << texts("1|A|B|||X|1|3|1", "2|C|D|||Y|2|1|1");
    QTest::newRow("A, no disc is one disc")
        << 'A' << QByteArray("x\n0\n1\na\nb\n\n\n") << texts("1|A|B|||X|1|1|1");
    QTest::newRow("A, counts that are rounded")
        << 'A' << QByteArray("x\n 1e0 \n2.5\na\nb\n\n\nc\nd\n\n\n")
        << texts("1|A|B|||X|1|1|1", "2|C|D|||X|1|1|2");
    QTest::newRow("B, a new artist for each CD")
        << 'B' << QByteArray("p\nx\n1\n1\na\n\n\nq\ny\n1\n1\nb\n\n\n")
        << texts("1|P|A|||X|1|1|1", "2|Q|B|||Y|2|1|1");
    QTest::newRow("C, the same title twice is one CD")
        << 'C' << QByteArray("x\na*b**\nx\nc*d**\n") << texts("1|A|B|||X|2|1|1", "2|C|D|||X|2|1|2");
    QTest::newRow("C, titles are compared exactly")
        << 'C' << QByteArray("x\na*b**\nX\nc*d**\n") << texts("1|A|B|||X|2|1|1", "2|C|D|||X|3|1|1");
    QTest::newRow("C, ends of discs before, between and twice")
        << 'C' << QByteArray("*\n\nx\na*b**\n*\n\nc*d**\n*\ny\ne*f**\n")
        << texts("1|A|B|||X|2|1|1", "2|C|D|||X|2|3|1", "3|E|F|||Y|3|1|1");
    QTest::newRow("D, the same title by another artist is one CD")
        << 'D' << QByteArray("p\nx\na**\nq\nx\nb**\n")
        << texts("1|P|A|||X|2|1|1", "2|Q|B|||X|2|1|2");
}

void tst_FileReading::formats()
{
    QFETCH(char, format);
    QFETCH(QByteArray, content);
    QCOMPARE(read(format, content), QStringLiteral("read"));
    QTEST(importRows(), "rows");
}

void tst_FileReading::faults_data()
{
    QTest::addColumn<char>("format");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QString>("end");
    const auto row = [](const char *name, char format, const char *content, const char *end) {
        QTest::newRow(name) << format << QByteArray(content) << QString::fromUtf8(end);
    };
    const char *number = "data 2: Number expected but not found!";
    row("A, count in words", 'A', "x\ntwo\n", number);
    row("A, count empty", 'A', "x\n", number);
    row("A, count beyond all bounds", 'A', "x\n1e300\n", "not readable, 2");
    row("A, count beyond 32 bits", 'A', "x\n2147483648\n", "not readable, 2");
    row("A, second count", 'A', "x\n1\n1 track\n", "data 3: Number expected but not found!");
    row("A, empty line at the end", 'A', "x\n1\n1\na\nb\n\n\n\n",
        "data 8: Found empty line, whereas title is obligatory!");
    row("A, no artist", 'A', "x\n1\n1\n\nb\n\n\n",
        "data 4: Found empty line, whereas artist is obligatory!");
    row("A, no title", 'A', "x\n1\n1\na\n\n\n\n",
        "data 5: Found empty line, whereas title is obligatory!");
    row("A, ends behind a title", 'A', "x\n1\n2\na\nb\n",
        "data 8: Found empty line, whereas artist is obligatory!");
    row("A, ends before the second disc", 'A', "x\n2\n1\na\nb\n\n\n",
        "data 8: Number expected but not found!");
    row("A, year", 'A', "x\n1\n1\na\nb\n\n1900\n", "data 7: Invalid year found!");
    row("B, no artist", 'B', "\nx\n", "data 1: Found empty line, whereas artist is obligatory!");
    row("B, no album title", 'B', "p\n", "data 2: Found empty line, whereas title is obligatory!");
    row("B, no title", 'B', "p\nx\n1\n1\n\n",
        "data 5: Found empty line, whereas title is obligatory!");
    row("C, no artist", 'C', "x\n\n*b**\n",
        "data 3: Found empty line, whereas artist is obligatory!");
    row("C, no title", 'C', "x\na***\n", "data 2: Found empty line, whereas title is obligatory!");
    row("C, no main title", 'C', "a*b**\n",
        "data 1: Found empty line, whereas title is obligatory!");
    row("C, artist before main title", 'C', "*b**\n",
        "data 1: Found empty line, whereas artist is obligatory!");
    row("C, two stars", 'C', "x\na*b*c\n", "not readable, 2");
    row("C, two stars and no artist", 'C', "x\n*b*\n", "not readable, 2");
    row("C, a fourth star", 'C', "x\na*b*c*1985*\n", "data 2: Invalid year found!");
    row("C, titles alone", 'C', "x\ny\nz\n", "not readable, 3");
    row("D, no artist", 'D', "a*b*1985\n",
        "data 1: Found empty line, whereas artist is obligatory!");
    row("D, no album title", 'D', "p\n\na*b*1985\n",
        "data 3: Found empty line, whereas title is obligatory!");
    row("D, a star in the album title", 'D', "p\nx*y\n",
        "data 2: Hoofdtitel mag het teken * niet bevatten!");
    row("D, a star as the album title", 'D', "p\n*\n",
        "data 2: Hoofdtitel mag het teken * niet bevatten!");
    row("D, an artist at the end", 'D', "p", "not readable, 2");
    row("D, one star", 'D', "p\nx\na*b\n", "not readable, 3");
    row("A read as C", 'C', "x\n1\n1\na\nb\nRock\n1985\n", "not readable, 7");
    row("binary", 'A', "\x89PNG\r\n\x1a\n\x01\xff\xfe", number);
}

void tst_FileReading::faults()
{
    QFETCH(char, format);
    QFETCH(QByteArray, content);
    QTEST(read(format, content), "end");
}

// The row of a track in a file of compilations.
QString tst_FileReading::track(const QByteArray &line)
{
    const QString end = read('C', "x\n" + line + '\n');
    return end == QLatin1String("read") ? importRows().value(0) : end;
}

void tst_FileReading::fields_data()
{
    QTest::addColumn<QString>("artist");
    QTest::addColumn<QString>("kept");
    const auto row = [](const char *name, const QString &artist, const QString &kept) {
        QTest::newRow(name) << artist << kept;
    };
    const auto as = [](int n) { return QString(n, u'a'); };
    row("capitals", QStringLiteral("AC/DC  the ÉCOLE"), QStringLiteral("Ac/dc  The École"));
    row("words part at blanks alone", QStringLiteral("o'neal-smith\tx.y"),
        QStringLiteral("O'neal-smith\tX.y"));
    row("no letter turns into two", QStringLiteral("ßtraße"), QStringLiteral("ßtraße"));
    row("double quotes", QStringLiteral("\"a\" b\""), QStringLiteral("''a'' B''"));
    row("255 characters", as(255), QLatin1Char('A') + as(254));
    row("256 characters", as(256), QLatin1Char('A') + as(254));
    row("cut before quotes are doubled", as(254) + QStringLiteral("\"\""),
        QLatin1Char('A') + as(253) + QStringLiteral("''"));
    row("a pair at the cut", as(254) + QString::fromUtf8("😀"), QLatin1Char('A') + as(253));
    row("a pair before the cut", as(253) + QString::fromUtf8("😀x"),
        QLatin1Char('A') + as(252) + QString::fromUtf8("😀"));
    row("capitals of two units", QString::fromUtf8("𐐨𐐨 𐐨"), QString::fromUtf8("𐐀𐐨 𐐀"));
}

void tst_FileReading::fields()
{
    QFETCH(QString, artist);
    QFETCH(QString, kept);
    QCOMPARE(track(artist.toUtf8() + "*t**"),
             QStringLiteral("1|") + kept + QStringLiteral("|T|||X|2|1|1"));
}

void tst_FileReading::years_data()
{
    QTest::addColumn<QByteArray>("year");
    QTest::addColumn<bool>("accepted");
    const auto row = [](const char *year, bool accepted) {
        QTest::newRow(year) << QByteArray(year) << accepted;
    };
    for (const char *good : {"1901", "9999", "2e03", " 2e3", "2.e3", "1e99", "+2e3"})
        row(good, true);
    for (const char *bad :
         {"1900", "0000", "19", "01985", "198x", "-2e3", "19.5", "*", "1985 ", "2e-3", "    "})
        row(bad, false);
}

void tst_FileReading::years()
{
    QFETCH(QByteArray, year);
    QFETCH(bool, accepted);
    const QString kept = QStringLiteral("1|A|B||") + QString::fromLatin1(year);
    QCOMPARE(track("a*b**" + year.mid(year == "*")).startsWith(kept), accepted);
}

void tst_FileReading::encodings_data()
{
    QTest::addColumn<QByteArray>("content");
    const QByteArray utf8 = "Été\nÉdith*Œuvre*Chanson*1960\n";
    const QByteArray codePage = "\xC9t\xE9\n\xC9"
                                "dith*\x8Cuvre*Chanson*1960\n";
    QTest::newRow("UTF-8") << utf8;
    QTest::newRow("UTF-8 with a mark") << QByteArray("\xEF\xBB\xBF").append(utf8);
    QTest::newRow("Windows-1252") << codePage;
    QTest::newRow("CR LF") << QByteArray(codePage).replace("\n", "\r\n");
    QTest::newRow("CR") << QByteArray(utf8).replace('\n', '\r');
    QTest::newRow("no end of the last line") << utf8.chopped(1);
}

void tst_FileReading::encodings()
{
    QFETCH(QByteArray, content);
    QCOMPARE(read('C', content), QStringLiteral("read"));
    QCOMPARE(importRows(), texts("1|Édith|Œuvre|Chanson|1960|Été|2|1|1"));
}

void tst_FileReading::idsFollowTheCatalogue()
{
    mCatalogue->exec(QStringLiteral("insert into CompactDiscs(ID) values (40), (7);"
                                    "insert into CDTitels(ID) values (99);"));
    QCOMPARE(read('A', "x\n1\n1\na\nb\n\n\n"), QStringLiteral("read"));
    QCOMPARE(importRows(), texts("41|A|B|||X|100|1|1"));
    QCOMPARE(track("a*b**"), QStringLiteral("41|A|B|||X|101|1|1"));
}

void tst_FileReading::filesThatGiveNothing_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("end");
    QTest::newRow("missing") << "missing.txt"
                             << "read";
    QTest::newRow("empty") << "empty.txt"
                           << "read";
    QTest::newRow("a mark alone") << "mark.txt"
                                  << "read";
    QTest::newRow("a folder") << "folder.txt"
                              << "not readable, 0";
    QTest::newRow("no name") << ""
                             << "read";
}

void tst_FileReading::filesThatGiveNothing()
{
    QFETCH(QString, name);
    writeFile(mCatalogue->path(QStringLiteral("empty.txt")), {});
    writeFile(mCatalogue->path(QStringLiteral("mark.txt")), "\xEF\xBB\xBF");
    QDir().mkpath(mCatalogue->path(QStringLiteral("folder.txt")));
    read('C', "x\na*b**\n"); // must not be seen again
    for (const char format : {'A', 'B', 'C', 'D'}) {
        QTEST(readFile(format, name.isEmpty() ? name : mCatalogue->path(name)), "end");
        QVERIFY(importRows().isEmpty());
    }
}

void tst_FileReading::oneLineOfMegabytes()
{
    const QByteArray line(10 << 20, 'a');
    QCOMPARE(track(line + "*b**"),
             QStringLiteral("1|A") + QString(254, u'a') + QStringLiteral("|B|||X|2|1|1"));
    QCOMPARE(read('A', line.repeated(10)),
             QStringLiteral("data 2: Number expected but not found!"));
}

void tst_FileReading::rowsBeforeAFaultAreKept()
{
    read('C', "x\na*b**\nc*d\n");
    QCOMPARE(importRows(), texts("1|A|B|||X|2|1|1"));
}

// The word behind the percentage is Dutch in both languages, except where a reader takes it from
// the table.
void tst_FileReading::progress_data()
{
    QTest::addColumn<char>("format");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QStringList>("labels");
    QTest::newRow("A") << 'A' << QByteArray("x\n1\n1\na\nb\n\n\n\x20")
                       << texts("0% read", "12% read", "25% read", "37% read", "50% read",
                                "62% read", "75% read", "87% read", "100% read");
    QTest::newRow("B") << 'B' << QByteArray("p\nx\n1\n1\na\n\n\n1")
                       << texts("0% ingelezen", "12% ingelezen", "25% ingelezen", "37% ingelezen",
                                "50% ingelezen", "62% read", "75% read", "87% read",
                                "100% ingelezen");
    QTest::newRow("C") << 'C' << QByteArray("x\na*b**\n")
                       << texts("0% ingelezen", "50% ingelezen", "100% ingelezen");
    QTest::newRow("D") << 'D' << QByteArray("p\nx\na**\na**\n")
                       << texts("0% ingelezen", "25% ingelezen", "50% ingelezen", "75% ingelezen",
                                "100% ingelezen");
    QTest::newRow("many lines") << 'C' << QByteArray("x\n") + QByteArray(198, '\n') + "a*b**\n"
                                << QStringList();
}

void tst_FileReading::progress()
{
    QFETCH(char, format);
    QFETCH(QByteArray, content);
    QFETCH(QStringList, labels);
    read(format, content);
    if (labels.isEmpty())
        QCOMPARE(mLabels.size(), 101); // each percentage once
    else
        QCOMPARE(mLabels.first(labels.size()), labels);
}

void tst_FileReading::fields_areThoseOfTheTable()
{
    read('C', "x\na*b**\n");
    const auto fields = gImportRecords->rows()->fields();
    QStringList names;
    for (const auto &field : fields)
        names.append(field.name);
    QCOMPARE(names, texts("ListIndex", "Artist", "TrackTitle", "Genre", "Hitjaar", "MainTitle",
                          "MainTitleIndex", "DiskIndex", "TrackIndex"));
    QCOMPARE(fields.front().type, ADODB::adBigInt);
    QCOMPARE(fields.back().size, 255);
}

QTEST_MAIN(tst_FileReading)
#include "tst_FileReading.moc"
