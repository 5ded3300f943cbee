#include "textimport/frmImportBusy.h"

#include "platform/work/longwork.h"
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
    setFramePointer(vbHourglass);
    Desktop::current().setPointer(this, vbHourglass);
    setWindowTitle(GetMessage("BusyReadingFile") + gImportFile);
    FileReading reading;
    switch (read(reading)) {
    case Outcome::Read:
        showReview();
        break;
    case Outcome::Refused:
        refuse(reading.lineNumber());
        break;
    case Outcome::Stopped:
        setImportEnabled(true);
        Unload();
    }
}

frmImportBusy::Outcome frmImportBusy::read(FileReading &reading)
{
    LongWork work(*this);
    work.showPercent = [&](int percent) {
        mUi->ImportProgressBar->setValue(percent);
        mUi->lblRead->setText(reading.label(percent));
    };
    reading.step = [&](qint64 done, qint64 all) { return work.step(done, all); };
    try {
        reading.run();
        return Outcome::Read;
    } catch (const FileReading::Stopped &) {
        return Outcome::Stopped; // the program ends
    } catch (const DataError &error) {
        errorBox(atLine(error.line, u": "_s + error.reason), GetMessage("FileError"));
    } catch (const std::exception &) {
        // What cannot be taken apart has no reason but the general one.
    }
    return Outcome::Refused;
}

// The pointers stay as they are until the review has loaded.
void frmImportBusy::showReview()
{
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
    Unload();
}
