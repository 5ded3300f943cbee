// Label: screen
#include "collection/frmCDList.h"
#include "reports/frmPageSetup.h"
#include "reports/reportpaper.h"
#include "reports/reports.h"
#include "reports/reportview.h"
#include "services/clsRegistry.h"
#include "support/fulldisk.h"
#include "support/screentest.h"

#include <QComboBox>
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

namespace
{

QString textOf(const QString &pdf, const QString &mode)
{
    QProcess reader;
    reader.start(u"pdftotext"_s, {mode, pdf, u"-"_s});
    if (!reader.waitForFinished() || reader.exitCode() != 0)
        QTest::qFail("pdftotext (poppler-utils) cannot read the file", __FILE__, __LINE__);
    return QString::fromUtf8(reader.readAllStandardOutput());
}

// The lines of all pages of a tab's report between their head and foot; marks of direction are
// pdftotext's own.
QStringList linesOf(const QString &pdf, int tab)
{
    const int headLines = tab == 0 ? 1 : 2;
    static const QRegularExpression marks(u"[\u200e\u200f\u202a-\u202e]"_s);
    QStringList all;
    QStringList pages = textOf(pdf, u"-layout"_s).remove(marks).split(QChar(u'\f'));
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
    return uR"(
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
        insert into CompactDiscs select ID, ID, 1, 1, ID, null from CDTitels;)"_s;
}

} // namespace

/// The printed reports from the button of the browser to the text of the file, on a real catalogue.
class tst_Reports : public ScreenTest
{
    Q_OBJECT

private slots:
    void allRowsArePrinted_data()
    {
        const DataRows<QString, int, QString> row("name", "tab", "rows");
        row("CompilationReport", 0,
            "select Titel from CDTitels where CD_Type = 'V' group by Titel order by Titel");
        row("AlbumReport", 1,
            "select Naam, Titel from CDTitels c join Artiesten a on a.ID = c.Artiest_ID"
            " where CD_Type = 'E' group by Naam, Titel order by Naam, Titel");
        row("PlatenbakReport", 2,
            "select Naam, Titel from Tracks t join Artiesten a on a.ID = t.Artiest_ID"
            " group by Naam, Titel order by Naam, Titel");
    }

    void allRowsArePrinted()
    {
        QFETCH(QString, rows);
        QFETCH(int, tab);
        mCatalogue->exec(manyDiscs());
        const QStringList expected = folded(mCatalogue->rows(rows));
        QVERIFY(expected.size() > 600 && expected.size() < 9000);
        Report *report = open(tab);
        QTEST(report->Name(), "name");
        const QString pdf = path(u"saved.pdf"_s), paper = path(u"paper.pdf"_s);
        mDesktop->expectFile(pdf);
        QTest::keyClick(report, Qt::Key_E, Qt::ControlModifier);
        QCOMPARE(linesOf(pdf, tab), expected);
        mDesktop->expectPrinter(paper);
        QTest::keyClick(report, Qt::Key_P, Qt::ControlModifier);
        QCOMPARE(linesOf(paper, tab), expected);
        const QString text = textOf(pdf, u"-layout"_s);
        const QString last = u"Page %1 of %1"_s.arg(control<QSpinBox>(report, "Page")->maximum());
        QVERIFY2(text.contains(last) && text.contains("November 22, 2026"_L1),
                 qPrintable(text.last(300)));
    }

    void theLastPageFirst()
    {
        Report *report = openLong(150);
        const QString paper = path(u"paper.pdf"_s);
        mDesktop->expectPrinter(paper, QPrinter::LastPageFirst);
        press(report, "cmdPrint");
        const QStringList pages = textOf(paper, u"-layout"_s).split(QChar(u'\f'));
        QCOMPARE(pages.size(), 4);
        for (int page = 0; page < 3; ++page)
            QVERIFY(pages[page].contains(u"Page %1 of 3"_s.arg(3 - page)));
    }

    void textsStayWithinTheMargins()
    {
        mCatalogue->exec(manyDiscs());
        Report *report = open(0);
        const QString pdf = path(u"saved.pdf"_s);
        mDesktop->expectFile(pdf);
        press(report, "cmdPdf");
        static const QRegularExpression word(u"xMax=\"([0-9.]+)\""_s);
        double furthest = 0;
        for (const auto &match : word.globalMatch(textOf(pdf, u"-bbox"_s)))
            furthest = std::max(furthest, match.captured(1).toDouble());
        const QRectF paper = reportpaper::stored().fullRect(QPageLayout::Point);
        const double margin = 15 / 25.4 * 72;
        QVERIFY2(furthest <= paper.width() - margin + 1 && furthest > paper.width() - margin - 10,
                 qPrintable(QString::number(furthest)));
    }

