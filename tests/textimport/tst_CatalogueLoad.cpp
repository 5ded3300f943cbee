// Label: unit
#include "platform/ado/recordset.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/importfixture.h"
#include "support/testcatalogue.h"
#include "textimport/catalogueload.h"
#include "textimport/filereading.h"

#include <QTest>
#include <deque>

/// Rows into the catalogue. A load ends as "N imported", "cancelled" or "error TEXT".
class tst_CatalogueLoad : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void everyTable();
    void whatIsThereIsFound_data();
    void whatIsThereIsFound();
    void questions_data();
    void questions();
    void noLeavesTheCdOut();
    void cancelTakesAllBack();
    void errorsTakeAllBack_data();
    void errorsTakeAllBack();
    void quotes();
    void progress();

private:
    void read(char format, const QByteArray &content);
    QString load();
    QString import(char format, const QByteArray &content);
    QStringList everything();

    std::unique_ptr<TestCatalogue> mCatalogue;
    std::deque<BoxAnswer> mAnswers; // Yes when there are none left
    QStringList mQuestions, mLabels;
};

namespace
{

const auto tracks = QStringLiteral("select * from Tracks order by ID");
const auto artists = QStringLiteral("select * from Artiesten order by ID");
const auto titles = QStringLiteral(
    "select ID, Titel, Artiest_ID, CD_Type, Genre, Hitjaar from CDTitels order by ID");
const auto links = QStringLiteral(
    "select ID, CDTitels_ID, DiskNo, TrackNo, Track_ID from CompactDiscs order by ID");

} // namespace

void tst_CatalogueLoad::init()
{
    gLanguage = languageEnglish;
    mCatalogue.reset(); // first: each one holds gConnection
    mCatalogue = std::make_unique<TestCatalogue>();
    mAnswers.clear();
    mQuestions.clear();
    mLabels.clear();
}

void tst_CatalogueLoad::read(char format, const QByteArray &content)
{
    chooseImport(format, writeFile(mCatalogue->path(QStringLiteral("in.txt")), content));
    FileReading().run();
}

QString tst_CatalogueLoad::load()
{
    CatalogueLoad load;
    load.show = [this](int, const QString &label) { mLabels.append(label); };
    load.ask = [this](const QString &question) {
        mQuestions.append(question);
        const BoxAnswer answer = mAnswers.empty() ? vbYes : mAnswers.front();
        if (!mAnswers.empty())
            mAnswers.pop_front();
        return answer;
    };
    try {
        if (load.run() == CatalogueLoad::Outcome::Cancelled)
            return QStringLiteral("cancelled");
        return QString::number(load.importedCount()) + QStringLiteral(" imported");
    } catch (const ADODB::Error &error) {
        gConnection->RollbackTrans();
        return QStringLiteral("error ") + error.Description;
    }
}

QString tst_CatalogueLoad::import(char format, const QByteArray &content)
{
    read(format, content);
    return load();
}

QStringList tst_CatalogueLoad::everything()
{
    return mCatalogue->rows(artists) + mCatalogue->rows(tracks) + mCatalogue->rows(titles) +
           mCatalogue->rows(links);
}

void tst_CatalogueLoad::everyTable()
{
    QCOMPARE(import('C', "x\na*t*Pop*1985\nb*u**\n*\na*v**2e03\ny\na*t**\n"),
             QStringLiteral("4 imported"));
    QCOMPARE(mCatalogue->rows(artists), texts("1|A", "2|B"));
    QCOMPARE(mCatalogue->rows(tracks),
             texts("1|1|T|Pop|1985", "2|2|U|NULL|NULL", "3|1|V|NULL|2000"));
    QCOMPARE(mCatalogue->rows(titles), texts("2|X|NULL|V|NULL|NULL", "3|Y|NULL|V|NULL|NULL"));
    QCOMPARE(mCatalogue->rows(links), texts("1|2|1|1|1", "2|2|1|2|2", "3|2|2|1|3", "4|3|1|1|1"));
    QCOMPARE(import('B', "b\nz\n1\n1\nw\nRock\n*\n"), QStringLiteral("1 imported"));
    QCOMPARE(mCatalogue->rows(titles).last(), QStringLiteral("4|Z|2|E|NULL|NULL"));
    QCOMPARE(mCatalogue->rows(links).last(), QStringLiteral("5|4|1|1|4"));
}

