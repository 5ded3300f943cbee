#pragma once

#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class ProxyInfo;
}

/// Whether what is asked of the services goes through a proxy, and through which. The values go
/// into the settings as typed, the password in plain text.
class ProxyInfo : public Form
{
    Q_OBJECT

public:
    ProxyInfo();
    ~ProxyInfo() override;

protected:
    void Form_Load() override;

private:
    void readSettings();
    void checkFields();
    void cmdOK_Click();

    std::unique_ptr<Ui::ProxyInfo> mUi;
};
