#pragma once

#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class frmWhatNow;
}

/// Asks what becomes of a disc whose data are not complete; Answer is read behind it.
class frmWhatNow : public Form
{
    Q_OBJECT

public:
    frmWhatNow();
    ~frmWhatNow() override;

    QString Answer; // "0" cancelled, "1" insert with dummies, "2" edit

protected:
    void Form_Load() override;

private:
    void answer(const QString &text);
    void OKButton_Click();

    std::unique_ptr<Ui::frmWhatNow> mUi;
};
