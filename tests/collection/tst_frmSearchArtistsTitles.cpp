// Label: screen
#include "collection/cdeditor.h"
#include "collection/frmSearchArtistsTitles.h"
#include "collection/searchstatement.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/tracks/trackgrid.h"
#include "platform/ado/dialect.h"
#include "platform/ado/ordertail.h"
#include "support/fulldisk.h"
#include "support/referencelike.h"
#include "support/screentest.h"

#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QStatusBar>
#include <QTabBar>
#include <cerrno>

/// The search on a real catalogue file, held against a slow matcher of its own.
class tst_frmSearchArtistsTitles : public ScreenTest
{
    Q_OBJECT

private:
    enum Column { Artist, Title, Genre = 5, Type = 7, columnCount };

    QPointer<frmSearchArtistsTitles> mScreen;

    template <typename Control> Control *control(const char *name) const
    {
        return mScreen->findChild<Control *>(QLatin1String(name));
    }
    DBListViewCTL *list() const { return control<DBListViewCTL>("ResultList"); }
    void select(int row) { list()->setSelectedItem(list()->ListItems().Item(row + 1)); }
    QString status() const { return control<QStatusBar>("StatusBar")->currentMessage(); }
    void type(const char *field, const QString &text) { control<QLineEdit>(field)->setText(text); }
    void search()
    {
        control<QLineEdit>("txtGenre")->setFocus();
        QTest::keyClick(control<QLineEdit>("txtGenre"), Qt::Key_Return);
    }

