#include "reports/frmPageSetup.h"

#include "platform/desktop/options.h"
#include "reports/reportpaper.h"
#include "reports/ui_frmPageSetup.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

#include <QScopedValueRollback>

using namespace Qt::StringLiterals;

namespace
{

// "A4 (210 × 297 mm)"
QString nameOf(const reportpaper::Size &size)
{
    const QSize mm = QPageSize(size.id).size(QPageSize::Millimeter).toSize();
    return QLatin1String(size.name) + u" ("_s + QString::number(mm.width()) + u" × "_s +
           QString::number(mm.height()) + u" mm)"_s;
}

} // namespace

frmPageSetup::frmPageSetup(std::shared_ptr<const ReportContent> content, const QPageLayout &paper)
    : Form(u"frmPageSetup"_s), mUi(std::make_unique<Ui::frmPageSetup>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdOK);
    setCancelButton(mUi->cmdCancel);
    setCaptions();
    for (const reportpaper::Size &size : reportpaper::sizes())
        mUi->Paper->addItem(nameOf(size), size.id);
    showPaper(paper);
    mUi->Picture->setReport(std::move(content));
    paper_Change();
    connectControls();
}

frmPageSetup::~frmPageSetup() = default;

void frmPageSetup::Form_Load()
{
    placeInFrame(this, 0.2, 0.2);
}

void frmPageSetup::setCaptions()
{
    applyCaptions(this, {{"frmPageSetup", "xReportSetupTip"},
                         {"lblPaper", "xPaper"},
                         {"fraOrientation", "xOrientation"},
                         {"Portrait", "xPortrait"},
                         {"Landscape", "xLandscape"},
                         {"fraMargins", "xMargins"},
                         {"lblLeft", "xMarginLeft"},
                         {"lblRight", "xMarginRight"},
                         {"lblTop", "xMarginTop"},
                         {"lblBottom", "xMarginBottom"},
                         {"cmdOK", "OKButtonCaption"},
                         {"cmdCancel", "cmdCancelCaption"}});
    mUi->Picture->setAccessibleName(GetMessage("xPreview"));
}

void frmPageSetup::connectControls()
{
    connect(mUi->Paper, &QComboBox::currentIndexChanged, this, &frmPageSetup::paper_Change);
    connect(mUi->Landscape, &QRadioButton::toggled, this, &frmPageSetup::paper_Change);
    for (QSpinBox *margin : findChildren<QSpinBox *>())
        connect(margin, &QSpinBox::valueChanged, this, [this, margin](int value) {
            if (mFitting)
                return;
            mWanted[margin] = value;
            paper_Change();
        });
    connect(mUi->cmdOK, &QPushButton::clicked, this, &frmPageSetup::cmdOK_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
}

void frmPageSetup::showPaper(const QPageLayout &paper)
{
    const QMargins margins = paper.margins(QPageLayout::Millimeter).toMargins();
    mUi->Paper->setCurrentIndex(mUi->Paper->findData(paper.pageSize().id()));
    chooseOption(paper.orientation() == QPageLayout::Landscape ? mUi->Landscape : mUi->Portrait);
    mUi->MarginLeft->setValue(margins.left());
    mUi->MarginTop->setValue(margins.top());
    mUi->MarginRight->setValue(margins.right());
    mUi->MarginBottom->setValue(margins.bottom());
    for (QSpinBox *margin : findChildren<QSpinBox *>())
        mWanted[margin] = margin->value();
}

QPageLayout frmPageSetup::paper() const
{
    return reportpaper::layout(QPageSize::PageSizeId(mUi->Paper->currentData().toInt()),
                               mUi->Landscape->isChecked() ? QPageLayout::Landscape
                                                           : QPageLayout::Portrait,
                               {mUi->MarginLeft->value(), mUi->MarginTop->value(),
                                mUi->MarginRight->value(), mUi->MarginBottom->value()});
}

// The margins may go as far as the paper allows.
void frmPageSetup::paper_Change()
{
    const QSizeF sheet = paper().fullRect(QPageLayout::Millimeter).size();
    fit(mUi->MarginLeft, sheet.width());
    fit(mUi->MarginRight, sheet.width());
    fit(mUi->MarginTop, sheet.height());
    fit(mUi->MarginBottom, sheet.height());
    mUi->Picture->setPaper(paper());
}

void frmPageSetup::fit(QSpinBox *margin, double side)
{
    const QScopedValueRollback<bool> fitting(mFitting, true);
    margin->setRange(reportpaper::smallestMargin, reportpaper::largestMargin(side));
    margin->setValue(mWanted.value(margin, margin->value()));
}

void frmPageSetup::cmdOK_Click()
{
    emit chosen(paper());
    Unload();
}
