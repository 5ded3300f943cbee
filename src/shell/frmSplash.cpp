#include "shell/frmSplash.h"

#include "platform/desktop/paintwait.h"
#include "services/messages.h"
#include "shell/ui_frmSplash.h"

#include <QScreen>

using namespace Qt::StringLiterals;

namespace
{

constexpr int nameSize = 20, otherSize = 13; // pixels

// Light on the dark ground of the picture, whatever the palette of the desktop is.
void setLight(QLabel *label, int pixels, int alpha)
{
    QFont font = label->font();
    font.setPixelSize(pixels); // the picture has one size, too
    font.setBold(pixels == nameSize);
    label->setFont(font);
    QPalette palette = label->palette();
    palette.setColor(QPalette::WindowText, QColor(255, 246, 230, alpha));
    label->setPalette(palette);
}

} // namespace

frmSplash::frmSplash() : Form(u"frmSplash"_s), mUi(std::make_unique<Ui::frmSplash>())
{
    mUi->setupUi(this);
    setWindowFlags(Qt::SplashScreen | Qt::FramelessWindowHint);
    setFixedSize(size());
    mUi->Picture1->setSource(u":/splash/splash.svg"_s);
    for (QLabel *label : {mUi->lblProgram, mUi->lblVersion, mUi->lblAuthor})
        label->hide();
    connect(mUi->Picture1, &SvgPicture::Painted, this, &frmSplash::showWords);
    connect(mUi->Picture1, &SvgPicture::Click, this, &Form::Unload);
}

frmSplash::~frmSplash() = default;

void frmSplash::Form_Load()
{
    const QString name = GetMessage("MainScreen.Caption");
    setWindowTitle(name);
    mUi->lblProgram->setText(name);
    mUi->lblVersion->setText(u"Version " SONGCASE_VERSION ""_s);
    mUi->Picture1->setAccessibleName(name);
    move(screen()->availableGeometry().center() - rect().center());
}

// The first words of a program make it load its fonts, which takes as long as the picture: that is
// shown first.
void frmSplash::showWords()
{
    setLight(mUi->lblProgram, nameSize, 255);
    setLight(mUi->lblVersion, otherSize, 220);
    setLight(mUi->lblAuthor, otherSize, 200);
    for (QLabel *label : {mUi->lblProgram, mUi->lblVersion, mUi->lblAuthor})
        label->show();
}

void frmSplash::waitUntilPainted()
{
    constexpr int longest = 100; // milliseconds
    paintUntil([this] { return mUi->Picture1->isPainted(); }, longest);
}

void frmSplash::setAuthor(const QString &text)
{
    mUi->lblAuthor->setText(text);
}

void frmSplash::keyPressEvent(QKeyEvent *)
{
    Unload();
}