    // Every artist has every title, on a compilation and on the second disc of an album, with
    // genres and years, none among them, in turn.
    void fill()
    {
        mCatalogue->exec(QString::fromUtf8(R"(
            create temp table Name(n integer primary key, w);
            insert into Name(w) values ('O''Neal'),('Édith'),('edith ÉCLAIR'),('100% Pure'),('a_b'),
                ('axb'),('ÅSA'),('Жук'),(' lead'),('Ab');
            create temp table Kind(n integer primary key, g, y);
            insert into Kind values (0,'Pop',1985),(1,'pop/Rock',1900),(2,null,null),
                (3,'Rock',2000),(4,'ROCK',2001),(5,'%',1985);
            insert into Artiesten select n, w from Name;
            insert into Tracks select a.n * 100 + t.n, a.n, t.w || iif(t.n % 2, '', ' ' || t.n), g, y
                from Name a, Name t, Kind k where k.n = (a.n * 3 + t.n) % 6;
            insert into CDTitels values (1,'Mix "one"',null,'V',null,null),
                (2,'Second',1,'E',null,1999);
            insert into CompactDiscs select ID, 1, 1, ID, ID, null from Tracks;
            insert into CompactDiscs select ID + 5000, 2, 2, ID % 100 + Artiest_ID, ID, null
                from Tracks where ID % 3 = 0;)"));
    }

    // All rows as they are to be shown, in their order.
    QList<QStringList> allRows()
    {
        QList<QStringList> all;
        const auto lines = mCatalogue->rows(
            u"select a.Naam, t.Titel, DiskNo, TrackNo, c.Titel, t.Genre, t.Hitjaar, CD_Type"
            " from Artiesten a, Tracks t, CompactDiscs l, CDTitels c where t.Artiest_ID = a.ID"
            " and l.Track_ID = t.ID and l.CDTitels_ID = c.ID"
            " order by a.Naam, t.Titel, c.Titel, DiskNo, TrackNo"_s);
        for (const QString &line : lines) {
            QStringList row = line.split(u'|').replaceInStrings(u"NULL"_s, QString());
            row[Type] = row[Type] == u"V"_s ? u"Compilation"_s : u"Album"_s;
            all.append(row);
        }
        return all;
    }

    QStringList shown() const
    {
        QStringList lines;
        auto items = list()->ListItems();
        for (int i = 1; i <= items.Count(); ++i) {
            QStringList row;
            for (int column = 0; column < columnCount; ++column)
                row.append(items.Item(i).SubItems(column));
            lines.append(row.join(u'|'));
        }
        return lines;
    }

    void exportTo(const QString &name)
    {
        mDesktop->expectFile(name);
        QTest::mouseClick(control<QPushButton>("cmdExport"), Qt::LeftButton);
    }
    static CdEditor *editor(const QString &name)
    {
        for (Form *form : Form::openForms()) {
            if (form->Name() == name)
                return qobject_cast<CdEditor *>(form);
        }
        return nullptr;
    }

private slots:
    void init()
    {
        ScreenTest::init();
        fill();
        mScreen = &defaultInstance<frmSearchArtistsTitles>();
        mScreen->Show();
        QVERIFY(QTest::qWaitForWindowActive(mScreen));
    }

    void findsWhatTheMatcherFinds_data()
    {
        const DataRows<QString, QString, QString> row("mode", "before", "behind");
        row("optFullWord", "", "");
        row("optPartWord", "%", "%");
        row("optBeginWord", "", "%");
        row("optEndWord", "%", "");
    }
    void findsWhatTheMatcherFinds()
    {
        QFETCH(QString, mode);
        QFETCH(QString, before);
        QFETCH(QString, behind);
        mScreen->findChild<QRadioButton *>(mode)->setChecked(true);
        const QString veryLong(10000, u'x');
        const auto keys = texts("||", "o'n||", "édith||", "EDITH|b|", "|%|rock", "|a_b|", "ж|å|",
                                " ||pop", "||%", "a_|ab 10|p%k", "100% pure||", "'; drop||");
        const auto rows = allRows();
        for (const QString &fields : keys + QStringList(veryLong + u'|' + veryLong + u"||"_s)) {
            const QStringList key = fields.split(u'|');
            const auto fits = [&](qsizetype field, const QString &text) {
                return key[field].isEmpty() ||
                       (!text.isEmpty() && referenceLike(before + key[field] + behind, text));
            };
            QStringList expected;
            for (const QStringList &row : rows) {
                if (fits(0, row[Artist]) && fits(1, row[Title]) && fits(2, row[Genre]))
                    expected.append(row.join(u'|'));
            }
            type("txtArtistKey", key[0]);
            type("txtTitleKey", key[1]);
            type("txtGenre", key[2]);
            search();
            QCOMPARE(shown(), expected);
            QCOMPARE(status(), u"Number of titles found: %1"_s.arg(expected.size()));
        }
    }

    void plans_data()
    {
        // keys: artist, title, genre, first and last year
        const DataRows<QString, QStringList, QString> row("name", "keys", "begins");
        row("nothing", texts("", "", "", "", ""), "vcd");
        row("artist", texts("maan", "", "", "", ""), "art");
        row("title", texts("", "maan", "", "", ""), "trk");
        row("genre", texts("", "", "pop", "", ""), "trk");
        row("all texts", texts("maan", "maan", "pop", "", ""), "art");
        row("year", texts("", "", "", "1985", ""), "trk");
        row("years", texts("", "", "", "1980", "1989"), "vcd");
        row("artist, year", texts("maan", "", "", "1985", ""), "art");
    }
    void plans()
    {
        QFETCH(QStringList, keys);
        const auto sql = ADODB::translated(
            searchStatement({SearchKey::PartWord, keys[0], keys[1], keys[2], keys[3], keys[4]}));
        const auto unordered = sql.substr(0, ADODB::orderTail(sql).from); // as it is run
        const auto plan =
            mCatalogue->rows(u"explain query plan "_s + QString::fromStdString(unordered));
        QTEST(plan.value(0).section(u'|', 3).section(u' ', 1, 1), "begins");
    }

    void years_data()
    {
        const DataRows<QString, QString, QString> row("condition", "first", "last");
        row("= 2000", "2000", "");
        row("= 2000 ", "", "2000");
        row("between 1985 and 2000", "1985", "2000");
        row("= 1985", "1985", "1985");
        row("= 1900", "1900", "");
        row("is not null", "1900", "9999");
        row("=  2000", "2e3 ", "");
        row("= 0", "1e10", "");
    }
    void years()
    {
        QFETCH(QString, condition);
        QFETCH(QString, first);
        QFETCH(QString, last);
        type("txtHitjaarvan", first);
        type("txtHitjaartm", last);
        search();
        QCOMPARE(list()->ListItems().Count(),
                 mCatalogue->count(u"select count(*) from Tracks t, CompactDiscs l where "
                                   "l.Track_ID = t.ID and t.Hitjaar "_s +
                                   condition));
    }

    // The old list stays, and so do the words of the panel.
    void yearsThatAreNone_data()
    {
        const DataRows<QString, QString, QString, QString> row("name", "first", "last", "focus");
        row("too early", "1899", "", "txtHitjaarvan");
        row("no number", "19x5", "1985", "txtHitjaarvan");
        row("too long", "01985", "", "txtHitjaarvan");
        row("too short", "", "198", "txtHitjaartm");
        row("more than a number", "1985", "1; x", "txtHitjaartm");
        row("wrong order", "2001", "2000", "txtHitjaarvan");
    }
    void yearsThatAreNone()
    {
        QFETCH(QString, first);
        QFETCH(QString, last);
        search();
        const QStringList before = shown();
        type("txtArtistKey", u"Ab"_s);
        type("txtHitjaarvan", first);
        type("txtHitjaartm", last);
        const bool order = first == u"2001";
        mDesktop->expectBox(order ? u"earlier than last hityear!"_s : u"Invalid year between"_s);
        search();
        QTEST(mScreen->focusWidget()->objectName(), "focus");
        QCOMPARE(shown(), before);
        QCOMPARE(status(), u"Busy searching ...."_s);
        QCOMPARE(mScreen->cursor().shape(), Qt::ArrowCursor);
    }

    void theScreenFollowsTheResult()
    {
        QVERIFY(control<QRadioButton>("optPartWord")->isChecked());
        QVERIFY(!control<QPushButton>("cmdExport")->isEnabled());
        QVERIFY(!list()->isEnabled());
        search();
        QVERIFY(control<QPushButton>("cmdExport")->isEnabled());
        QCOMPARE(mScreen->focusWidget(), list());
        type("txtArtistKey", u"nobody"_s);
        search();
        QVERIFY(!control<QPushButton>("cmdExport")->isEnabled());
        QVERIFY(!list()->isEnabled());
        QCOMPARE(mScreen->focusWidget(), control<QLineEdit>("txtArtistKey"));
    }

    void aFailureIsTold()
    {
        search();
        const int before = list()->ListItems().Count();
        mCatalogue->exec(u"alter table CompactDiscs rename to Elsewhere"_s);
        mDesktop->expectBox(u"no such table"_s);
        search();
        QCOMPARE(list()->ListItems().Count(), before);
        QCOMPARE(mScreen->cursor().shape(), Qt::WaitCursor);
    }

    // By Enter and by a double click, in any order; the search is not run again.
    void aRowOpensItsDisc()
    {
        type("txtArtistKey", u"o'neal"_s);
        search();
        emit list()->ColumnClick(5);
        const QStringList sorted = shown();
        const auto row = sorted.indexOf(QRegularExpression(u".*\\|Second\\|.*"_s));
        QVERIFY(row > 0);
        select(int(row));
        list()->setFocus();
        QTest::keyClick(list(), Qt::Key_Return);
        CdEditor *album = editor(u"frmCDRootE"_s);
        QVERIFY(album && album->CdId == 2);
        QCOMPARE(album->findChild<QTabBar *>(u"DiscsTab"_s)->currentIndex(), 1);
        QCOMPARE(shown(), sorted);
        QTest::keyClick(list(), Qt::Key_Return); // which brings the editor up again
        QCOMPARE(shown(), sorted);

        select(2);
        emit list()->DblClick();
        QVERIFY(editor(u"frmCDRoot"_s));
        mCatalogue->exec(u"delete from CompactDiscs"_s);
        mDesktop->expectBox(u"changed or removed"_s);
        emit list()->DblClick();
    }

    // The numbers of tracks are what they are: some are missing, some have gaps before them.
    void theRowOfAFoundTrack_data()
    {
        const DataRows<QString, int> row("number", "row");
        row("none", "", 1);
        row("behind none", "3", 2);
        row("behind a gap", "7", 3);
    }
    void theRowOfAFoundTrack()
    {
        QFETCH(QString, number);
        mCatalogue->exec("insert into CDTitels values (9,'Gaps',null,'V',null,null);"
                         "insert into CompactDiscs values (9001,9,1,7,101,null),"
                         "(9002,9,1,null,102,null),(9003,9,1,3,103,null),(9004,9,2,1,104,null)");
        search();
        const auto found =
            shown().indexOf(QRegularExpression(u".*\\|1\\|"_s + number + u"\\|Gaps\\|.*"_s));
        QVERIFY(found >= 0);
        select(int(found));
        emit list()->DblClick();
        QVERIFY(editor(u"frmCDRoot"_s));
        QTEST(editor(u"frmCDRoot"_s)->findChild<TrackGrid *>()->CurrentRow(), "row");
    }

    void exportsTheListAsItIsShown()
    {
        const QString name = mCatalogue->path(u"out"_s);
        type("txtTitleKey", u"é"_s);
        search();
        emit list()->ColumnClick(6);
        exportTo(name);
        QString expected;
        for (const QString &line : shown())
            expected += u'"' + QString(line).replace(u'|', u"\",\""_s) + u"\"\n"_s;
        QVERIFY(expected.contains(u"\"Mix \"one\"\""_s));
        QCOMPARE(QString::fromUtf8(readFile(name)), expected);

        exportTo({}); // cancelled
        writeFile(name, "mine");
        for (const auto answer : {vbNo, vbYes}) {
            mDesktop->expectBox(u"A file with the same name already exists!"_s, answer);
            exportTo(name);
            QCOMPARE(QString::fromUtf8(readFile(name)), answer == vbYes ? expected : u"mine"_s);
        }
    }

    // Nothing is left behind, and the old file stays. What cannot be opened is told in the panel
    // alone.
    void whatCannotBeWritten()
    {
        search();
        const QString name = writeFile(mCatalogue->path(u"out"_s), "mine");
        const QString told = u"The file could not be written: "_s;
        {
            const FullDisk full(4000);
            mDesktop->expectBox(u"already exists!"_s, vbYes);
            mDesktop->expectBox(u"/out\r"_s + qt_error_string(EFBIG));
            exportTo(name);
        }
        QCOMPARE(status(), told + name);
        QCOMPARE(readFile(name), "mine");
        QVERIFY(QDir(QFileInfo(name).path()).entryList({u"out?*"_s}).isEmpty());
        exportTo(name + u"/none"_s);
        QCOMPARE(status(), told + name + u"/none"_s);
        QCOMPARE(mScreen->cursor().shape(), Qt::ArrowCursor);
    }
};

QTEST_MAIN(tst_frmSearchArtistsTitles)
#include "tst_frmSearchArtistsTitles.moc"
