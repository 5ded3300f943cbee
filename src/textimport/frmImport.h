#pragma once

#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class frmImport;
}

/// The review of an import: shows the tracks that were read, to look at only, and starts their way
/// into the catalogue. The import ends when it is closed.
class frmImport : public Form
{
    Q_OBJECT

public:
    frmImport();
    ~frmImport() override;

protected:
    void Form_Load() override;
    void Form_Unload() override;

private:
    void fillList();
    void StartDBImport_Click();

    std::unique_ptr<Ui::frmImport> mUi;
};
