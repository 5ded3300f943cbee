#pragma once

#include "platform/desktop/form.h"
#include "reports/reportcontent.h"

#include <QHash>
#include <QPageLayout>
#include <memory>

class QSpinBox;
namespace Ui
{
class frmPageSetup;
}

/// Asks for paper, orientation and margins of a report, with a picture of what they make of it.
class frmPageSetup : public Form
{
    Q_OBJECT

public:
    frmPageSetup(std::shared_ptr<const ReportContent> content, const QPageLayout &paper);
    ~frmPageSetup() override;

signals:
    void chosen(const QPageLayout &paper);

protected:
    void Form_Load() override;

private:
    void setCaptions();
    void connectControls();
    void showPaper(const QPageLayout &paper);
    QPageLayout paper() const;
    void paper_Change();
    void fit(QSpinBox *margin, double side);
    void cmdOK_Click();

    std::unique_ptr<Ui::frmPageSetup> mUi;
    QHash<QSpinBox *, int> mWanted; // margins as the user set them, though the paper be too small
    bool mFitting = false;
};
