#pragma once

#include "platform/desktop/form.h"

#include <memory>

class ListColumns;
namespace Ui
{
class frmWhatCD;
}

/// Asks which title of the catalogue a disc of a box set belongs to. SearchKey and CDType are set
/// before it is shown, CD_ID is read behind it: 0 means no choice.
class frmWhatCD : public Form
{
    Q_OBJECT

public:
    frmWhatCD();
    ~frmWhatCD() override;

    QString CDType; // "V" or "E"
    QString SearchKey;
    qint64 CD_ID = 0;

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    void connectControls();
    bool showTitles(const std::optional<QString> &text);
    void cmdShowAll_Click();
    void OKButton_Click();
    void CancelButton_Click();
    template <typename Fill> void fill(Fill fillList);

    std::unique_ptr<Ui::frmWhatCD> mUi;
    ListColumns *mColumns = nullptr;
};
