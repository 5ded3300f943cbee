// Label: screen
#include "mp3/collectionrows.h"
#include "mp3/collectionstore.h"
#include "mp3/rownames.h"
#include "platform/ado/connection.h"
#include "platform/files/nativename.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "support/madesound.h"
#include "support/ordinaryuser.h"
#include "support/screentest.h"

#include <QDir>
#include <sys/stat.h>

/// The rows of a collection without their screen: order, files, catalogue.
class tst_CollectionRows : public ScreenTest
{
    Q_OBJECT

private:
    using Field = CollectionField;

    QString cell(qsizetype row, Field field) const
    {
        return mRows->WorkingRecords->rows()->text(row, int(field));
    }

    QString order() const
    {
        QStringList all;
        for (qsizetype row = 0; row < mRows->count(); ++row)
            all.append(cell(row, Field::Volgnummer) + cell(row, Field::FileName));
        return all.join(u' ');
    }

    void put(const QByteArray &name, const char *title)
    {
        const QByteArray tag = id3Tag({{"TIT2", QString::fromUtf8(title)}, {"TRCK", u"3"_s}});
        writeFile(mCatalogue->path(QString::fromUtf8(name)), tag + silentMP3(50));
    }

    CollectionRows::Reading read()
    {
        LongWork work(*mScreen);
        return mRows->read(mCatalogue->path(""), work);
    }

    std::unique_ptr<CollectionRows> mRows;
    QPointer<Form> mScreen;

private slots:
    void init()
    {
        ScreenTest::init();
        mRows = std::make_unique<CollectionRows>();
        mRows->load(1);
        mScreen = new Form(u"frmCDRootMP3"_s);
        mScreen->Load();
    }

    void theOrder_data()
    {
        const DataRows<QString, QString> row("steps", "order");
        row("append a b c", "1a 2b 3c");
        row("append a b a c,remove a", "1b 2a 3c"); // the first of that name
        row("append a b a c,remove a a c", "1b");
        row("append a b,remove x", "1a 2b");
        row("append a b c d,move 0 2", "1b 2c 3a 4d");
        row("append a b c d,move 3 1", "1a 2d 3b 4c");
        row("append a b c,name 2 z,append d", "1a 2z 3c 4d");
        row("append a b,clear,append c", "1c");
    }

    void theOrder()
    {
        QFETCH(QString, steps);
        for (const QString &step : steps.split(u',')) {
            const QStringList words = step.split(u' '), rest = words.sliced(1);
            if (words[0] == u"append")
                mRows->append(rest);
            else if (words[0] == u"remove")
                mRows->remove(rest);
            else if (words[0] == u"move")
                mRows->move(rest[0].toInt(), rest[1].toInt());
            else if (words[0] == u"name")
                mRows->setFileNames({{rest[0], rest[1]}});
            else
                mRows->removeAll();
        }
        QTEST(order(), "order");
        QVERIFY(mRows->haveChanged());
    }

    void whatIsNoFileIsNotOpened()
    {
        put("a.mp3", "One");
        put("new\nline.mp3", "Two");
        put("none.mp3", "Unreadable");
        QDir().mkpath(mCatalogue->path("folder.mp3"));
        mkfifo(nativeName(mCatalogue->path("pipe.mp3")).constData(), 0600);
        chmod(nativeName(mCatalogue->path("none.mp3")).constData(), 0);
        chmod(nativeName(mCatalogue->path("")).constData(), 0755);
        mRows->append({u"a.mp3"_s, u"folder.mp3"_s, u"pipe.mp3"_s, u"none.mp3"_s,
                       u"new\nline.mp3"_s, u"gone.mp3"_s});
        const OrdinaryUser user;
        const auto reading = read();
        QVERIFY(!reading.allExist);
        QCOMPARE(reading.unreadable, texts("none.mp3"));
        QStringList titles;
        for (qsizetype row = 0; row < mRows->count(); ++row)
            titles.append(cell(row, Field::DoesFileExist) + cell(row, Field::Title));
        QCOMPARE(titles, texts("yOne", "n?", "n?", "y", "yTwo", "n?"));
        QVERIFY2(read().unreadable.isEmpty(), "it is told once");
    }

