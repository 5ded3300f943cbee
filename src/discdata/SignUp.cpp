#include "discdata/SignUp.h"

#include "discdata/serviceoptions.h"
#include "discdata/ui_SignUp.h"
#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

#include <QUrl>

using namespace Qt::StringLiterals;

namespace
{

// Empty stands for the usual one.
bool isAddress(const QString &text)
{
    if (text.isEmpty())
        return true;
    const QUrl url(text.contains("://"_L1) ? text : u"https://"_s + text, QUrl::StrictMode);
    const bool web = url.scheme() == "https"_L1 || url.scheme() == "http"_L1;
    return web && url.isValid() && !url.host().isEmpty() && url.userInfo().isEmpty();
}

} // namespace

SignUp::SignUp(CddbUserProfile profile)
    : Form(u"SignUp"_s), mUi(std::make_unique<Ui::SignUp>()), mProfile(std::move(profile))
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdYes);
    setCancelButton(mUi->cmdNo);
    setCaptions();
    show(mProfile);
    connectControls();
    followChecks();
}

SignUp::~SignUp() = default;

void SignUp::Form_Load()
{
    placeInFrame(this, 0.25, 0.1);
}

void SignUp::setCaptions()
{
    applyCaptions(this, {{"SignUp", "xSignUpCaption"},
                         {"lblWhat", "xSignUpWhat"},
                         {"fraServices", "xSignUpServices"},
                         {"cmdUp", "xSignUpUp"},
                         {"cmdDown", "xSignUpDown"},
                         {"fraYou", "xSignUpYou"},
                         {"lblName", "xSignUpName"},
                         {"lblMail", "xSignUpMail"},
                         {"lblMailUse", "xSignUpMailUse"},
                         {"fraAddresses", "xSignUpAddresses"},
                         {"lblMusicBrainzAddress", "xSignUpMusicBrainz"},
                         {"lblCDDBAddress", "xSignUpCDDB"},
                         {"cmdYes", "xSignUpYes"},
                         {"cmdNo", "cmdCancelCaption"}});
    mUi->Services->setAccessibleName(GetMessage("xSignUpServices"));
    mUi->txtMusicBrainzAddress->setPlaceholderText(ServiceOptions().musicBrainzAddress);
    mUi->txtCDDBAddress->setPlaceholderText(ServiceOptions().cddbAddress);
}

void SignUp::show(const CddbUserProfile &profile)
{
    QStringList order = profile.services;
    for (const QString &service : knownServices()) {
        if (!order.contains(service))
            order.append(service);
    }
    for (const QString &service : std::as_const(order)) {
        auto *item = new QListWidgetItem(serviceTitle(service), mUi->Services);
        item->setData(Qt::UserRole, service);
        item->setFlags(Qt::ItemIsEnabled | Qt::ItemIsSelectable | Qt::ItemIsUserCheckable);
        item->setCheckState(profile.services.contains(service) ? Qt::Checked : Qt::Unchecked);
    }
    mUi->Services->setCurrentRow(0);
    mUi->txtName->setText(profile.name);
    mUi->txtMail->setText(profile.mail);
    mUi->txtMusicBrainzAddress->setText(profile.musicBrainzAddress);
    mUi->txtCDDBAddress->setText(profile.cddbAddress);
}

void SignUp::connectControls()
{
    connect(mUi->cmdUp, &QPushButton::clicked, this, [this] { moveService(-1); });
    connect(mUi->cmdDown, &QPushButton::clicked, this, [this] { moveService(+1); });
    connect(mUi->Services, &QListWidget::itemChanged, this, &SignUp::followChecks);
    connect(mUi->Services, &QListWidget::currentRowChanged, this, &SignUp::followChecks);
    connect(mUi->cmdYes, &QPushButton::clicked, this, &SignUp::cmdYes_Click);
    connect(mUi->cmdNo, &QPushButton::clicked, this, &Form::Unload);
}

void SignUp::moveService(int step)
{
    const int from = mUi->Services->currentRow(), to = from + step;
    if (from < 0 || to < 0 || to >= mUi->Services->count())
        return;
    mUi->Services->insertItem(to, mUi->Services->takeItem(from));
    mUi->Services->setCurrentRow(to);
    followChecks();
}

void SignUp::followChecks()
{
    const int row = mUi->Services->currentRow();
    mUi->cmdUp->setEnabled(row > 0);
    mUi->cmdDown->setEnabled(row >= 0 && row + 1 < mUi->Services->count());
    const bool mail = chosenServices().contains("cddb"_L1);
    mUi->lblMailUse->setVisible(mail);
}

QStringList SignUp::chosenServices() const
{
    QStringList chosen;
    for (int row = 0; row < mUi->Services->count(); ++row) {
        const QListWidgetItem *item = mUi->Services->item(row);
        if (item->checkState() == Qt::Checked)
            chosen.append(item->data(Qt::UserRole).toString());
    }
    return chosen;
}

// What stands in the way of a yes, as the key of its message; the field gets the focus.
const char *SignUp::refusal() const
{
    const QString mail = mUi->txtMail->text().trimmed();
    const bool needsMail = chosenServices().contains("cddb"_L1);
    const auto wrong = [](QWidget *field, const char *key) {
        field->setFocus();
        return key;
    };
    // Who has signed up takes it back by choosing none.
    if (chosenServices().isEmpty() && !mProfile.registered)
        return wrong(mUi->Services, "xSignUpNoService");
    if (mail.isEmpty() ? needsMail : !isMailAddress(mail))
        return wrong(mUi->txtMail, "xSignUpNoMail");
    if (!isAddress(mUi->txtMusicBrainzAddress->text().trimmed()))
        return wrong(mUi->txtMusicBrainzAddress, "xSignUpNoAddress");
    if (!isAddress(mUi->txtCDDBAddress->text().trimmed()))
        return wrong(mUi->txtCDDBAddress, "xSignUpNoAddress");
    return nullptr;
}

void SignUp::cmdYes_Click()
{
    if (const char *key = refusal()) {
        errorBox(GetMessage(QLatin1String(key)));
        return;
    }
    mProfile.services = chosenServices();
    mProfile.registered = !mProfile.services.isEmpty();
    mProfile.name = mUi->txtName->text().trimmed();
    mProfile.mail = mUi->txtMail->text().trimmed();
    mProfile.musicBrainzAddress = mUi->txtMusicBrainzAddress->text().trimmed();
    mProfile.cddbAddress = mUi->txtCDDBAddress->text().trimmed();
    mAccepted = true;
    Unload();
}
