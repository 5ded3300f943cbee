#pragma once

#include "discdata/cddbobjects.h"
#include "platform/desktop/form.h"

namespace Ui
{
class frmTracks;
}

/// Lets the user say which track of a disc a file is: Enter, a double click or OK does.
class frmTracks : public Form
{
    Q_OBJECT

public:
    frmTracks();
    ~frmTracks() override;

    void setDisc(const CddbDiscPtr &disc);     // before it is shown
    int TrackNum() const { return mTrackNum; } // from 1; 0: cancelled

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    void cmdOK_Click();

    std::unique_ptr<Ui::frmTracks> mUi;
    int mTrackNum = 0;
};
