#pragma once

#include "discdata/cddbuserprofile.h"
#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class SignUp;
}

/// Tells what is sent where, and asks whether it may be: who the user is, which services are asked
/// and in which order.
class SignUp : public Form
{
    Q_OBJECT

public:
    explicit SignUp(CddbUserProfile profile);
    ~SignUp() override;

    bool isAccepted() const { return mAccepted; }
    const CddbUserProfile &profile() const { return mProfile; } // as accepted

protected:
    void Form_Load() override;

private:
    void setCaptions();
    void connectControls();
    void show(const CddbUserProfile &profile);
    void moveService(int step);
    void followChecks();
    QStringList chosenServices() const;
    const char *refusal() const;
    void cmdYes_Click();

    std::unique_ptr<Ui::SignUp> mUi;
    CddbUserProfile mProfile;
    bool mAccepted = false;
};
