// Label: screen
#include "collection/cdeditor.h"
#include "collection/frmSearchArtistsTitles.h"
#include "controls/DBListViewCTL.h"
#include "controls/trackgrid.h"
#include "platform/ado/connection.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/editing.h"
#include "support/ordinaryuser.h"
#include "support/referencelike.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QClipboard>
#include <QPushButton>
#include <QRadioButton>
#include <QStatusBar>
#include <QTabBar>
#include <QTest>
#include <csignal>
#include <sys/resource.h>

/// The search on a real catalogue file, held against a slow matcher of its own.
class tst_frmSearchArtistsTitles : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void findsWhatTheMatcherFinds_data();
    void findsWhatTheMatcherFinds();
    void years_data();
    void years();
    void yearsThatAreNone_data();
    void yearsThatAreNone();
    void theScreenFollowsTheResult();
    void aFailureIsTold();
    void aRowOpensItsDisc();
    void aTrackThatIsGoneIsTold();
    void exportsTheListAsItIsShown();
    void anExistingFileIsKept();
    void whatCannotBeWritten_data();
    void whatCannotBeWritten();

private:
    enum Column { Artist, Title, Genre = 5, Type = 7 };
    void fill();
    QList<QStringList> allRows(); // as they are to be shown, by the columns of the list
    void type(const char *field, const QString &text) { control<QLineEdit>(field)->setText(text); }
    void choose(const QString &mode)
    {
        control<QRadioButton>(mode.toLatin1().constData())->setChecked(true);
    }
    void search()
    {
        control<QLineEdit>("txtGenre")->setFocus();
        QTest::keyClick(control<QLineEdit>("txtGenre"), Qt::Key_Return);
    }
    QStringList shown() const;
    template <typename Control> Control *control(const char *name) const
    {
        return mScreen->findChild<Control *>(QLatin1String(name));
    }
    DBListViewCTL *list() const { return control<DBListViewCTL>("ResultList"); }
    QString status() const { return control<QStatusBar>("StatusBar")->currentMessage(); }
    void exportTo(const QString &name);
    static QByteArray content(const QString &name);

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
    QPointer<frmSearchArtistsTitles> mScreen;
};

void tst_frmSearchArtistsTitles::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
    fill();
    mScreen = &defaultInstance<frmSearchArtistsTitles>();
    mScreen->Show();
    QVERIFY(QTest::qWaitForWindowActive(mScreen));
}

