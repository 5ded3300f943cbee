// Label: screen
#include "controls/list/DBListViewCTL.h"
#include "mp3/renaming.h"
#include "support/ordinaryuser.h"
#include "support/rowstest.h"

#include <QDir>
#include <QLabel>
#include <QPushButton>
#include <unistd.h>

/// Files get the names that their tags make; each file holds the name that it began with.
class tst_Renaming : public RowsTest
{
    Q_OBJECT

private:
    // "file|artist|title|track position" of each row.
    static std::vector<CollectionRow> rowsOf(const QString &lines)
    {
        using enum CollectionField;
        return RowsTest::rowsOf(lines, {FileName, LeadArtist, Title, TrackPosition}, 1);
    }
    QString folder() const { return mCatalogue->path("music"); }
    QByteArray contentOf(const QString &name) const { return readFile(folder() + u'/' + name); }

    void makeFiles(const std::vector<CollectionRow> &rows)
    {
        for (const CollectionRow &row : rows) {
            const QString name = QString(row[CollectionField::FileName]).replace(u'\\', u'/');
            QDir().mkpath(QFileInfo(folder() + u'/' + name).path());
            writeFile(folder() + u'/' + name, name.toUtf8());
        }
    }

    // The rows' names behind it.
    QStringList rename(const std::vector<CollectionRow> &rows, const QStringList &boxes)
    {
        expect(boxes);
        QStringList names;
        for (const CollectionRow &row : rows)
            names.append(row[CollectionField::FileName]);
        const auto renamed = [&](const CollectionRow &row, const QString &name) {
            names[row.index - 1] = name;
        };
        renameFiles(*mScreen, folder(), rows, renamed, rows);
        return names;
    }

    // "new name: remark" of each row, "! " before what stands bold.
    QStringList preview(const std::vector<CollectionRow> &rows, QString *heading = nullptr)
    {
        QStringList lines;
        mDesktop->expectModal(u"RenamePreview"_s, [&](Form &screen) {
            auto *list = screen.findChild<DBListViewCTL *>();
            const QAbstractItemView *view = list;
            for (int column = 0; column < 4; ++column)
                QVERIFY(list->columnWidth(column) >= view->sizeHintForColumn(column));
            auto items = list->ListItems();
            for (int i = 1; i <= items.Count(); ++i)
                lines.append((items.Item(i).Bold() ? u"! "_s : QString()) +
                             items.Item(i).SubItems(2) + u": "_s + items.Item(i).SubItems(3));
            if (heading)
                *heading = screen.findChild<QLabel *>(u"lblCount"_s)->text();
            screen.findChild<QPushButton *>(u"cmdClose"_s)->click();
        });
        previewRenaming(*mScreen, folder(), rows, rows);
        return lines;
    }

private slots:
    void init()
    {
        RowsTest::init();
        qputenv("XDG_DATA_HOME", mCatalogue->path("data").toUtf8()); // wastebasket
    }

