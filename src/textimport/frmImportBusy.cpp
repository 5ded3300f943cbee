#include "textimport/frmImportBusy.h"

#include "platform/desktop/throttledpump.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/filereading.h"
#include "textimport/frmImport.h"
#include "textimport/ui_frmImportBusy.h"

#include <QTimer>

using namespace Qt::StringLiterals;

namespace
{

constexpr double shareOfFrame = 1.0 / 3;

QString atLine(int lineNumber, const QString &what)
{
    return GetMessage("ErrorAtLine") + QString::number(lineNumber) + what;
}

} // namespace

frmImportBusy::frmImportBusy()
    : Form(u"frmImportBusy"_s),
      mUi(std::make_unique<Ui::frmImportBusy>()),
      mStartReading(new QTimer(this))
{
    mUi->setupUi(this);
    mStartReading->setObjectName(u"StartReading"_s);
    connect(mStartReading, &QTimer::timeout, this, &frmImportBusy::StartReading_Timer);
    mStartReading->start(1);
}

frmImportBusy::~frmImportBusy() = default;

void frmImportBusy::Form_Load()
{
    placeInFrame(this, shareOfFrame, shareOfFrame);
    applyCaptions(this, {{"frmImportBusy", "frmImportBusyCaption"}});
    mUi->ImportProgressBar->setAccessibleName(GetMessage("xProgress"));
    setImportEnabled(false);
}

// Closed before it has begun: the import ends here.
void frmImportBusy::Form_Unload()
{
    if (mStartReading->isActive())
        setImportEnabled(true);
    mStartReading->stop();
}

void frmImportBusy::StartReading_Timer()
{
    mStartReading->stop();
    mReading = true;
    setFramePointer(vbHourglass);
    Desktop::current().setPointer(this, vbHourglass);
    setWindowTitle(GetMessage("BusyReadingFile") + gImportFile);
    ThrottledPump pump;
    FileReading reading;
    reading.lineRead = std::ref(pump);
    reading.show = [this](int percent, const QString &label) {
        mUi->ImportProgressBar->setValue(percent);
        mUi->lblRead->setText(label);
    };
    if (read(reading))
        showReview();
    else
        refuse(reading.lineNumber());
}

bool frmImportBusy::read(FileReading &reading)
{
    try {
        reading.run();
        return true;
    } catch (const DataError &error) {
        errorBox(atLine(error.line, u": "_s + error.reason), GetMessage("FileError"));
    } catch (const std::exception &) {
        // What cannot be taken apart has no reason but the general one.
    }
    return false;
}

// The pointers stay as they are until the review has loaded.
void frmImportBusy::showReview()
{
    mReading = false;
    mUi->lblRead->setText(GetMessage("BusyCreatingList"));
    Unload();
    freezeFrame();
    defaultInstance<frmImport>().Show();
}

void frmImportBusy::refuse(int lineNumber)
{
    setFramePointer(vbDefault);
    Desktop::current().setPointer(this, vbDefault);
    setImportEnabled(true);
    errorBox(atLine(lineNumber, GetMessage("InvalidFileFormat")));
    mReading = false;
    Unload();
}
