#pragma once

#include "platform/ado/recordset.h"
#include "platform/desktop/form.h"
#include "reports/reportoutput.h"
#include "reports/reportpainter.h"

#include <QPageLayout>
#include <memory>

class QAbstractButton;
class QKeySequence;
class LongWork;
class QProgressBar;
namespace Ui
{
class Report;
}

/// The preview of a printed report, a modeless screen: pages to look through, to set up, to print
/// and to write into a PDF file. Each report is a subclass with a default instance.
class Report : public Form
{
    Q_OBJECT

public:
    ~Report() override;

    /// The open recordset whose rows are printed; a report that is shown shows the new ones. Throws
    /// Error if it is not that of a report.
    void setDataSource(const ADODB::Recordset &source);
    void setCaption(const QString &caption);

protected:
    explicit Report(const QString &name);
    void Form_Load() override;
    void Form_Activate() override;
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    using Work = std::function<reportoutput::Result(const reportoutput::Progress &)>;

    void setCaptions();
    void connectControls();
    void connectZoom();
    void connectKeys();
    void onKeys(const QKeySequence &keys, QAbstractButton *button);
    void layOut();
    void showPage();
    void showZoom();
    void enable(QAbstractButton *button, bool enabled);
    void cmdCancel_Click();
    void command(void (Report::*routine)());
    void print();
    void writePdf();
    void setUpPage();
    void run(const QString &failure, const char *stopped, const Work &work);
    void showBusy(bool busy);
    ReportPainter painter() const;

    std::unique_ptr<Ui::Report> mUi;
    QProgressBar *mProgress;
    std::shared_ptr<const ReportContent> mContent;
    ADODB::Recordset mSource;
    QPageLayout mPaper;
    LongWork *mWork = nullptr; // the output, while one runs
};
