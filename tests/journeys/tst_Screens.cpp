// Label: journey
#include "collection/frmCDList.h"
#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "platform/ado/connection.h"
#include "reports/frmPageSetup.h"
#include "reports/reportpaper.h"
#include "reports/reports.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/frmHelp.h"
#include "shell/frmSplash.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"
#include "textimport/frmImport.h"
#include "textimport/frmImportBusy.h"
#include "textimport/frmImportDBBusy.h"
#include "textimport/frmImportWizard.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>
#include <QStyle>
#include <QTest>
#include <QTimer>
#include <functional>

namespace
{

using Make = std::function<Form *()>;

template <typename Screen> Make make()
{
    return [] { return new Screen; };
}

template <typename Editor> Make makeEditor()
{
    return [] {
        auto *editor = new Editor;
        editor->Mode = u"I"_s;
        return editor;
    };
}

// With the rows that its command gives.
template <typename PrintedReport> Make makeReport()
{
    return [] {
        auto *report = new PrintedReport;
        report->setDataSource(gConnection->Execute(PrintedReport::command()));
        report->setCaption(PrintedReport::caption());
        return report;
    };
}

Form *makePageSetup()
{
    const auto rows = gConnection->Execute(AlbumReport::command());
    const auto content = std::make_shared<ReportContent>(rows, AlbumReport::caption(), QDate());
    return new frmPageSetup(content, reportpaper::stored());
}

QString textOf(const QWidget *w)
{
    return w->property("text").toString() + w->property("title").toString() + w->windowTitle() +
           w->toolTip() + w->accessibleName();
}

bool needsName(const QWidget *w)
{
    return qobject_cast<const QAbstractButton *>(w) || qobject_cast<const QLineEdit *>(w) ||
           qobject_cast<const QAbstractItemView *>(w) || qobject_cast<const QProgressBar *>(w);
}

bool hasName(const QWidget *w, const QWidget *screen)
{
    const auto *button = qobject_cast<const QAbstractButton *>(w);
    if (!w->accessibleName().isEmpty() || (button && !button->text().isEmpty()))
        return true;
    const auto labels = screen->findChildren<QLabel *>();
    return std::any_of(labels.begin(), labels.end(), [w](QLabel *l) { return l->buddy() == w; });
}

bool isCut(const QWidget *w)
{
    if (const auto *label = qobject_cast<const QLabel *>(w); label && label->wordWrap())
        return label->heightForWidth(label->width()) > label->height();
    if (!qobject_cast<const QLabel *>(w) && !qobject_cast<const QAbstractButton *>(w))
        return false;
    return w->sizeHint().width() > w->width() || w->sizeHint().height() > w->height();
}

bool isPartOfAnother(const QWidget *w)
{
    return w->objectName().isEmpty() || w->objectName().startsWith("qt_"_L1);
}

} // namespace

/// What holds for every screen in both languages: each text comes from the table, is shown whole,
/// and each control has a name that a screen reader can say.
class tst_Screens : public QObject
{
    Q_OBJECT

private slots:
    void everyScreen_data()
    {
        QTest::addColumn<int>("language");
        QTest::addColumn<Make>("make");
        const std::pair<const char *, Make> screens[] = {
            {"frmSplash", make<frmSplash>()},
            {"frmHelp", make<frmHelp>()},
            {"frmCDList", make<frmCDList>()},
            {"frmCDRoot", makeEditor<frmCDRoot>()},
            {"frmCDRootE", makeEditor<frmCDRootE>()},
            {"frmImportWizard", make<frmImportWizard>()},
            {"frmImportBusy", make<frmImportBusy>()},
            {"frmImport", make<frmImport>()},
            {"frmImportDBBusy", make<frmImportDBBusy>()},
            {"CompilationReport", makeReport<CompilationReport>()},
            {"AlbumReport", makeReport<AlbumReport>()},
            {"PlatenbakReport", makeReport<PlatenbakReport>()},
            {"frmPageSetup", makePageSetup}};
        for (const auto &[name, make] : screens) {
            QTest::newRow(QByteArray(name).append(", English")) << languageEnglish << make;
            QTest::newRow(QByteArray(name).append(", Dutch")) << languageDutch << make;
        }
    }

    void everyScreen()
    {
        QFETCH(int, language);
        QFETCH(Make, make);
        gLanguage = language;
        ScriptedDesktop desktop;
        TestCatalogue catalogue;
        Form *screen = make();
        QCOMPARE(screen->Name(), QString::fromLatin1(QTest::currentDataTag()).section(u',', 0, 0));
        for (QTimer *timer : screen->findChildren<QTimer *>())
            timer->stop();
        screen->Show();
        QVERIFY(QTest::qWaitForWindowExposed(screen));
        QVERIFY2(!screen->windowTitle().isEmpty(), "a window without a title");

        for (const QWidget *w : screen->findChildren<QWidget *>()) {
            const QByteArray name = w->objectName().toLatin1();
            const QString text = textOf(w);
            QVERIFY2(!text.contains("Unknown"_L1) && !text.contains("Onbekend"_L1), name);
            if (isPartOfAnother(w) || !w->isVisible())
                continue;
            QVERIFY2(!needsName(w) || hasName(w, screen),
                     QByteArray(name).append(": no name for a screen reader"));
            QVERIFY2(!isCut(w), QByteArray(name).append(": text cut: ").append(text.toUtf8()));
        }
        screen->Unload();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    }
};

QTEST_MAIN(tst_Screens)
#include "tst_Screens.moc"