    void names_data()
    {
        const QString longTitle(260, u'x');
        const DataRows<QString, QStringList, QStringList> row("rows", "boxes", "names");
        const QStringList none;
        row("one digit", "x.MP3|A|B|7", none, texts("07-A-B.mp3"));
        row("a zero before it", "x.mp3|A|B|07", none, texts("007-A-B.mp3"));
        row("two digits", "x.mp3|A|\"B\"|12", none, texts("12-A-\"B\".mp3"));
        row("no number", "x.mp3|A|B|", none, texts("-A-B.mp3"));
        row("sub-folder", "S/T/x.mp3|A|B|4", none, texts("S/T/04-A-B.mp3"));
        row("sub-folder of an older catalogue", "S\\x.mp3|A|B|4", none, texts("S/04-A-B.mp3"));
        row("no artist", "x.mp3||B|4\ny.mp3|A|B|1",
            texts("error [Songcase] Unable to rename file x.mp3 because artist"),
            texts("x.mp3", "01-A-B.mp3"));
        row("no title", "x.mp3|A||4", texts("error [Songcase] Unable to rename file x.mp3 because"),
            texts("x.mp3"));
        row("forbidden symbol", "x.mp3|A|B:C|4\ny.mp3|A|B|1",
            texts("error [Songcase] 04-A-B:C.mp3: Unable to rename file because"),
            texts("x.mp3", "01-A-B.mp3"));
        row("number with a total", "x.mp3|A|B|3/12",
            texts("error [Songcase] 3/12-A-B.mp3: This name holds"), texts("x.mp3"));
        row("too long", u"x.mp3|A|"_s + longTitle + u"|1"_s, texts("x.mp3: This name is too long"),
            texts("x.mp3"));
        row("its own name", "01-A-B.mp3|A|B|1",
            texts(
                "yes-no [Songcase] 01-A-B.mp3: A file with the same name already exists! Would=Yes"),
            texts("01-A-B.mp3"));
        row("of a row before", "y.mp3|A|B|1\nx.mp3|A|B|1\nz.mp3||B|1",
            texts("error [Songcase] Unable to rename file z.mp3",
                  "error [Songcase] 01-A-B.mp3: This is the name of the file in row 1 of the list, "
                  "so this file keeps its own name: x.mp3"),
            texts("01-A-B.mp3", "x.mp3", "z.mp3"));
        row("that a later row leaves", "02-C-D.mp3|E|F|3\nx.mp3|C|D|2\n03-E-F.mp3|G|H|4", none,
            texts("03-E-F.mp3", "02-C-D.mp3", "04-G-H.mp3"));
        row("two that want each other's", "01-A-B.mp3|C|D|2\n02-C-D.mp3|A|B|1",
            texts("02-C-D.mp3: This is the name of the file in row 2",
                  "01-A-B.mp3: This is the name of the file in row 1"),
            texts("01-A-B.mp3", "02-C-D.mp3"));
        row("that a row before leaves", "01-A-B.mp3|C|D|2\nx.mp3|A|B|1", none,
            texts("02-C-D.mp3", "01-A-B.mp3"));
        row("one file twice in the list", "x.mp3|A|B|1\nx.mp3|A|B|1", none,
            texts("01-A-B.mp3", "01-A-B.mp3"));
    }
    void names()
    {
        QFETCH(QString, rows);
        QFETCH(QStringList, boxes);
        QFETCH(QStringList, names);
        makeFiles(rowsOf(rows));
        QCOMPARE(rename(rowsOf(rows), boxes), names);
        for (int place = 0; const CollectionRow &row : rowsOf(rows))
            QCOMPARE(contentOf(names[place++]),
                     QString(row[CollectionField::FileName]).replace(u'\\', u'/').toUtf8());
    }

