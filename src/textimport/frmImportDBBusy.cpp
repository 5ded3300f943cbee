#include "textimport/frmImportDBBusy.h"

#include "catalogue/errorboxes.h"
#include "platform/ado/connection.h"
#include "platform/work/longwork.h"
#include "services/browser.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/catalogueload.h"
#include "textimport/ui_frmImportDBBusy.h"

#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

constexpr double shareOfFrame = 1.0 / 3;

void unloadReview()
{
    const auto forms = Form::openForms();
    for (Form *form : forms) {
        if (form->Name() == "frmImport"_L1)
            form->Unload();
    }
}

} // namespace

frmImportDBBusy::frmImportDBBusy()
    : Form(u"frmImportDBBusy"_s),
      mUi(std::make_unique<Ui::frmImportDBBusy>()),
      mStartImporting(new QTimer(this))
{
    mUi->setupUi(this);
    mStartImporting->setObjectName(u"StartImporting"_s);
    connect(mStartImporting, &QTimer::timeout, this, &frmImportDBBusy::StartImporting_Timer);
    mStartImporting->start(1);
}

frmImportDBBusy::~frmImportDBBusy() = default;

void frmImportDBBusy::Form_Load()
{
    placeInFrame(this, shareOfFrame, shareOfFrame);
    applyCaptions(this, {{"frmImportDBBusy", "frmImportDBBusyCaption"}});
    mUi->DBImportProgressBar->setAccessibleName(GetMessage("xProgress"));
}

void frmImportDBBusy::Form_Unload()
{
    mStartImporting->stop();
}

// By design: a load that fails leaves the hourglass where it is.
void frmImportDBBusy::StartImporting_Timer()
{
    mStartImporting->stop();
    setFramePointer(vbHourglass);
    Desktop::current().setPointer(this, vbHourglass);
    try {
        load();
    } catch (const Error &error) {
        showDatabaseErrors(error);
        gConnection->RollbackTrans();
        Unload();
    }
}

void frmImportDBBusy::load()
{
    CatalogueLoad load;
    switch (run(load)) {
    case CatalogueLoad::Outcome::Committed:
        tellImported(load.importedCount());
        break;
    case CatalogueLoad::Outcome::Cancelled:
        tellCancelled();
    }
}

CatalogueLoad::Outcome frmImportDBBusy::run(CatalogueLoad &load)
{
    LongWork work(*this);
    work.showPercent = [this](int percent) {
        mUi->DBImportProgressBar->setValue(percent);
        mUi->lblRead->setText(QString::number(percent) + GetMessage("PercentImported"));
    };
    load.step = [&](qint64 number, qint64 count) { return work.step(number, count); };
    load.ask = [](const QString &question) { return askYesNoCancel(question); };
    return load.run();
}

void frmImportDBBusy::tellImported(qsizetype count)
{
    Desktop::current().pump();
    resetPointers();
    informationBox(GetMessage("MsgNumImpTracks") + QString::number(count));
    Desktop::current().pump();
    Unload();
    unloadReview();
    Desktop::current().pump();
    refreshBrowser();
    Desktop::current().pump();
}

// The review stays, and the load can be started again.
void frmImportDBBusy::tellCancelled()
{
    resetPointers();
    informationBox(GetMessage("MsgImpCancel"));
    Unload();
}

void frmImportDBBusy::resetPointers()
{
    setFramePointer(vbDefault);
    Desktop::current().setPointer(this, vbDefault);
}
