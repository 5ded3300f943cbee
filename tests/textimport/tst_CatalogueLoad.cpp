// Label: unit
#include "platform/ado/recordset.h"
#include "support/importfixture.h"
#include "textimport/catalogueload.h"
#include "textimport/filereading.h"

#include <deque>

namespace
{

const auto tracks = u"select * from Tracks order by ID"_s;
const auto artists = u"select * from Artiesten order by ID"_s;
const auto titles =
    u"select ID, Titel, Artiest_ID, CD_Type, Genre, Hitjaar from CDTitels order by ID"_s;
const auto links =
    u"select ID, CDTitels_ID, DiskNo, TrackNo, Track_ID from CompactDiscs order by ID"_s;

} // namespace

/// Rows into the catalogue. A load ends as "N imported", "cancelled" or "error TEXT".
class tst_CatalogueLoad : public QObject
{
    Q_OBJECT

private:
    void read(char format, const QByteArray &content)
    {
        chooseImport(format, writeFile(mCatalogue->path("in.txt"), content));
        FileReading().run();
    }

    QString load()
    {
        CatalogueLoad load;
        load.ask = [this](const QString &question) {
            mQuestions.append(question);
            const BoxAnswer answer = mAnswers.empty() ? vbYes : mAnswers.front();
            if (!mAnswers.empty())
                mAnswers.pop_front();
            return answer;
        };
        try {
            if (load.run() == CatalogueLoad::Outcome::Cancelled)
                return u"cancelled"_s;
            return QString::number(load.importedCount()) + u" imported"_s;
        } catch (const Error &error) {
            gConnection->RollbackTrans();
            return u"error "_s + error.Description;
        }
    }

    QString import(char format, const QByteArray &content)
    {
        read(format, content);
        return load();
    }

    QStringList everything()
    {
        return mCatalogue->rows(artists) + mCatalogue->rows(tracks) + mCatalogue->rows(titles) +
               mCatalogue->rows(links);
    }

    std::unique_ptr<TestCatalogue> mCatalogue;
    std::deque<BoxAnswer> mAnswers; // Yes when there are none left
    QStringList mQuestions;

private slots:
    void init()
    {
        gLanguage = languageEnglish;
        mCatalogue.reset(); // first: each one holds gConnection
        mCatalogue = std::make_unique<TestCatalogue>();
        mAnswers.clear();
        mQuestions.clear();
    }

    // A double quote has become two single ones: the genre, which is not doubled, keeps one of
    // them.
    void everyTable()
    {
        QCOMPARE(
            import('C', "x\nd'arc*t*\"Pop\"*1985\nb*u**\n*\nd'arc*say \"v\"**2e03\ny\nd'arc*t**\n"),
            u"4 imported"_s);
        QCOMPARE(mCatalogue->rows(artists), texts("1|D'arc", "2|B"));
        QCOMPARE(mCatalogue->rows(tracks),
                 texts("1|1|T|'pop'|1985", "2|2|U|NULL|NULL", "3|1|Say ''v''|NULL|2000"));
        QCOMPARE(mCatalogue->rows(titles), texts("2|X|NULL|V|NULL|NULL", "3|Y|NULL|V|NULL|NULL"));
        QCOMPARE(mCatalogue->rows(links),
                 texts("1|2|1|1|1", "2|2|1|2|2", "3|2|2|1|3", "4|3|1|1|1"));
        QCOMPARE(import('B', "b\nz\n1\n1\nw\nRock\n*\n"), u"1 imported"_s);
        QCOMPARE(mCatalogue->rows(titles).last(), u"4|Z|2|E|NULL|NULL"_s);
        QCOMPARE(mCatalogue->rows(links).last(), u"5|4|1|1|4"_s);
    }

    void whatIsThereIsFound_data()
    {
        const DataRows<QString, QStringList, QStringList> row("before", "artistsAfter",
                                                              "tracksAfter");
        row("artist in other letters, highest id in use",
            "insert into Artiesten values (7,'ÉDITH')", texts("7|ÉDITH"),
            texts("1|7|Ça Va|Pop|1985"));
        row("a track keeps its genre and year",
            "insert into Artiesten values (7,'Édith'); insert into Tracks values (3,7,'ça "
            "VA','Jazz',NULL)",
            texts("7|Édith"), texts("3|7|ça VA|Jazz|NULL"));
        row("the same title by another artist",
            "insert into Artiesten values (7,'X'); insert into Tracks values (3,7,'Ça "
            "Va','Jazz',1950)",
            texts("7|X", "8|Édith"), texts("3|7|Ça Va|Jazz|1950", "4|8|Ça Va|Pop|1985"));
        row("two of them are none",
            "insert into Artiesten values (7,'Édith'); insert into Artiesten values (8,'Édith')",
            texts("7|Édith", "8|Édith", "9|Édith"), texts("1|9|Ça Va|Pop|1985"));
        row("decomposed", "insert into Artiesten values (7,'E\u0301dith')", texts("7|E\u0301dith"),
            texts("1|7|Ça Va|Pop|1985"));
    }

    void whatIsThereIsFound()
    {
        QFETCH(QString, before);
        mCatalogue->exec(before);
        QCOMPARE(import('C', "x\nÉdith*ça va*Pop*1985\n"), u"1 imported"_s);
        QTEST(mCatalogue->rows(artists), "artistsAfter");
        QTEST(mCatalogue->rows(tracks), "tracksAfter");
    }