void tst_CatalogueLoad::whatIsThereIsFound_data()
{
    QTest::addColumn<QString>("before");
    QTest::addColumn<QStringList>("artistsAfter");
    QTest::addColumn<QStringList>("tracksAfter");
    const auto row = [](const char *name, const char *before, const QStringList &artistsAfter,
                        const QStringList &tracksAfter) {
        QTest::newRow(name) << QString::fromUtf8(before) << artistsAfter << tracksAfter;
    };
    row("artist in other letters, highest id in use", "insert into Artiesten values (7,'ÉDITH')",
        texts("7|ÉDITH"), texts("1|7|Ça Va|Pop|1985"));
    row("accents part artists", "insert into Artiesten values (7,'Edith')",
        texts("7|Edith", "8|Édith"), texts("1|8|Ça Va|Pop|1985"));
    row("a track keeps its genre and year",
        "insert into Artiesten values (7,'Édith'); insert into Tracks values (3,7,'ça "
        "VA','Jazz',NULL)",
        texts("7|Édith"), texts("3|7|ça VA|Jazz|NULL"));
    row("the same title by another artist",
        "insert into Artiesten values (7,'X'); insert into Tracks values (3,7,'Ça Va','Jazz',1950)",
        texts("7|X", "8|Édith"), texts("3|7|Ça Va|Jazz|1950", "4|8|Ça Va|Pop|1985"));
    row("two of them are none",
        "insert into Artiesten values (7,'Édith'); insert into Artiesten values (8,'Édith')",
        texts("7|Édith", "8|Édith", "9|Édith"), texts("1|9|Ça Va|Pop|1985"));
    row("decomposed", "insert into Artiesten values (7,'E\u0301dith')", texts("7|E\u0301dith"),
        texts("1|7|Ça Va|Pop|1985"));
}

void tst_CatalogueLoad::whatIsThereIsFound()
{
    QFETCH(QString, before);
    mCatalogue->exec(before);
    QCOMPARE(import('C', "x\nÉdith*ça va*Pop*1985\n"), QStringLiteral("1 imported"));
    QTEST(mCatalogue->rows(artists), "artistsAfter");
    QTEST(mCatalogue->rows(tracks), "tracksAfter");
}

void tst_CatalogueLoad::questions_data()
{
    QTest::addColumn<int>("language");
    QTest::addColumn<QString>("before");
    QTest::addColumn<char>("format");
    QTest::addColumn<QByteArray>("content");
    QTest::addColumn<QStringList>("asked");
    const auto row = [](const char *name, int language, const char *before, char format,
                        const char *content, const QStringList &asked) {
        QTest::newRow(name) << language << QString::fromUtf8(before) << format
                            << QByteArray(content) << asked;
    };
    const char *album = "insert into Artiesten values (1,'P'); "
                        "insert into CDTitels values (1,'Mama''s X',1,'E',NULL,NULL)";
    const auto compilation = texts("A compilation entitled 'Mama''s X ' is already stored in the "
                                   "database! \rDo you still want to import this CD?");
    row("a compilation titled as an album", languageEnglish, album, 'C', "mama's x\na*t**\n",
        compilation);
    row("the same in the file", languageEnglish, "", 'A',
        "mama's x\n1\n1\na\nt\n\n\nmama's x\n1\n1\nb\nu\n\n\n", compilation);
    row("an album again", languageEnglish, album, 'D', "p\nmama's x\na**\n",
        texts("An album by P entitled 'Mama''s X' is already stored in the database! \rDo you "
              "still want to import this CD?"));
    row("an album again, Dutch", languageDutch, album, 'B', "p\nMAMA'S X\n1\n1\na\n\n\n",
        texts("Er is reeds een CD van P met de titel 'Mama''s X' in de database aanwezig! \rWilt U "
              "desondanks deze CD aan uw verzameling toevoegen?"));
    row("an album of another artist", languageEnglish, album, 'D', "q\nmama's x\na**\n", {});
    row("an album titled as a compilation", languageEnglish,
        "insert into CDTitels values (1,'X',NULL,'V',NULL,NULL)", 'D', "p\nx\na**\n", {});
}

void tst_CatalogueLoad::questions()
{
    QFETCH(int, language);
    QFETCH(QString, before);
    QFETCH(char, format);
    QFETCH(QByteArray, content);
    gLanguage = language;
    mCatalogue->exec(before);
    const int titlesBefore = mCatalogue->count(QStringLiteral("select count(*) from CDTitels"));
    import(format, content);
    QTEST(mQuestions, "asked");
    QVERIFY(mCatalogue->count(QStringLiteral("select count(*) from CDTitels")) > titlesBefore);
}

