#pragma once

#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class frmHelp;
}

/// Tells where the guide is and opens it in the browser of the desktop.
class frmHelp : public Form
{
    Q_OBJECT

public:
    frmHelp();
    ~frmHelp() override;

    /// The address of the guide in the language of the run. Empty if it is not installed.
    static QString guideAddress();

protected:
    void Form_Load() override;
    void Form_Activate() override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    void Link_Click();

    std::unique_ptr<Ui::frmHelp> mUi;
};

/// Shows frmHelp, modeless.
void ShowHelpLinks();
