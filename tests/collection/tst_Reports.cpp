// Label: screen
#include "collection/frmCDList.h"
#include "collection/frmPageSetup.h"
#include "collection/reportpaper.h"
#include "collection/reports.h"
#include "collection/reportview.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QComboBox>
#include <QLabel>
#include <QProcess>
#include <QPushButton>
#include <QRadioButton>
#include <QRegularExpression>
#include <QSpinBox>
#include <QStatusBar>
#include <QTabWidget>
#include <QTest>
#include <QTimer>
#include <QToolButton>
#include <csignal>
#include <sys/resource.h>

/// The printed reports from the button of the browser to the text of the file, on a real catalogue.
class tst_Reports : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void allRowsArePrinted_data();
    void allRowsArePrinted();
    void textsStayWithinTheMargins();
    void nothingToPrint();
    void aSecondPressShowsWhatIsNew();
    void anErrorRises();
    void whatCannotBeWrittenIsTold_data();
    void whatCannotBeWrittenIsTold();
    void withoutAPrinterThereIsAFile();
    void aLongOneOpensAtOnceAndCanBeStopped();
    void goingThroughThePages();
    void thePaperIsRemembered();
    void settingsThatCannotBeUsed();

private:
    Report *open(int tab);
    Report *openLong(qsizetype rows);
    QString path(const QString &name) const { return mCatalogue->path(name); }
    template <typename Control> static Control *control(Report *report, const char *name)
    {
        return report->findChild<Control *>(QLatin1String(name));
    }
    static void press(Report *report, const char *name)
    {
        control<QAbstractButton>(report, name)->click();
    }

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<TestCatalogue> mCatalogue;
};

