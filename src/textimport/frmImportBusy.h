#pragma once

#include "platform/desktop/form.h"

#include <memory>

class FileReading;
class QTimer;
namespace Ui
{
class frmImportBusy;
}

/// Reads the chosen file as soon as it is on the screen, shows how far it has come, and makes way
/// for the review or says why the file cannot be used. It cannot be closed meanwhile.
class frmImportBusy : public Form
{
    Q_OBJECT

public:
    frmImportBusy();
    ~frmImportBusy() override;

protected:
    void Form_Load() override;
    void Form_Unload() override;

private:
    void StartReading_Timer();
    enum class Outcome { Read, Refused, Stopped };
    Outcome read(FileReading &reading); // a reason for a refusal was shown, if there is one
    void showReview();
    void refuse(int lineNumber);

    std::unique_ptr<Ui::frmImportBusy> mUi;
    QTimer *mStartReading;
};