    void questions_data()
    {
        const DataRows<int, QString, char, QByteArray, QStringList> row(
            "language", "before", "format", "content", "asked");
        const char *album = "insert into Artiesten values (1,'P'); "
                            "insert into CDTitels values (1,'Mama''s X',1,'E',NULL,NULL)";
        const auto compilation =
            texts("A compilation entitled 'Mama''s X ' is already stored in the "
                  "database! \rDo you still want to import this CD?");
        row("a compilation titled as an album", languageEnglish, album, 'C', "mama's x\na*t**\n",
            compilation);
        row("an album again, Dutch", languageDutch, album, 'B', "p\nMAMA'S X\n1\n1\na\n\n\n",
            texts("Er is reeds een CD van P met de titel 'Mama''s X' in de database aanwezig! "
                  "\rWilt U "
                  "desondanks deze CD aan uw verzameling toevoegen?"));
        row("an album of another artist", languageEnglish, album, 'D', "q\nmama's x\na**\n", {});
        row("an album titled as a compilation", languageEnglish,
            "insert into CDTitels values (1,'X',NULL,'V',NULL,NULL)", 'D', "p\nx\na**\n", {});
    }

    void questions()
    {
        QFETCH(int, language);
        QFETCH(QString, before);
        QFETCH(char, format);
        QFETCH(QByteArray, content);
        gLanguage = language;
        mCatalogue->exec(before);
        const int titlesBefore = mCatalogue->count("select count(*) from CDTitels");
        import(format, content);
        QTEST(mQuestions, "asked");
        QVERIFY(mCatalogue->count("select count(*) from CDTitels") > titlesBefore);
    }

    void noLeavesTheCdOut()
    {
        mCatalogue->exec("insert into CDTitels values (1,'Y',NULL,'V',NULL,NULL)");
        mAnswers = {vbNo};
        QCOMPARE(import('C', "x\na*t**\ny\nb*u**\nb*v**\nz\nc*w**\n"), u"2 imported"_s);
        QCOMPARE(mQuestions.size(), 1);
        QCOMPARE(mCatalogue->rows(artists), texts("1|A", "2|B", "3|C"));
        QCOMPARE(mCatalogue->rows(links), texts("1|3|1|1|1", "4|5|1|1|4"));
        QCOMPARE(mCatalogue->rows(titles),
                 texts("1|Y|NULL|V|NULL|NULL", "3|X|NULL|V|NULL|NULL", "5|Z|NULL|V|NULL|NULL"));
    }

    void cancelTakesAllBack()
    {
        mCatalogue->exec("insert into CDTitels values (1,'Z',NULL,'V',NULL,NULL)");
        const QStringList before = everything();
        mAnswers = {vbCancel};
        QCOMPARE(import('C', "x\na*t**\ny\nb*u**\nz\nc*w**\n"), u"cancelled"_s);
        QCOMPARE(everything(), before);
        QCOMPARE(load(), u"3 imported"_s); // once more, and Yes
    }

    // A record that was saved between reading and loading has taken the ids that the readers had
    // counted, or given some back.
    void idsThatWereTakenMeanwhile_data()
    {
        const DataRows<QString, QString> row("meanwhile", "ids");
        row("none", "select 1", "5:20 6:21,22");
        row("of titles", "insert into CDTitels(ID) values (4),(5)", "6:20 7:21,22");
        row("of links", "insert into CompactDiscs(ID) values (22)", "5:23 6:24,25");
        row("given back", "delete from CDTitels; delete from CompactDiscs", "5:20 6:21,22");
    }

    void idsThatWereTakenMeanwhile()
    {
        mCatalogue->exec("insert into CDTitels(ID) values (3);"
                         "insert into CompactDiscs(ID) values (19)");
        read('C', "x\na*t**\ny\nb*u**\nb*v**\n");
        QFETCH(QString, meanwhile);
        mCatalogue->exec(meanwhile);
        QCOMPARE(load(), u"3 imported"_s);
        QTEST(mCatalogue
                  ->rows("select CDTitels_ID || ':' || group_concat(ID) from CompactDiscs "
                         "where Track_ID > 0 group by CDTitels_ID")
                  .join(u' '),
              "ids");
    }

    void errorsTakeAllBack_data()
    {
        const DataRows<QByteArray, QString> row("genre",
                                                "meanwhile"); // between reading and loading
        row("apostrophe in a genre", "Rock 'n Roll", "");
        row("a second row in a genre", "x',1985),(51,1,'r','y", "");
        row("a condition in a genre", "x' or '1", "");
        row("a trigger that rolls back", "",
            "create trigger T before insert on CompactDiscs when new.ID = 2 begin "
            "select raise(rollback, 'no'); end");
    }

    void errorsTakeAllBack()
    {
        QFETCH(QByteArray, genre);
        QFETCH(QString, meanwhile);
        read('C', "x\na*t**\ny\nb*u*" + genre + "*\n");
        mCatalogue->exec(meanwhile);
        const QStringList before = everything();
        gConnection->Errors.clear();
        const QString end = load();
        QVERIFY2(end.startsWith("error "_L1), qPrintable(end));
        QCOMPARE(gConnection->Errors.size(), 1u);
        QCOMPARE(everything(), before);
        mCatalogue->exec("drop trigger if exists T");
        QCOMPARE(import('C', "x\na*t**\ny\nb*u**\n"), u"2 imported"_s);
    }
};

QTEST_MAIN(tst_CatalogueLoad)
#include "tst_CatalogueLoad.moc"
