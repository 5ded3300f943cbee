#pragma once

#include "platform/desktop/form.h"

#include <memory>

class QCheckBox;
namespace Ui
{
class frmImportWizard;
}

/// Asks for a text file and for its format, and starts its reading. What was chosen stays in
/// gImportFile and the four flags of the formats.
class frmImportWizard : public Form
{
    Q_OBJECT

public:
    frmImportWizard();
    ~frmImportWizard() override;

protected:
    void Form_Load() override;
    void Form_Unload() override;

private:
    void connectControls();
    void pair(QCheckBox *one, QCheckBox *other);
    void cmdBrowse_Click();
    void txtFileName_Change();
    void cmdImport_Click();
    void takeFormat();

    std::unique_ptr<Ui::frmImportWizard> mUi;
};
