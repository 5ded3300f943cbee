#include "reports/Report.h"

#include "platform/work/longwork.h"
#include "reports/frmPageSetup.h"
#include "reports/reportpaper.h"
#include "reports/ui_Report.h"
#include "services/captions.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/messages.h"

#include <QKeyEvent>
#include <QPrinter>
#include <QProgressBar>
#include <QScopedValueRollback>
#include <QShortcut>

using namespace Qt::StringLiterals;

namespace
{

constexpr int fitWidth = 0, wholePage = 1, firstStep = 2; // entries of Zoom

QString percent(double factor)
{
    return reportLocale().toString(qRound(factor * 100)) + u" %"_s;
}

} // namespace

Report::Report(const QString &name)
    : Form(name), mUi(std::make_unique<Ui::Report>()), mProgress(new QProgressBar)
{
    mUi->setupUi(this);
    mUi->TheStatusBar->addPermanentWidget(mProgress);
    setCancelButton(mUi->cmdCancel);
    setCaptions();
    connectControls();
    connectZoom();
    connectKeys();
    showBusy(false);
}

Report::~Report() = default;

void Report::setCaptions()
{
    applyCaptions(this, {{"cmdPrint", "xReportPrint"},
                         {"cmdPdf", "xReportPdf"},
                         {"cmdPageSetup", "xReportSetup"},
                         {"cmdZoomOut", "xZoomOut", Caption::ToolTip},
                         {"Zoom", "xZoom", Caption::ToolTip},
                         {"cmdZoomIn", "xZoomIn", Caption::ToolTip},
                         {"cmdFirst", "xFirstPage", Caption::ToolTip},
                         {"cmdPrevious", "xPreviousPage", Caption::ToolTip},
                         {"cmdNext", "xNextPage", Caption::ToolTip},
                         {"cmdLast", "xLastPage", Caption::ToolTip},
                         {"lblPage", "xReportPageField"}});
    mUi->cmdPrint->setToolTip(GetMessage("xPrint") + u" (Ctrl+P)"_s);
    mUi->cmdPdf->setToolTip(GetMessage("xReportPdfTip") + u" (Ctrl+E)"_s);
    mUi->cmdPageSetup->setToolTip(GetMessage("xReportSetupTip"));
    mUi->Preview->setAccessibleName(GetMessage("xPreview"));
    mProgress->setAccessibleName(GetMessage("xProgress"));
    mUi->Page->setLocale(reportLocale());
    mUi->Page->setGroupSeparatorShown(true);
    mUi->Zoom->addItems({GetMessage("xFitWidth"), GetMessage("xWholePage")});
    for (const double step : ReportView::zoomSteps())
        mUi->Zoom->addItem(percent(step));
}

void Report::connectControls()
{
    connect(mUi->cmdPrint, &QToolButton::clicked, this, [this] { command(&Report::print); });
    connect(mUi->cmdPdf, &QToolButton::clicked, this, [this] { command(&Report::writePdf); });
    connect(mUi->cmdPageSetup, &QToolButton::clicked, this,
            [this] { command(&Report::setUpPage); });
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Report::cmdCancel_Click);
    ReportView *view = mUi->Preview;
    connect(view, &ReportView::pageChanged, this, &Report::showPage);
    connect(mUi->cmdFirst, &QToolButton::clicked, view, [view] { view->goToPage(0); });
    connect(mUi->cmdPrevious, &QToolButton::clicked, view,
            [view] { view->goToPage(view->currentPage() - 1); });
    connect(mUi->cmdNext, &QToolButton::clicked, view,
            [view] { view->goToPage(view->currentPage() + 1); });
    connect(mUi->cmdLast, &QToolButton::clicked, view,
            [view] { view->goToPage(view->pageCount() - 1); });
    mUi->Page->installEventFilter(this);
    connect(mUi->Page, &QSpinBox::valueChanged, view, [view](int n) { view->goToPage(n - 1); });
}