void tst_frmSearchArtistsTitles::cleanup()
{
    for (Form *form : Form::openForms())
        form->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

// Every artist has every title, on a compilation and on the second disc of an album, with genres
// and years, none among them, in turn.
void tst_frmSearchArtistsTitles::fill()
{
    mCatalogue->exec(QString::fromUtf8(R"(
        create temp table Name(n integer primary key, w);
        insert into Name(w) values ('O''Neal'),('Édith'),('edith ÉCLAIR'),('100% Pure'),('a_b'),
            ('axb'),('ÅSA'),('Жук'),(' lead'),('Ab');
        create temp table Kind(n integer primary key, g, y);
        insert into Kind values (0,'Pop',1985),(1,'pop/Rock',1900),(2,null,null),(3,'Rock',2000),
            (4,'ROCK',2001),(5,'%',1985);
        insert into Artiesten select n, w from Name;
        insert into Tracks select a.n * 100 + t.n, a.n, t.w || iif(t.n % 2, '', ' ' || t.n), g, y
            from Name a, Name t, Kind k where k.n = (a.n * 3 + t.n) % 6;
        insert into CDTitels values (1,'Mix "one"',null,'V',null,null),(2,'Second',1,'E',null,1999);
        insert into CompactDiscs select ID, 1, 1, ID, ID, null from Tracks;
        insert into CompactDiscs select ID + 5000, 2, 2, ID % 100 + Artiest_ID, ID, null
            from Tracks where ID % 3 = 0;)"));
}

QList<QStringList> tst_frmSearchArtistsTitles::allRows()
{
    QList<QStringList> all;
    const auto lines = mCatalogue->rows(QStringLiteral(
        "select a.Naam, t.Titel, DiskNo, TrackNo, c.Titel, t.Genre, t.Hitjaar, CD_Type"
        " from Artiesten a, Tracks t, CompactDiscs l, CDTitels c where t.Artiest_ID = a.ID"
        " and l.Track_ID = t.ID and l.CDTitels_ID = c.ID"
        " order by a.Naam, t.Titel, c.Titel, DiskNo, TrackNo"));
    for (const QString &line : lines) {
        QStringList row = line.split(u'|').replaceInStrings(QStringLiteral("NULL"), QString());
        row[Type] = QLatin1String(row[Type] == QLatin1String("V") ? "Compilation" : "Album");
        all.append(row);
    }
    return all;
}

QStringList tst_frmSearchArtistsTitles::shown() const
{
    QStringList lines;
    auto items = list()->ListItems();
    for (int i = 1; i <= items.Count(); ++i) {
        QStringList texts;
        for (int column = 0; column < 8; ++column)
            texts.append(items.Item(i).SubItems(column));
        lines.append(texts.join(u'|'));
    }
    return lines;
}

void tst_frmSearchArtistsTitles::findsWhatTheMatcherFinds_data()
{
    QTest::addColumn<QString>("before");
    QTest::addColumn<QString>("behind");
    const QString open = QStringLiteral("%");
    QTest::newRow("optFullWord") << QString() << QString();
    QTest::newRow("optPartWord") << open << open;
    QTest::newRow("optBeginWord") << QString() << open;
    QTest::newRow("optEndWord") << open << QString();
}

void tst_frmSearchArtistsTitles::findsWhatTheMatcherFinds()
{
    QFETCH(QString, before);
    QFETCH(QString, behind);
    choose(QString::fromLatin1(QTest::currentDataTag()));
    const QString veryLong(10000, u'x');
    const QStringList keys[] = {texts("", "", ""),
                                texts("o'n", "", ""),
                                texts("édith", "", ""),
                                texts("EDITH", "b", ""),
                                texts("", "%", "rock"),
                                texts("", "a_b", ""),
                                texts("ж", "å", ""),
                                texts(" ", "", "pop"),
                                texts("", "", "%"),
                                texts("a_", "ab 10", "p%k"),
                                texts("100% pure", "", ""),
                                texts("'; drop", "", ""),
                                {veryLong, veryLong, veryLong}};
    const auto rows = allRows();
    for (const QStringList &key : keys) {
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
        QCOMPARE(status(), QStringLiteral("Number of titles found: %1").arg(expected.size()));
    }
}

void tst_frmSearchArtistsTitles::years_data()
{
    QTest::addColumn<QString>("first");
    QTest::addColumn<QString>("last");
    QTest::addColumn<QString>("condition");
    const auto row = [](const char *first, const char *last, const char *condition) {
        QTest::addRow("%s to %s", first, last)
            << QString::fromLatin1(first) << QString::fromLatin1(last)
            << QString::fromLatin1(condition);
    };
    row("2000", "", "= 2000");
    row("", "2000", "= 2000");
    row("1985", "2000", "between 1985 and 2000");
    row("1985", "1985", "= 1985");
    row("1900", "", "= 1900");
    row("1900", "9999", "is not null");
    row("2e3 ", "", "= 2000");
    row("1e10", "", "= 0");
}

void tst_frmSearchArtistsTitles::years()
{
    QFETCH(QString, first);
    QFETCH(QString, last);
    QFETCH(QString, condition);
    type("txtHitjaarvan", first);
    type("txtHitjaartm", last);
    search();
    QCOMPARE(list()->ListItems().Count(),
             mCatalogue->count(QStringLiteral("select count(*) from Tracks t, CompactDiscs l where "
                                              "l.Track_ID = t.ID and t.Hitjaar ") +
                               condition));
}

void tst_frmSearchArtistsTitles::yearsThatAreNone_data()
{
    QTest::addColumn<QString>("first");
    QTest::addColumn<QString>("last");
    QTest::addColumn<QString>("message");
    QTest::addColumn<QString>("focus");
    const auto row = [](const char *first, const char *last, bool order, const char *focus) {
        QTest::addRow("%s to %s", first, last)
            << QString::fromLatin1(first) << QString::fromLatin1(last)
            << QString::fromLatin1(order ? "First hityear should be earlier than last hityear!"
                                         : "Invalid year between")
            << QString::fromLatin1(focus);
    };
    row("1899", "", false, "txtHitjaarvan");
    row("19x5", "1985", false, "txtHitjaarvan");
    row("01985", "", false, "txtHitjaarvan");
    row("", "198", false, "txtHitjaartm");
    row("1985", "1; x", false, "txtHitjaartm");
    row("2001", "2000", true, "txtHitjaarvan");
}

// The old list stays, and so do the words of the panel.
void tst_frmSearchArtistsTitles::yearsThatAreNone()
{
    QFETCH(QString, first);
    QFETCH(QString, last);
    QFETCH(QString, message);
    search();
    const QStringList before = shown();
    type("txtArtistKey", QStringLiteral("Ab"));
    type("txtHitjaarvan", first);
    type("txtHitjaartm", last);
    mDesktop->expectBox(message);
    search();
    QVERIFY(mDesktop->boxes.last().startsWith(QLatin1String("error")));
    QTEST(mScreen->focusWidget()->objectName(), "focus");
    QCOMPARE(shown(), before);
    QCOMPARE(status(), QStringLiteral("Busy searching ...."));
    QCOMPARE(mScreen->cursor().shape(), Qt::ArrowCursor);
}

void tst_frmSearchArtistsTitles::theScreenFollowsTheResult()
{
    QVERIFY(control<QRadioButton>("optPartWord")->isChecked());
    QVERIFY(!control<QPushButton>("cmdExport")->isEnabled());
    QVERIFY(!list()->isEnabled());
    search();
    QVERIFY(control<QPushButton>("cmdExport")->isEnabled());
    QCOMPARE(mScreen->focusWidget(), list());
    auto headers = list()->ColumnHeaders();
    const int room = list()->viewport()->width();
    QStringList heads;
    for (int column = 1; column <= 8; ++column)
        heads.append(headers.Item(column).Text());
    QCOMPARE(heads.join(u'|'),
             QStringLiteral("Artist|Title|Disc|Track|CD-title|Genre|Hityear|Type"));
    QVERIFY(std::abs(headers.Item(1).Width() - room * 3 / 13) <= 1);
    QVERIFY(std::abs(headers.Item(8).Width() - room / 13) <= 1);
    mScreen->resize(mScreen->width() + 260, mScreen->height());
    QTRY_VERIFY(list()->viewport()->width() > room);
    QCOMPARE(headers.Item(1).Width(), list()->viewport()->width() * 3 / 13);

    type("txtArtistKey", QStringLiteral("nobody"));
    search();
    QVERIFY(!control<QPushButton>("cmdExport")->isEnabled());
    QVERIFY(!list()->isEnabled());
    QCOMPARE(mScreen->focusWidget(), control<QLineEdit>("txtArtistKey"));
    QCOMPARE(list()->ListItems().Count(), 0);
}

void tst_frmSearchArtistsTitles::aFailureIsTold()
{
    search();
    const int before = list()->ListItems().Count();
    mCatalogue->exec(QStringLiteral("alter table CompactDiscs rename to Elsewhere"));
    mDesktop->expectBox(QStringLiteral("no such table"));
    search();
    QVERIFY(mDesktop->boxes.last().startsWith(QLatin1String("plain")));
    QCOMPARE(list()->ListItems().Count(), before);
    QCOMPARE(mScreen->cursor().shape(), Qt::WaitCursor);
    mCatalogue->exec(QStringLiteral("alter table Elsewhere rename to CompactDiscs"));
    search();
    QCOMPARE(mScreen->cursor().shape(), Qt::ArrowCursor);
}

// By Enter and by a double click, sorted or not; the search is not run again.
void tst_frmSearchArtistsTitles::aRowOpensItsDisc()
{
    choose(QStringLiteral("optFullWord"));
    type("txtArtistKey", QStringLiteral("o'neal"));
    type("txtTitleKey", QStringLiteral("%"));
    search();
    emit list()->ColumnClick(5);
    const QStringList sorted = shown();
    const int row = int(sorted.indexOf(QRegularExpression(QStringLiteral(".*\\|Second\\|.*"))));
    QVERIFY(row > 0);
    list()->setSelectedItem(list()->ListItems().Item(row + 1));
    list()->setFocus();
    QTest::keyClick(list(), Qt::Key_Return);
    const auto editorOf = [](const char *name) -> CdEditor * {
        for (Form *form : Form::openForms()) {
            if (form->Name() == QLatin1String(name))
                return qobject_cast<CdEditor *>(form);
        }
        return nullptr;
    };
    CdEditor *album = editorOf("frmCDRootE");
    QVERIFY(album);
    QCOMPARE(album->CdId, 2);
    QCOMPARE(album->findChild<QTabBar *>(QStringLiteral("DiscsTab"))->currentIndex(), 1);
    QCOMPARE(shown(), sorted);

    const ListItem third = list()->ListItems().Item(3);
    list()->setSelectedItem(third);
    emit list()->DblClick();
    CdEditor *compilation = editorOf("frmCDRoot");
    QVERIFY(compilation);
    QCOMPARE(compilation->CdId, 1);
    QCOMPARE(compilation->findChild<TrackGrid *>()->CurrentRow(),
             third.SubItems(3).toInt() - 100); // the tracks of the compilation count from 101
}

void tst_frmSearchArtistsTitles::aTrackThatIsGoneIsTold()
{
    search();
    mCatalogue->exec(QStringLiteral("delete from CompactDiscs"));
    mDesktop->expectBox(QStringLiteral("no longer in the catalogue"));
    QTest::keyClick(list(), Qt::Key_Return);
}

QByteArray tst_frmSearchArtistsTitles::content(const QString &name)
{
    QFile file(name);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

void tst_frmSearchArtistsTitles::exportTo(const QString &name)
{
    mDesktop->expectFile(name);
    QTest::mouseClick(control<QPushButton>("cmdExport"), Qt::LeftButton);
}

void tst_frmSearchArtistsTitles::exportsTheListAsItIsShown()
{
    const QString name = mCatalogue->path(QStringLiteral("out"));
    type("txtTitleKey", QStringLiteral("é"));
    search();
    emit list()->ColumnClick(6);
    exportTo(name);
    QString expected;
    for (const QString &line : shown())
        expected +=
            u'"' + QString(line).replace(u'|', QLatin1String("\",\"")) + QLatin1String("\"\n");
    QVERIFY(expected.contains(QLatin1String("\"Mix \"one\"\"")));
    QCOMPARE(QString::fromUtf8(content(name)), expected);

    exportTo(QString()); // cancelled
    QCOMPARE(QString::fromUtf8(content(name)), expected);
}

void tst_frmSearchArtistsTitles::anExistingFileIsKept()
{
    const QString name = mCatalogue->path(QStringLiteral("out"));
    search();
    writeFile(name, "mine");
    mDesktop->expectBox(QStringLiteral("A file with the same name already exists!"), vbNo);
    exportTo(name);
    QCOMPARE(content(name), QByteArray("mine"));
    mDesktop->expectBox(QStringLiteral("A file with the same name already exists!"), vbYes);
    exportTo(name);
    QVERIFY(content(name).startsWith("\" lead\""));
}

void tst_frmSearchArtistsTitles::whatCannotBeWritten_data()
{
    QTest::addColumn<bool>("diskFull");
    QTest::newRow("folder without rights") << false;
    QTest::newRow("disk full") << true;
}

// Nothing is left behind, and the old file stays. What cannot be opened is told in the panel alone.
void tst_frmSearchArtistsTitles::whatCannotBeWritten()
{
    QFETCH(bool, diskFull);
    const QString folder = mCatalogue->path(QStringLiteral("sub"));
    QDir().mkdir(folder);
    const QString name = folder + QStringLiteral("/out");
    writeFile(name, "mine");
    search();
    mDesktop->expectBox(QStringLiteral("already exists!"), vbYes);
    rlimit before;
    getrlimit(RLIMIT_FSIZE, &before);
    if (diskFull) {
        signal(SIGXFSZ, SIG_IGN);
        const rlimit little{4000, before.rlim_max};
        setrlimit(RLIMIT_FSIZE, &little);
        mDesktop->expectBox(QStringLiteral("The file could not be written"));
        exportTo(name);
        setrlimit(RLIMIT_FSIZE, &before);
    } else {
        QFile::setPermissions(folder, QFile::ReadOwner | QFile::ExeOwner | QFile::ReadOther |
                                          QFile::ExeOther);
        const OrdinaryUser nobody;
        exportTo(name);
    }
    QCOMPARE(status(), QString(QStringLiteral("The file could not be written: ") + name));
    QCOMPARE(content(name), QByteArray("mine"));
    QCOMPARE(QDir(folder).entryList(QDir::Files | QDir::Hidden).size(), 1);
    QCOMPARE(mScreen->cursor().shape(), Qt::ArrowCursor);
}

QTEST_MAIN(tst_frmSearchArtistsTitles)
#include "tst_frmSearchArtistsTitles.moc"