    // What the test writes into a row stays there for as long as the file is not read again.
    void aFileIsReadOnce()
    {
        put("a.mp3", "One");
        mRows->append({u"a.mp3"_s});
        const auto titleAfterReading = [this] {
            mRows->WorkingRecords->MoveFirst();
            mRows->WorkingRecords->Fields(u"Title").setValue(u"kept"_s);
            read();
            return cell(0, Field::Title);
        };
        read();
        QCOMPARE(cell(0, Field::TrackPosition), u"3"_s);
        QCOMPARE(titleAfterReading(), u"kept"_s);
        put("a.mp3", "Two");
        QCOMPARE(titleAfterReading(), u"Two"_s);
        QFile::remove(mCatalogue->path("a.mp3"));
        QCOMPARE(titleAfterReading(), u"?"_s);
        put("a.mp3", "Three");
        QCOMPARE(titleAfterReading(), u"Three"_s);
        put("b.mp3", "Other");
        mRows->setFileNames({{u"1"_s, u"b.mp3"_s}});
        QCOMPARE(titleAfterReading(), u"Other"_s);
    }

    // Rows that a cancelled reading has not come to stay empty until they are wanted again.
    void aCancelledReading()
    {
        put("a.mp3", "One");
        mRows->append({u"a.mp3"_s});
        LongWork work(*mScreen);
        work.cancel();
        QVERIFY(mRows->read(mCatalogue->path(""), work).cancelled);
        read();
        QCOMPARE(cell(0, Field::Title), QString());
        mRows->readAnew();
        read();
        QCOMPARE(cell(0, Field::Title), u"One"_s);
    }

    // Bytes that are no UTF-8, a quote, decomposed letters, the other separator.
    void namesSurviveTheCatalogue()
    {
        const QByteArray names[] = {"Caf\xe9.mp3", "it's.mp3", "Cafe\xcc\x81.mp3",
                                    "x/Caf\xc3\xa9.mp3"};
        QDir().mkpath(mCatalogue->path("music/x"));
        const QByteArray folder = nativeName(mCatalogue->path("music/"));
        for (const QByteArray &name : names)
            writeFile(nameOfNative(folder + name).contains(QChar(0xefe9))
                          ? mCatalogue->path("seed")
                          : nameOfNative(folder + name),
                      id3Tag({{"TIT2", u"Title"_s}}));
        QCOMPARE(rename(nativeName(mCatalogue->path("seed")).constData(),
                        QByteArray(folder + names[0]).constData()),
                 0);
        const QString music = mCatalogue->path("music");
        mRows->append(rownames::ofFound(music, FindFilesInTree(music, u"*.mp3"_s, 1)));
        mRows->setFileNames({{u"4"_s, u"x\\Café.mp3"_s}});
        QCOMPARE(mRows->count(), 4);
        const qint64 id = collectionstore::insertHeader({music, u"It's"_s});
        collectionstore::replaceFiles(id, *mRows->WorkingRecords->rows());
        mRows->load(id);
        LongWork work(*mScreen);
        QVERIFY(mRows->read(music, work).allExist);
        QCOMPARE(cell(3, Field::Title), u"Title"_s);
        QVERIFY(!mRows->haveChanged());
        QVERIFY(!MoveFileReplace(nameOfNative(folder + names[0]), mCatalogue->path("seed")));
    }

    void chosenFiles_data()
    {
        const DataRows<QString, QString, QString> row("files", "names", "refusal");
        row("/m/a.mp3", "a.mp3", "");
        row("/m/a.mp3 /m/b.mp3 /m/c.MP3x", "b.mp3 c.MP3x a.mp3", ""); // the first comes last
        row("/m/sub/a.mp3", "sub/a.mp3", "");
        row("/m2/a.mp3", "", "InvalidDirectory");
        row("/a.mp3", "", "InvalidDirectory");
        row("/m/a.mp3 /m/b.mp3 /m/c.txt /m/d.mp3", "b.mp3", "OnlyMP3Files");
        const QString longest = QString(251, u'x') + u".mp3"_s;
        row("255", u"/m/"_s + longest, longest, "");
        row("256", u"/m/x"_s + longest, "", "NumberOfCharactersExceeded");
    }

    void chosenFiles()
    {
        QFETCH(QString, files);
        for (const QString &folder : {u"/m"_s, u"/m/"_s, u"/x/../m"_s}) {
            const auto chosen = rownames::ofChosen(folder, files.split(u' '));
            QTEST(chosen.names.join(u' '), "names");
            QTEST(QString::fromLatin1(chosen.refusal), "refusal");
            QCOMPARE(chosen.askAgain, chosen.refusal == QByteArray("OnlyMP3Files"));
        }
        QCOMPARE(rownames::ofChosen(u"/"_s, {u"/a/b.mp3"_s}).names, texts("a/b.mp3"));
    }
};

QTEST_MAIN(tst_CollectionRows)
#include "tst_CollectionRows.moc"