    void nothingToPrint()
    {
        for (int tab = 0; tab < 3; ++tab) {
            Report *report = open(tab);
            const QString pdf = path(QString::number(tab));
            mDesktop->expectFile(pdf);
            press(report, "cmdPdf");
            QVERIFY(linesOf(pdf, tab).isEmpty());
            QVERIFY(textOf(pdf, u"-raw"_s).contains(report->windowTitle()));
        }
    }

    void aSecondPressShowsWhatIsNew()
    {
        mCatalogue->exec(u"insert into CDTitels values (1,'A',null,'V',null,null)"_s);
        Report *first = open(0);
        auto *lines = control<QStatusBar>(first, "TheStatusBar");
        QCOMPARE(lines->currentMessage(), u"Number of lines: 1"_s);
        mCatalogue->exec(u"insert into CDTitels values (2,'B',null,'v',null,null)"_s);
        QCOMPARE(open(0), first);
        QCOMPARE(lines->currentMessage(), u"Number of lines: 2"_s);
    }

    void anErrorRises()
    {
        auto &browser = defaultInstance<frmCDList>();
        browser.Show();
        mCatalogue->exec(u"drop table CDTitels"_s);
        auto *button = browser.findChild<QPushButton *>(u"cmdStartReport"_s);
        QVERIFY_EXCEPTION_THROWN(button->click(), Error);
        QCOMPARE(browser.cursor().shape(), Qt::WaitCursor);
        QCOMPARE(Form::openForms().size(), 1);
    }

    void whatCannotBeWrittenIsTold()
    {
        Report *report = openLong(20000);
        const QString pdf = writeFile(path(u"old.pdf"_s), "old");
        const QString nowhere = path(u"none/new.pdf"_s);
        mDesktop->expectPrinter(nowhere);
        mDesktop->expectBox(u"error [File error] The printer cannot be used"_s);
        press(report, "cmdPrint");
        mDesktop->expectFile(nowhere);
        mDesktop->expectBox(u"error [File error] The PDF file cannot be written: "_s + nowhere);
        press(report, "cmdPdf");
        mDesktop->expectFile(pdf);
        mDesktop->expectBox(u"already exists"_s, vbYes);
        mDesktop->expectBox(u"error [File error] The PDF file cannot be written: "_s + pdf);
        {
            const FullDisk disk(50000);
            press(report, "cmdPdf");
        }
        QCOMPARE(readFile(pdf), "old");
        QVERIFY(QDir(QFileInfo(pdf).path()).entryList({u"old.pdf?*"_s}).isEmpty());
        QVERIFY(report->Unload());
    }

    void withoutAPrinterThereIsAFile()
    {
        Report *report = openLong(10);
        const QString pdf = writeFile(path(u"there.pdf"_s), "old");
        for (const BoxAnswer replace : {vbNo, vbYes}) {
            mDesktop->expectPrinter({});
            mDesktop->expectBox(u"yes-no [Albums] There is no printer"_s, vbYes);
            mDesktop->expectFile(pdf);
            mDesktop->expectBox(u"already exists"_s, replace);
            press(report, "cmdPrint");
            QCOMPARE(QFileInfo(pdf).size() > 3, replace == vbYes);
        }
        mDesktop->expectPrinter({});
        mDesktop->expectBox(u"There is no printer"_s, vbNo);
        press(report, "cmdPrint");
    }

    // The timer fires in the midst of the writing; the clock runs in openLong().
    void aLongOneOpensAtOnceAndCanBeStopped()
    {
        Report *report = openLong(100000);
        const QString pdf = path(u"long.pdf"_s);
        bool refused = false;
        QTimer::singleShot(0, report, [&] {
            refused = !report->Unload() && !control<QToolButton>(report, "cmdPdf")->isEnabled();
            QTest::keyClick(control<ReportView>(report, "Preview"), Qt::Key_Escape);
        });
        mDesktop->expectFile(pdf);
        press(report, "cmdPdf");
        QVERIFY(refused && !report->isUnloaded());
        QVERIFY(QDir(QFileInfo(pdf).path()).entryList({u"long*"_s}).isEmpty());
        QVERIFY(control<QToolButton>(report, "cmdPdf")->isEnabled());
        QTest::keyClick(report, Qt::Key_Escape);
        QVERIFY(report->isUnloaded());
    }