namespace
{

/// No file grows beyond this as long as this object lives, as on a disk that is full.
class FullDisk
{
public:
    explicit FullDisk(rlim_t size)
    {
        std::signal(SIGXFSZ, SIG_IGN);
        getrlimit(RLIMIT_FSIZE, &mWas);
        const rlimit limit{size, mWas.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FullDisk() { setrlimit(RLIMIT_FSIZE, &mWas); }

private:
    rlimit mWas;
};

QString textOf(const QString &pdf, const QString &mode)
{
    QProcess reader;
    reader.start(QStringLiteral("pdftotext"), {mode, pdf, QStringLiteral("-")});
    if (!reader.waitForFinished() || reader.exitCode() != 0)
        QTest::qFail("pdftotext (poppler-utils) cannot read the file", __FILE__, __LINE__);
    return QString::fromUtf8(reader.readAllStandardOutput());
}

// The lines of all pages between their head and foot; marks of direction are pdftotext's own.
QStringList linesOf(const QString &pdf, qsizetype headLines)
{
    static const QRegularExpression marks(QStringLiteral("[\u200e\u200f\u202a-\u202e]"));
    QStringList all;
    QStringList pages = textOf(pdf, QStringLiteral("-layout")).remove(marks).split(QChar(u'\f'));
    pages.removeLast(); // behind the last one
    for (const QString &page : pages) {
        QStringList lines = page.split(u'\n', Qt::SkipEmptyParts);
        all += lines.mid(headLines, lines.size() - headLines - 1);
    }
    for (QString &line : all)
        line = line.simplified().toCaseFolded();
    return all;
}

QStringList folded(QStringList rows)
{
    for (QString &row : rows)
        row = row.replace(u'|', u' ').simplified().toCaseFolded();
    return rows;
}

// 3,000 discs: repeats in other letters, quotes, line ends, signs of other scripts, long titles.
QString manyDiscs()
{
    return QStringLiteral(R"(
        with recursive n(i) as (select 1 union all select i + 1 from n where i < 700)
        insert into Artiesten select i, case when i % 7 = 3 then 'שלום' else case i % 7 when 0 then 'Édith O''Hara ' when 1 then 'Ünal "DJ" '
            when 2 then 'fi & <b>ffl</b> ' else 'Artist ' end || i end from n;
        with recursive n(i) as (select 1 union all select i + 1 from n where i < 9000)
        insert into Tracks select i, i % 700 + 1, case i % 11 when 0 then 'Where''s the Ñandú?'
            when 1 then 'WHERE''S THE ÑANDÚ?' when 2 then 'One line' || char(13, 10) || 'or two ' || i
            when 3 then '100%2 \ {x} (' || i else 'Song ' || (i / 3) end, null, null from n;
        with recursive n(i) as (select 1 union all select i + 1 from n where i < 3000)
        insert into CDTitels select i, case when i % 5 = 0 then 'Greatest Hits'
            when i % 97 = 0 then replace(hex(zeroblob(60)), '00', 'Long Title ') || i
            else 'Čo Disc ' || (i / 2) end,
            case when i % 3 = 0 then i % 700 + 1 end, case when i % 3 = 0 then 'E' else 'V' end, null, null
            from n;
        insert into CompactDiscs select ID, ID, 1, 1, ID, null from CDTitels;)");
}

} // namespace

void tst_Reports::init()
{
    gLanguage = languageEnglish;
    mDesktop = std::make_unique<ScriptedDesktop>();
    mCatalogue = std::make_unique<TestCatalogue>();
}

void tst_Reports::cleanup()
{
    const auto forms = Form::openForms();
    for (Form *form : forms)
        form->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    mCatalogue.reset();
    mDesktop->verifyAllCame();
    mDesktop.reset();
}

// Through the browser, as a person does.
Report *tst_Reports::open(int tab)
{
    auto &browser = defaultInstance<frmCDList>();
    browser.Show();
    browser.findChild<QTabWidget *>(QStringLiteral("CDTab"))->setCurrentIndex(tab);
    browser.findChild<QPushButton *>(QStringLiteral("cmdStartReport"))->click();
    auto *report = qobject_cast<Report *>(Form::openForms().last());
    report->activateWindow();
    return QTest::qWaitForWindowActive(report) ? report : nullptr;
}

Report *tst_Reports::openLong(qsizetype count)
{
    ADODB::Recordset rows;
    rows.appendField(QStringLiteral("artiest"), ADODB::adVarWChar);
    rows.appendField(QStringLiteral("titel"), ADODB::adVarWChar);
    rows.Open();
    for (qsizetype i = 0; i < count; ++i) {
        rows.AddNew();
        rows.Fields(0).setValue(QString::number(i / 9));
        rows.Fields(1).setValue(QStringLiteral("Title %1").arg(i));
    }
    auto &report = defaultInstance<AlbumReport>();
    QElapsedTimer clock;
    clock.start();
    report.setDataSource(rows);
    report.setCaption(AlbumReport::caption());
    report.Show();
    report.grab();
    if (clock.elapsed() > 500)
        QTest::qFail(qPrintable(QString::number(clock.elapsed())), __FILE__, __LINE__);
    report.activateWindow();
    return QTest::qWaitForWindowActive(&report) ? &report : nullptr;
}

void tst_Reports::allRowsArePrinted_data()
{
    QTest::addColumn<int>("tab");
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<QString>("rows");
    QTest::addColumn<int>("headLines");
    const auto row = [](int tab, const char *name, const char *caption, const char *rows,
                        int head) {
        QTest::newRow(name) << tab << QString::fromLatin1(name) << QString::fromLatin1(caption)
                            << QString::fromLatin1(rows) << head;
    };
    row(0, "CompilationReport", "Compilations",
        "select Titel from CDTitels where CD_Type = 'V' group by Titel order by Titel", 1);
    row(1, "AlbumReport", "Albums",
        "select Naam, Titel from CDTitels c join Artiesten a on a.ID = c.Artiest_ID where CD_Type "
        "= 'E' "
        "group by Naam, Titel order by Naam, Titel",
        2);
    row(2, "PlatenbakReport", "Records",
        "select Naam, Titel from Tracks t join Artiesten a on a.ID = t.Artiest_ID group by Naam, "
        "Titel "
        "order by Naam, Titel",
        2);
}

void tst_Reports::allRowsArePrinted()
{
    QFETCH(QString, rows);
    QFETCH(int, tab);
    QFETCH(int, headLines);
    mCatalogue->exec(manyDiscs());
    const QStringList expected = folded(mCatalogue->rows(rows));
    QVERIFY(expected.size() > 600 && expected.size() < 9000);
    Report *report = open(tab);
    QTEST(report->Name(), "name");
    QTEST(report->windowTitle(), "caption");
    const QString pdf = path(QStringLiteral("saved.pdf")),
                  paper = path(QStringLiteral("paper.pdf"));
    mDesktop->expectFile(pdf);
    QTest::keyClick(report, Qt::Key_E, Qt::ControlModifier);
    QCOMPARE(linesOf(pdf, headLines), expected);
    mDesktop->expectPrinter(paper);
    QTest::keyClick(report, Qt::Key_P, Qt::ControlModifier);
    QCOMPARE(linesOf(paper, headLines), expected);
    const QString text = textOf(pdf, QStringLiteral("-layout"));
    const QString last =
        QStringLiteral("Page %1 of %1").arg(control<QSpinBox>(report, "Page")->maximum());
    QVERIFY2(text.contains(last) && text.contains(QLatin1String("November 22, 2026")),
             qPrintable(text.last(300)));
}

void tst_Reports::textsStayWithinTheMargins()
{
    mCatalogue->exec(manyDiscs());
    Report *report = open(0);
    const QString pdf = path(QStringLiteral("saved.pdf"));
    mDesktop->expectFile(pdf);
    press(report, "cmdPdf");
    static const QRegularExpression word(QStringLiteral("xMax=\"([0-9.]+)\""));
    double furthest = 0;
    for (const auto &match : word.globalMatch(textOf(pdf, QStringLiteral("-bbox"))))
        furthest = std::max(furthest, match.captured(1).toDouble());
    const QRectF paper = reportpaper::stored().fullRect(QPageLayout::Point);
    const double margin = 15 / 25.4 * 72;
    QVERIFY2(furthest <= paper.width() - margin + 1 && furthest > paper.width() - margin - 10,
             qPrintable(QString::number(furthest)));
}

void tst_Reports::nothingToPrint()
{
    for (int tab = 0; tab < 3; ++tab) {
        Report *report = open(tab);
        QVERIFY(report->isVisible());
        QCOMPARE(control<QLabel>(report, "lblPages")->text(), QStringLiteral("of 1"));
        const QString pdf = path(QString::number(tab));
        mDesktop->expectFile(pdf);
        press(report, "cmdPdf");
        QVERIFY(linesOf(pdf, tab == 0 ? 1 : 2).isEmpty());
        QVERIFY(textOf(pdf, QStringLiteral("-raw")).contains(report->windowTitle()));
    }
}

void tst_Reports::aSecondPressShowsWhatIsNew()
{
    mCatalogue->exec(QStringLiteral("insert into CDTitels values (1,'A',null,'V',null,null)"));
    Report *first = open(0);
    const auto lines = [first] {
        return control<QStatusBar>(first, "TheStatusBar")->currentMessage();
    };
    QCOMPARE(lines(), QStringLiteral("Number of lines: 1"));
    mCatalogue->exec(QStringLiteral("insert into CDTitels values (2,'B',null,'v',null,null)"));
    QCOMPARE(open(0), first);
    QCOMPARE(lines(), QStringLiteral("Number of lines: 2"));
}

void tst_Reports::anErrorRises()
{
    auto &browser = defaultInstance<frmCDList>();
    browser.Show();
    mCatalogue->exec(QStringLiteral("drop table CDTitels"));
    auto *button = browser.findChild<QPushButton *>(QStringLiteral("cmdStartReport"));
    QVERIFY_EXCEPTION_THROWN(button->click(), ADODB::Error);
    QCOMPARE(browser.cursor().shape(), Qt::WaitCursor);
    QCOMPARE(Form::openForms().size(), 1);
}

void tst_Reports::whatCannotBeWrittenIsTold_data()
{
    QTest::addColumn<QString>("what");
    for (const char *what : {"no such folder", "read-only folder", "full disk", "printer"})
        QTest::newRow(what) << QString::fromLatin1(what);
}

void tst_Reports::whatCannotBeWrittenIsTold()
{
    QFETCH(QString, what);
    Report *report = openLong(what == QLatin1String("full disk") ? 20000 : 10);
    const QString folder = path(what), pdf = folder + QStringLiteral("/old.pdf");
    if (what == QLatin1String("printer")) {
        mDesktop->expectPrinter(pdf);
        mDesktop->expectBox(QStringLiteral("error [File error] The printer cannot be used"));
        press(report, "cmdPrint");
        return;
    }
    const bool there = what != QLatin1String("no such folder");
    if (there) {
        QVERIFY(QDir().mkpath(folder));
        writeFile(pdf, "old");
        QFile::setPermissions(path(QString()), QFile::Permissions(0x7755));
        QFile::setPermissions(folder, QFile::Permissions(0x5555));
        if (what == QLatin1String("full disk"))
            QFile::setPermissions(folder, QFile::Permissions(0x7777));
        mDesktop->expectBox(QStringLiteral("already exists"), vbYes);
    }
    mDesktop->expectFile(pdf);
    mDesktop->expectBox(QStringLiteral("error [File error] The PDF file cannot be written: ") +
                        pdf);
    {
        const OrdinaryUser user;
        const FullDisk disk(what == QLatin1String("full disk") ? 50000 : RLIM_INFINITY);
        press(report, "cmdPdf");
    }
    QFile file(pdf);
    QCOMPARE(file.open(QIODevice::ReadOnly), there);
    QCOMPARE(file.readAll(), QByteArray(there ? "old" : ""));
    QCOMPARE(QDir(folder).entryList(QDir::Files).size(), there ? 1 : 0);
    QVERIFY(report->Unload());
}

void tst_Reports::withoutAPrinterThereIsAFile()
{
    Report *report = openLong(10);
    const QString pdf = writeFile(path(QStringLiteral("there.pdf")), "old");
    for (const BoxAnswer replace : {vbNo, vbYes}) {
        mDesktop->expectPrinter({});
        mDesktop->expectBox(QStringLiteral("yes-no [Albums] There is no printer"), vbYes);
        mDesktop->expectFile(pdf);
        mDesktop->expectBox(QStringLiteral("already exists"), replace);
        press(report, "cmdPrint");
        QCOMPARE(QFileInfo(pdf).size() > 3, replace == vbYes);
    }
    mDesktop->expectPrinter({});
    mDesktop->expectBox(QStringLiteral("There is no printer"), vbNo);
    press(report, "cmdPrint");
}

// The timer fires in the midst of the writing; the clock runs in openLong().
void tst_Reports::aLongOneOpensAtOnceAndCanBeStopped()
{
    Report *report = openLong(100000);
    const QString pdf = path(QStringLiteral("long.pdf"));
    bool refused = false;
    QTimer::singleShot(0, report, [&] {
        refused = !report->Unload() && !control<QToolButton>(report, "cmdPdf")->isEnabled();
        QTest::keyClick(control<ReportView>(report, "Preview"), Qt::Key_Escape);
    });
    mDesktop->expectFile(pdf);
    press(report, "cmdPdf");
    QVERIFY(refused);
    QVERIFY(!report->isUnloaded());
    QVERIFY(QDir(QFileInfo(pdf).path()).entryList({QStringLiteral("long*")}).isEmpty());
    QVERIFY(control<QToolButton>(report, "cmdPdf")->isEnabled());
    QTest::keyClick(report, Qt::Key_Escape);
    QVERIFY(report->isUnloaded());
}

void tst_Reports::goingThroughThePages()
{
    Report *report = openLong(100000);
    auto *view = control<ReportView>(report, "Preview");
    auto *field = control<QSpinBox>(report, "Page");
    const int last = field->maximum();
    const auto key = [&](Qt::Key k, Qt::KeyboardModifiers with = {}) {
        QTest::keyClick(QApplication::focusWidget(), k, with);
        return field->value();
    };
    QCOMPARE(QApplication::focusWidget(), view);
    QCOMPARE(last, int((100000 + 50) / 51));
    QCOMPARE(key(Qt::Key_End), last);
    QVERIFY(!control<QToolButton>(report, "cmdNext")->isEnabled());
    QCOMPARE(key(Qt::Key_PageUp, Qt::ControlModifier), last - 1);
    QCOMPARE(key(Qt::Key_Home), 1);
    for (int i = 0; i < 4; ++i)
        key(Qt::Key_PageDown);
    QVERIFY(field->value() > 1 && field->value() < 5);
    field->setFocus();
    field->selectAll();
    QTest::keyClicks(field, QStringLiteral("1234"));
    QCOMPARE(key(Qt::Key_Return), 1234);
    QCOMPARE(QApplication::focusWidget(), view);
    for (const Qt::Key zoom : {Qt::Key_Plus, Qt::Key_0, Qt::Key_Minus}) {
        key(zoom, Qt::ControlModifier);
        QCOMPARE(view->currentPage(), 1233);
    }
    QCOMPARE(view->factor(), 0.9);
    QCOMPARE(control<QComboBox>(report, "Zoom")->currentText(), QStringLiteral("90 %"));
    emit control<QComboBox>(report, "Zoom")->activated(1);
    QCOMPARE(key(Qt::Key_PageDown), 1235);
}

void tst_Reports::thePaperIsRemembered()
{
    Report *report = openLong(1000);
    const int pages = control<QSpinBox>(report, "Page")->maximum();
    mDesktop->expectModal(QStringLiteral("frmPageSetup"), [](Form &form) {
        auto *paper = form.findChild<QComboBox *>(QStringLiteral("Paper"));
        paper->setCurrentIndex(paper->findData(QPageSize::A5));
        form.findChild<QRadioButton *>(QStringLiteral("Landscape"))->setChecked(true);
        auto *top = form.findChild<QSpinBox *>(QStringLiteral("MarginTop"));
        top->setValue(500);
        QCOMPARE(top->value(), 37); // a quarter of the paper
        QTest::keyClick(&form, Qt::Key_Return);
    });
    press(report, "cmdPageSetup");
    const int more = control<QSpinBox>(report, "Page")->maximum();
    QVERIFY(more > 2 * pages);
    mDesktop->expectModal(QStringLiteral("frmPageSetup"), [](Form &form) {
        form.findChild<QRadioButton *>(QStringLiteral("Portrait"))->setChecked(true);
        QTest::keyClick(&form, Qt::Key_Escape);
    });
    press(report, "cmdPageSetup");
    report->Unload();
    QCOMPARE(control<QSpinBox>(openLong(1000), "Page")->maximum(), more);
}

void tst_Reports::settingsThatCannotBeUsed()
{
    const QPageLayout usual = reportpaper::stored();
    clsRegistry settings;
    const QString key = QString(settingsKey) + QStringLiteral("\\Reports");
    settings.CreateKey(key);
    settings.SetValue(key, QStringLiteral("Paper"), QStringLiteral("Papyrus"));
    settings.SetValue(key, QStringLiteral("MarginLeft"), QStringLiteral("wide"));
    QCOMPARE(reportpaper::stored(), usual);
    settings.SetValue(key, QStringLiteral("MarginLeft"), 1000000);
    settings.SetValue(key, QStringLiteral("MarginTop"), -1);
    const QMarginsF margins = reportpaper::stored().margins(QPageLayout::Millimeter);
    QCOMPARE(margins.left(), double(int(usual.fullRect(QPageLayout::Millimeter).width() / 4)));
    QCOMPARE(margins.top(), 5.0);
}

QTEST_MAIN(tst_Reports)
#include "tst_Reports.moc"