    void aFileThatNoRowHas()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1"_s);
        makeFiles(rows);
        writeFile(folder() + u"/01-A-B.mp3"_s, "other");
        QCOMPARE(rename(rows, {u"already exists=No"_s}), texts("x.mp3"));
        QCOMPARE(contentOf(u"01-A-B.mp3"_s), "other");
        QCOMPARE(rename(rows, {u"already exists=Yes"_s}), texts("01-A-B.mp3"));
        QCOMPARE(contentOf(u"01-A-B.mp3"_s), "x.mp3");
        QCOMPARE(contentOf(u"x.mp3"_s), "none");
        QVERIFY(!QFileInfo::exists(u"files/01-A-B.mp3"_s)); // in the current folder
        QCOMPARE(readFile(mCatalogue->path("data/Trash/files/01-A-B.mp3")), "other");
    }

    // One that leads nowhere is not seen by who follows it.
    void aLinkThatNoRowHas()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1"_s);
        makeFiles(rows);
        const QString there = folder() + u"/01-A-B.mp3"_s;
        QVERIFY(QFile::link(folder() + u"/nowhere"_s, there));
        QCOMPARE(preview(rows), texts("! 01-A-B.mp3: Another file has it; you will be asked"));
        QCOMPARE(rename(rows, {u"already exists=No"_s}), texts("x.mp3"));
        QVERIFY(QFileInfo(there).isSymLink());
    }

    void aFolder()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1"_s);
        makeFiles(rows);
        makeFiles(rowsOf(u"01-A-B.mp3/inside"_s));
        QCOMPARE(preview(rows), texts("! 01-A-B.mp3: A folder has this name"));
        QCOMPARE(rename(rows, {u"error [Songcase] 01-A-B.mp3: There is a folder"_s}),
                 texts("x.mp3"));
        QCOMPARE(contentOf(u"01-A-B.mp3/inside"_s), "01-A-B.mp3/inside");
    }

    // Another name for the very file, as on a disk that makes no difference between cases.
    void aLinkToTheFileItself()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1"_s);
        makeFiles(rows);
        QCOMPARE(link((folder() + u"/x.mp3"_s).toUtf8(), (folder() + u"/01-A-B.mp3"_s).toUtf8()),
                 0);
        QCOMPARE(rename(rows, {u"already exists=Yes"_s}), texts("01-A-B.mp3"));
        QCOMPARE(contentOf(u"01-A-B.mp3"_s), "x.mp3");
    }

    // As other systems write names; the catalogue has them composed.
    void aFolderOfDecomposedLetters()
    {
        const QString name = u"\u00e9/x.mp3"_s;
        makeFiles(rowsOf(name.normalized(QString::NormalizationForm_D)));
        QCOMPARE(rename(rowsOf(name + u"|A|B|4"_s), {}), QStringList(u"\u00e9/04-A-B.mp3"_s));
        QVERIFY(QFile::exists(folder() + u"/e\u0301/04-A-B.mp3"_s));
    }

    // By design a move that fails says nothing, and the row has the new name.
    void aFileThatIsGone() { QCOMPARE(rename(rowsOf(u"x.mp3|A|B|1"_s), {}), texts("01-A-B.mp3")); }

    void whatCannotBeTakenBackIsNotDone()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1\ny.mp3|A|C|2"_s);
        makeFiles(rows);
        writeFile(mCatalogue->path("Changes"), "not a folder");
        QCOMPARE(rename(rows, {u"error [Songcase]"_s}), texts("x.mp3", "y.mp3"));
        QCOMPARE(contentOf(u"x.mp3"_s), "x.mp3");
    }

    void whatTheWastebasketDoesNotTakeStays()
    {
        const auto rows = rowsOf(u"x.mp3|A|B|1\ny.mp3|A|C|2"_s);
        makeFiles(rows);
        writeFile(folder() + u"/01-A-B.mp3"_s, "other");
        QVERIFY(QDir().mkpath(mCatalogue->path("data/Trash")));
        writeFile(mCatalogue->path("data/Trash/info"), "not a folder");
        QCOMPARE(
            rename(rows, {u"already exists=Yes"_s, u"error [Songcase] 01-A-B.mp3: The file"_s}),
            texts("x.mp3", "02-A-C.mp3"));
        QCOMPARE(contentOf(u"x.mp3"_s), "x.mp3");
        QCOMPARE(contentOf(u"01-A-B.mp3"_s), "other");
    }

    void previewed()
    {
        const auto rows = rowsOf(u"a.mp3|A|B|1\nb.mp3|A|B|1\nc.mp3|A||\n02-C-D.mp3|C|D|2\n"
                                 "02-C-D.mp3|C|D|2\ne.mp3|E|F|3\n03-E-F.mp3|G|H|4\n"
                                 "gone.mp3|I|J|5\nclosed/k.mp3|K|L|6\nclosed/l.mp3|K|L|6"_s);
        makeFiles(rows);
        QVERIFY(QFile::remove(folder() + u"/gone.mp3"_s));
        for (const QString &open : {mCatalogue->path(""), folder()})
            QVERIFY(QFile::setPermissions(open, QFile::Permissions(0x7777)));
        const QString closed = folder() + u"/closed"_s;
        QVERIFY(QFile::setPermissions(closed, QFile::ReadUser | QFile::ExeUser | QFile::ReadOther |
                                                  QFile::ExeOther));
        const QStringList before = QDir(folder()).entryList(QDir::Files);
        QString heading;
        {
            const OrdinaryUser user;
            QCOMPARE(preview(rows, &heading),
                     texts("01-A-B.mp3: ", "! 01-A-B.mp3: Name of the file in row 1",
                           "! : No artist or no title in the tag",
                           "! 02-C-D.mp3: Has this name already; you will be asked",
                           "! 02-C-D.mp3: Has this name already; you will be asked",
                           "03-E-F.mp3: ", "04-G-H.mp3: ", "! 05-I-J.mp3: The file is not found",
                           "! closed/06-K-L.mp3: Not possible: the folder is write-protected",
                           "! closed/06-K-L.mp3: Name of the file in row 9"));
        }
        QVERIFY(heading.contains(u"in bold: 7\nFiles that cannot be renamed"_s));
        QVERIFY(heading.endsWith(u": 1"_s));
        QVERIFY(QFile::setPermissions(closed, QFile::Permissions(0x7777)));
        QCOMPARE(QDir(folder()).entryList(QDir::Files), before);
    }
};

QTEST_MAIN(tst_Renaming)
#include "tst_Renaming.moc"