    void goingThroughThePages()
    {
        Report *report = openLong(100000);
        auto *view = control<ReportView>(report, "Preview");
        auto *field = control<QSpinBox>(report, "Page");
        const int last = field->maximum();
        const auto typePage = [&](const QString &number) {
            field->setFocus();
            field->selectAll();
            QTest::keyClicks(field, number);
            QTest::keyClick(field, Qt::Key_Return);
            return field->value();
        };
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
        QCOMPARE(typePage(u"99999"_s), last);
        QCOMPARE(typePage(u"1234"_s), 1234);
        QCOMPARE(QApplication::focusWidget(), view);
        for (const Qt::Key zoom : {Qt::Key_Plus, Qt::Key_0, Qt::Key_Minus}) {
            key(zoom, Qt::ControlModifier);
            QCOMPARE(view->currentPage(), 1233);
        }
        QCOMPARE(control<QComboBox>(report, "Zoom")->currentText(), u"90 %"_s);
        emit control<QComboBox>(report, "Zoom")->activated(1);
        QCOMPARE(key(Qt::Key_PageDown), 1235);
    }

    void thePaperIsRemembered()
    {
        Report *report = openLong(1000);
        const int pages = control<QSpinBox>(report, "Page")->maximum();
        const auto turn = [](Form &form, const char *way) {
            form.findChild<QRadioButton *>(QLatin1String(way))->setChecked(true);
        };
        mDesktop->expectModal(u"frmPageSetup"_s, [&](Form &form) {
            auto *paper = form.findChild<QComboBox *>(u"Paper"_s);
            paper->setCurrentIndex(paper->findData(QPageSize::A5));
            turn(form, "Landscape");
            auto *left = form.findChild<QSpinBox *>(u"MarginLeft"_s);
            left->setValue(50);
            turn(form, "Portrait");
            QCOMPARE(left->value(), 37); // a quarter of the paper
            turn(form, "Landscape");
            QCOMPARE(left->value(), 50);
            QTest::keyClick(&form, Qt::Key_Return);
        });
        press(report, "cmdPageSetup");
        const int more = control<QSpinBox>(report, "Page")->maximum();
        QVERIFY(more > 2 * pages);
        mDesktop->expectModal(u"frmPageSetup"_s, [&](Form &form) {
            turn(form, "Portrait");
            QTest::keyClick(&form, Qt::Key_Escape);
        });
        press(report, "cmdPageSetup");
        report->Unload();
        QCOMPARE(control<QSpinBox>(openLong(1000), "Page")->maximum(), more);
    }

    void settingsThatCannotBeUsed()
    {
        const QPageLayout usual = reportpaper::stored();
        clsRegistry settings;
        const QString key = QString(settingsKey) + u"\\Reports"_s;
        settings.CreateKey(key);
        settings.SetValue(key, u"Paper"_s, u"Papyrus"_s);
        settings.SetValue(key, u"MarginLeft"_s, u"wide"_s);
        QCOMPARE(reportpaper::stored(), usual);
        settings.SetValue(key, u"MarginLeft"_s, 1000000);
        settings.SetValue(key, u"MarginTop"_s, -1);
        const QMarginsF margins = reportpaper::stored().margins(QPageLayout::Millimeter);
        QCOMPARE(margins.left(), double(int(usual.fullRect(QPageLayout::Millimeter).width() / 4)));
        QCOMPARE(margins.top(), 5.0);
    }

private:
    // Through the browser, as a person does.
    Report *open(int tab)
    {
        auto &browser = defaultInstance<frmCDList>();
        browser.Show();
        browser.findChild<QTabWidget *>(u"CDTab"_s)->setCurrentIndex(tab);
        browser.findChild<QPushButton *>(u"cmdStartReport"_s)->click();
        auto *report = qobject_cast<Report *>(Form::openForms().last());
        report->activateWindow();
        return QTest::qWaitForWindowActive(report) ? report : nullptr;
    }

    Report *openLong(qsizetype count)
    {
        ADODB::Recordset rows;
        rows.appendField(u"artiest"_s, ADODB::adVarWChar);
        rows.appendField(u"titel"_s, ADODB::adVarWChar);
        rows.Open();
        for (qsizetype i = 0; i < count; ++i) {
            rows.AddNew();
            rows.Fields(0).setValue(QString::number(i / 9));
            rows.Fields(1).setValue(u"Title %1"_s.arg(i));
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

    QString path(const QString &name) const { return mCatalogue->path(name); }
    template <typename Control> static Control *control(Report *report, const char *name)
    {
        return report->findChild<Control *>(QLatin1String(name));
    }
    static void press(Report *report, const char *name)
    {
        control<QAbstractButton>(report, name)->click();
    }
};

QTEST_MAIN(tst_Reports)
#include "tst_Reports.moc"