void tst_CatalogueLoad::noLeavesTheCdOut()
{
    mCatalogue->exec(QStringLiteral("insert into CDTitels values (1,'Y',NULL,'V',NULL,NULL)"));
    mAnswers = {vbNo};
    QCOMPARE(import('C', "x\na*t**\ny\nb*u**\nb*v**\nz\nc*w**\n"), QStringLiteral("2 imported"));
    QCOMPARE(mQuestions.size(), 1);
    QCOMPARE(mCatalogue->rows(artists), texts("1|A", "2|B", "3|C"));
    QCOMPARE(mCatalogue->rows(links), texts("1|3|1|1|1", "4|5|1|1|4"));
    QCOMPARE(mCatalogue->rows(titles),
             texts("1|Y|NULL|V|NULL|NULL", "3|X|NULL|V|NULL|NULL", "5|Z|NULL|V|NULL|NULL"));
}

void tst_CatalogueLoad::cancelTakesAllBack()
{
    mCatalogue->exec(QStringLiteral("insert into CDTitels values (1,'Z',NULL,'V',NULL,NULL)"));
    const QStringList before = everything();
    mAnswers = {vbCancel};
    QCOMPARE(import('C', "x\na*t**\ny\nb*u**\nz\nc*w**\n"), QStringLiteral("cancelled"));
    QCOMPARE(everything(), before);
    QCOMPARE(load(), QStringLiteral("3 imported")); // once more, and Yes
}

void tst_CatalogueLoad::errorsTakeAllBack_data()
{
    QTest::addColumn<QByteArray>("genre");
    QTest::addColumn<QString>("meanwhile"); // between reading and loading
    QTest::newRow("apostrophe in a genre") << QByteArray("Rock 'n Roll") << QString();
    QTest::newRow("a second row in a genre") << QByteArray("x',1985),(51,1,'r','y") << QString();
    QTest::newRow("a comment in a genre") << QByteArray("x',1985) --") << QString();
    QTest::newRow("taken id of a title")
        << QByteArray() << QStringLiteral("insert into CDTitels(ID) values (3)");
    QTest::newRow("taken id of a link")
        << QByteArray() << QStringLiteral("insert into CompactDiscs(ID) values (2)");
    QTest::newRow("a trigger that raises")
        << QByteArray()
        << QStringLiteral("create trigger T before insert on CompactDiscs when new.ID = 2 begin "
                          "select raise(abort, 'no'); end");
    QTest::newRow("a trigger that rolls back")
        << QByteArray()
        << QStringLiteral("create trigger T before insert on CompactDiscs when new.ID = 2 begin "
                          "select raise(rollback, 'no'); end");
}

void tst_CatalogueLoad::errorsTakeAllBack()
{
    QFETCH(QByteArray, genre);
    QFETCH(QString, meanwhile);
    read('C', "x\na*t**\ny\nb*u*" + genre + "*\n");
    mCatalogue->exec(meanwhile);
    const QStringList before = everything();
    gConnection->Errors.clear();
    const QString end = load();
    QVERIFY2(end.startsWith(QLatin1String("error ")), qPrintable(end));
    QCOMPARE(gConnection->Errors.size(), 1u);
    QCOMPARE(everything(), before);
    mCatalogue->exec(QStringLiteral("drop trigger if exists T"));
    QCOMPARE(import('C', "x\na*t**\ny\nb*u**\n"), QStringLiteral("2 imported"));
}

// A double quote has become two single ones: the genre, which is not doubled, keeps one of them.
void tst_CatalogueLoad::quotes()
{
    QCOMPARE(import('C', "\"x\"\nd'arc*say \"hi\"*\"pop\"*\n"), QStringLiteral("1 imported"));
    QCOMPARE(mCatalogue->rows(artists), texts("1|D'arc"));
    QCOMPARE(mCatalogue->rows(tracks), texts("1|1|Say ''hi''|'pop'|NULL"));
    QCOMPARE(mCatalogue->rows(titles), texts("2|''x''|NULL|V|NULL|NULL"));
}

void tst_CatalogueLoad::progress()
{
    import('C', "x\na*t**\na*u**\na*v**\n");
    QCOMPARE(mLabels, texts("33% imported.....", "66% imported.....", "100% imported....."));
    mLabels.clear();
    import('C', "y\n" + QByteArray("a*t**\n").repeated(250));
    QCOMPARE(mLabels.size(), 101); // from 0 on
}

QTEST_MAIN(tst_CatalogueLoad)
#include "tst_CatalogueLoad.moc"