void Report::connectZoom()
{
    ReportView *view = mUi->Preview;
    connect(view, &ReportView::zoomChanged, this, &Report::showZoom);
    connect(mUi->cmdZoomIn, &QToolButton::clicked, view, [view] { view->zoomBy(1); });
    connect(mUi->cmdZoomOut, &QToolButton::clicked, view, [view] { view->zoomBy(-1); });
    connect(mUi->Zoom, &QComboBox::activated, view, [view](int entry) {
        if (entry == fitWidth)
            view->setZoom(ReportView::Zoom::FitWidth);
        else if (entry == wholePage)
            view->setZoom(ReportView::Zoom::WholePage);
        else
            view->setZoom(ReportView::Zoom::Fixed,
                          ReportView::zoomSteps()[std::size_t(entry - firstStep)]);
    });
}

void Report::connectKeys()
{
    onKeys(QKeySequence::Print, mUi->cmdPrint);
    onKeys(Qt::CTRL | Qt::Key_E, mUi->cmdPdf);
    onKeys(Qt::CTRL | Qt::Key_Plus, mUi->cmdZoomIn);
    onKeys(Qt::CTRL | Qt::Key_Equal, mUi->cmdZoomIn); // the same key without Shift
    onKeys(Qt::CTRL | Qt::Key_Minus, mUi->cmdZoomOut);
    onKeys(Qt::CTRL | Qt::Key_Home, mUi->cmdFirst);
    onKeys(Qt::CTRL | Qt::Key_PageUp, mUi->cmdPrevious);
    onKeys(Qt::CTRL | Qt::Key_PageDown, mUi->cmdNext);
    onKeys(Qt::CTRL | Qt::Key_End, mUi->cmdLast);
    auto *actualSize = new QShortcut(Qt::CTRL | Qt::Key_0, this);
    actualSize->setContext(Qt::WidgetWithChildrenShortcut);
    connect(actualSize, &QShortcut::activated, mUi->Preview,
            [this] { mUi->Preview->setZoom(ReportView::Zoom::Fixed, 1); });
}

void Report::onKeys(const QKeySequence &keys, QAbstractButton *button)
{
    auto *shortcut = new QShortcut(keys, this);
    shortcut->setContext(Qt::WidgetWithChildrenShortcut);
    connect(shortcut, &QShortcut::activated, button, &QAbstractButton::click);
}

// Enter in the field leaves it for the page. Ctrl+E is the screen's, though a field has a use for
// it.
bool Report::eventFilter(QObject *watched, QEvent *event)
{
    const auto type = event->type();
    if (type != QEvent::ShortcutOverride && type != QEvent::KeyRelease)
        return Form::eventFilter(watched, event);
    const auto *key = static_cast<QKeyEvent *>(event);
    const bool enter = key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter;
    if (type == QEvent::KeyRelease && enter)
        mUi->Preview->setFocus();
    return type == QEvent::ShortcutOverride && key->keyCombination() == (Qt::CTRL | Qt::Key_E);
}

void Report::Form_Load()
{
    makeRoomInFrame(this);
    placeInFrame(this, 0.08, 0.02);
}

void Report::Form_Activate()
{
    mUi->Preview->setFocus();
}

void Report::setDataSource(const ADODB::Recordset &source)
{
    mSource = source;
    mPaper = reportpaper::stored();
    layOut();
}

void Report::setCaption(const QString &caption)
{
    setWindowTitle(caption);
    layOut();
}

void Report::layOut()
{
    if (mSource.State() == ADODB::adStateClosed)
        return;
    mContent =
        std::make_shared<ReportContent>(mSource, windowTitle(), Desktop::current().now().date());
    mUi->Preview->setReport(painter());
    if (!mWork)
        mUi->TheStatusBar->showMessage(mContent->count());
    showPage();
}

ReportPainter Report::painter() const
{
    return {mContent, ReportLayout(mPaper, mContent->rowCount(), mContent->hasArtists())};
}

void Report::showPage()
{
    const ReportView &view = *mUi->Preview;
    const qsizetype page = view.currentPage(), pages = view.pageCount();
    const QSignalBlocker blocker(mUi->Page); // the view is there already
    mUi->Page->setRange(1, int(pages));
    mUi->Page->setValue(int(page) + 1);
    mUi->lblPages->setText(GetMessage("xReportOf").trimmed() + u' ' +
                           reportLocale().toString(pages));
    for (QAbstractButton *button : {mUi->cmdFirst, mUi->cmdPrevious})
        enable(button, page > 0);
    for (QAbstractButton *button : {mUi->cmdNext, mUi->cmdLast})
        enable(button, page + 1 < pages);
}

