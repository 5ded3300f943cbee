#include "discdata/ProxyInfo.h"

#include "discdata/ui_ProxyInfo.h"
#include "platform/text/textrules.h"
#include "services/captions.h"
#include "services/clsRegistry.h"
#include "services/frame.h"

using namespace Qt::StringLiterals;

ProxyInfo::ProxyInfo() : Form(u"ProxyInfo"_s), mUi(std::make_unique<Ui::ProxyInfo>())
{
    mUi->setupUi(this);
    // Qt's echo character may differ by style; the screen shows a star for each character.
    mUi->ProxyPassword->setStyleSheet(u"lineedit-password-character: 42"_s);
    setDefaultButton(mUi->cmdOK);
    setCancelButton(mUi->cmdCancel);
    for (QLineEdit *field :
         {mUi->ProxyServer, mUi->ProxyServerPort, mUi->ProxyUserName, mUi->ProxyPassword})
        connect(field, &QLineEdit::textChanged, this, &ProxyInfo::checkFields);
    connect(mUi->cmdOK, &QPushButton::clicked, this, &ProxyInfo::cmdOK_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
}

ProxyInfo::~ProxyInfo() = default;

void ProxyInfo::Form_Load()
{
    placeInFrame(this, 0.25, 0.25);
    readSettings();
    applyCaptions(this, {{"ProxyInfo", "ProxyInfoCaption"},
                         {"lblProxyPassword", "lblProxyPassword"},
                         {"lblProxyServer", "lblProxyServer"},
                         {"lblProxyServerPort", "lblProxyServerPort"},
                         {"lblProxyUserName", "lblProxyUserName"},
                         {"cmdCancel", "cmdCancel"},
                         {"chkUseProxy", "chkUseProxy"}});
}

void ProxyInfo::readSettings()
{
    clsRegistry settings;
    settings.ysnFailSoftRead = true;
    const auto read = [&](const QString &name) {
        return settings.GetValue(settingsReadKey, name).toString();
    };
    mUi->chkUseProxy->setChecked(read(u"UseProxy"_s) == u'1');
    for (QLineEdit *field :
         {mUi->ProxyServer, mUi->ProxyServerPort, mUi->ProxyUserName, mUi->ProxyPassword})
        field->setText(read(field->objectName()));
}

// By design: whether the proxy is used plays no part, so one is switched off with valid fields too.
void ProxyInfo::checkFields()
{
    const QString port = mUi->ProxyServerPort->text();
    const bool portFits = !port.isEmpty() && text::isNumeric(port);
    const bool bothOrNone =
        mUi->ProxyUserName->text().isEmpty() == mUi->ProxyPassword->text().isEmpty();
    mUi->cmdOK->setEnabled(!mUi->ProxyServer->text().isEmpty() && portFits && bothOrNone);
}

void ProxyInfo::cmdOK_Click()
{
    clsRegistry settings;
    settings.CreateKey(settingsKey);
    settings.SetValue(settingsKey, u"UseProxy"_s, mUi->chkUseProxy->isChecked() ? 1 : 0);
    for (const QLineEdit *field :
         {mUi->ProxyPassword, mUi->ProxyServer, mUi->ProxyServerPort, mUi->ProxyUserName})
        settings.SetValue(settingsKey, field->objectName(), field->text());
    Unload();
}
