#include "textimport/frmImportDBBusy.h"

#include "catalogue/errorboxes.h"
#include "platform/ado/connection.h"
#include "platform/desktop/throttledpump.h"
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
    mLoading = true;
    setFramePointer(vbHourglass);
    Desktop::current().setPointer(this, vbHourglass);
    try {
        load();
    } catch (const Error &error) {
        showDatabaseErrors(error);
        gConnection->RollbackTrans();
        leave();
    }
}

void frmImportDBBusy::load()
{
    ThrottledPump pump;
    CatalogueLoad load;
    load.nextTrack = std::ref(pump);
    load.show = [this](int percent, const QString &label) {
        mUi->DBImportProgressBar->setValue(percent);
        mUi->lblRead->setText(label);
    };
    load.ask = [](const QString &question) { return askYesNoCancel(question); };
    if (load.run() == CatalogueLoad::Outcome::Committed)
        tellImported(load.importedCount());
    else
        tellCancelled();
}

void frmImportDBBusy::tellImported(qsizetype count)
{
    Desktop::current().pump();
    resetPointers();
    informationBox(GetMessage("MsgNumImpTracks") + QString::number(count));
    Desktop::current().pump();
    leave();
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
    leave();
}

void frmImportDBBusy::resetPointers()
{
    setFramePointer(vbDefault);
    Desktop::current().setPointer(this, vbDefault);
}

void frmImportDBBusy::leave()
{
    mLoading = false;
    Unload();
}
