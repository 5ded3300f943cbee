#include "shell/frmHelp.h"

#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/globals.h"
#include "services/messages.h"
#include "shell/ui_frmHelp.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <QKeyEvent>
#include <QStandardPaths>
#include <QUrl>

using namespace Qt::StringLiterals;

frmHelp::frmHelp() : Form(u"frmHelp"_s), mUi(std::make_unique<Ui::frmHelp>())
{
    mUi->setupUi(this);
    mUi->Picture1->setSource(u":/icons/songcase.svg"_s);
    connect(mUi->Link, &QLabel::linkActivated, this, &frmHelp::Link_Click);
}

frmHelp::~frmHelp() = default;

QString frmHelp::guideAddress()
{
    const QString page = QLatin1String(gLanguage == languageDutch ? "nl" : "en") + u"/index.html"_s;
    const QString beside =
        QCoreApplication::applicationDirPath() + u"/../share/songcase-guide/"_s + page;
    QString file = QFileInfo(beside).canonicalFilePath();
    if (file.isEmpty())
        file = QStandardPaths::locate(QStandardPaths::GenericDataLocation,
                                      u"songcase-guide/"_s + page);
    return file.isEmpty() ? QString() : QUrl::fromLocalFile(file).toString();
}

void frmHelp::Form_Load()
{
    applyCaptions(this, {{"lblVisitOurWebsite", "lblVisitOurWebsite"},
                         {"lblToGetYourHelpOnLine", "lblToGetYourHelpOnLine"}});
    setWindowTitle(GetMessage("TTHelp"));
    const QString name = GetMessage("xGuide");
    mUi->Link->setText(u"<a href=\"guide\"><b>"_s + name + u"</b></a>"_s);
    mUi->Link->setAccessibleName(name);
    mUi->Link->setToolTip(guideAddress());
}

// The focus alone selects no link of a label: what does is the Tab of a person.
void frmHelp::Form_Activate()
{
    mUi->Link->setFocus();
    if (mUi->Link->hasSelectedText())
        return;
    QKeyEvent tab(QEvent::KeyPress, Qt::Key_Tab, Qt::NoModifier);
    QCoreApplication::sendEvent(mUi->Link, &tab);
}

void frmHelp::keyPressEvent(QKeyEvent *event)
{
    if (event->key() == Qt::Key_Escape)
        Unload();
    else
        Form::keyPressEvent(event);
}

void frmHelp::Link_Click()
{
    const auto noBrowser = [] { errorBox(u"No browser detected!"_s); };
    const QString address = guideAddress();
    if (address.isEmpty())
        noBrowser();
    else
        Desktop::current().openAddress(address, noBrowser);
}

void ShowHelpLinks()
{
    defaultInstance<frmHelp>().Show();
}