// The focus of a button that is disabled would go to the next one: a key pressed again must not
// close the screen.
void Report::enable(QAbstractButton *button, bool enabled)
{
    if (!enabled && button->hasFocus())
        mUi->Preview->setFocus();
    button->setEnabled(enabled);
}

void Report::showZoom()
{
    const ReportView &view = *mUi->Preview;
    const auto &steps = ReportView::zoomSteps();
    int entry = view.zoom() == ReportView::Zoom::FitWidth ? fitWidth : wholePage;
    if (view.zoom() == ReportView::Zoom::Fixed)
        entry =
            firstStep + int(std::find(steps.begin(), steps.end(), view.factor()) - steps.begin());
    mUi->Zoom->setCurrentIndex(entry < mUi->Zoom->count() ? entry : -1);
    enable(mUi->cmdZoomIn, view.factor() < steps.back());
    enable(mUi->cmdZoomOut, view.factor() > steps.front());
}

// One at a time; the screen stays meanwhile, also below a dialog.
void Report::command(void (Report::*routine)())
{
    if (!mContent || !LongWork::mayBegin(*this))
        return;
    const Busy stays(*this);
    (this->*routine)();
}

void Report::print()
{
    QPrinter printer(QPrinter::HighResolution);
    printer.setPageLayout(mPaper);
    switch (Desktop::current().choosePrinter(printer, int(mUi->Preview->pageCount()))) {
    case PrinterChoice::Cancelled:
        return;
    case PrinterChoice::NoPrinter:
        if (askYesNo(GetMessage("xNoPrinter"), windowTitle()) == vbYes)
            writePdf();
        return;
    case PrinterChoice::Chosen:
        break;
    }
    run(GetMessage("xPrintFailed"), "xReportStopped", [&](const reportoutput::Progress &progress) {
        return reportoutput::print(printer, mContent, mUi->Preview->currentPage(), progress);
    });
}

void Report::writePdf()
{
    const QString name = Desktop::current().saveFileName({GetMessage("xReportPdfTip"), saveFolder(),
                                                          GetMessage("xPdfFiles"), u"pdf"_s,
                                                          windowTitle() + u".pdf"_s});
    if (name.isEmpty() || !mayWrite(name))
        return;
    rememberSaveFolder(name);
    run(GetMessage("xPdfFailed") + name, "xPdfStopped",
        [&](const reportoutput::Progress &progress) {
            return reportoutput::writePdf(name, painter(), mPaper, progress);
        });
}

// A failure is told with these words and the reason behind them.
void Report::run(const QString &failure, const char *stopped, const Work &work)
{
    LongWork running(*this);
    running.showPercent = [this](int percent) { mProgress->setValue(percent); };
    const QScopedValueRollback<LongWork *> cancellable(mWork, &running);
    showBusy(true);
    qsizetype written = 0;
    const auto result = work([&](qsizetype done, qsizetype all) {
        written = done;
        return running.step(done, all);
    });
    showBusy(false);
    const bool whole = result.outcome == reportoutput::Outcome::Done;
    mUi->TheStatusBar->showMessage(
        whole ? GetMessage("xReportDone") + reportLocale().toString(written) : GetMessage(stopped));
    if (result.outcome == reportoutput::Outcome::Failed)
        errorBox(result.reason.isEmpty() ? failure : failure + u'\r' + result.reason,
                 GetMessage("FileError"));
}

void Report::showBusy(bool busy)
{
    mProgress->setValue(0);
    mProgress->setVisible(busy);
    for (QToolButton *button : {mUi->cmdPrint, mUi->cmdPdf, mUi->cmdPageSetup})
        enable(button, !busy);
    applyCaptions(this, {{"cmdCancel", busy ? "cmdCancelCaption" : "xClose"}});
    if (busy)
        mUi->TheStatusBar->showMessage(GetMessage("xReportBusy"));
}

void Report::setUpPage()
{
    auto *setup = new frmPageSetup(mContent, mPaper);
    connect(setup, &frmPageSetup::chosen, this, [this](const QPageLayout &paper) {
        mPaper = paper;
        reportpaper::store(paper);
        layOut();
    });
    setup->ShowModal();
}

void Report::cmdCancel_Click()
{
    if (mWork)
        mWork->cancel();
    else
        Unload();
}
