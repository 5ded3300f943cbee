#include "textimport/frmImportWizard.h"

#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/frmImportBusy.h"
#include "textimport/ui_frmImportWizard.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

constexpr double shareOfWidth = 0.42, shareOfHeight = 0.1;

// What the field has room for: a longer name loses its middle.
QString shortened(const QString &name)
{
    constexpr qsizetype wholeBelow = 21, kept = 3, keptAtEnd = 18;
    if (name.size() < wholeBelow)
        return name;
    return name.first(kept) + u"......."_s + name.last(keptAtEnd);
}

} // namespace

frmImportWizard::frmImportWizard()
    : Form(u"frmImportWizard"_s), mUi(std::make_unique<Ui::frmImportWizard>())
{
    mUi->setupUi(this);
    connectControls();
    setDefaultButton(mUi->cmdImport);
    setCancelButton(mUi->cmdCancel);
}

frmImportWizard::~frmImportWizard() = default;

void frmImportWizard::connectControls()
{
    pair(mUi->Verzamel, mUi->Enkel);
    pair(mUi->Genest, mUi->Plat);
    connect(mUi->cmdBrowse, &QPushButton::clicked, this, &frmImportWizard::cmdBrowse_Click);
    connect(mUi->txtFileName, &QLineEdit::textChanged, this, &frmImportWizard::txtFileName_Change);
    connect(mUi->cmdImport, &QPushButton::clicked, this, &frmImportWizard::cmdImport_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
}

// Two boxes of which always exactly one is set.
void frmImportWizard::pair(QCheckBox *one, QCheckBox *other)
{
    connect(one, &QCheckBox::toggled, other, [other](bool set) { other->setChecked(!set); });
    connect(other, &QCheckBox::toggled, one, [one](bool set) { one->setChecked(!set); });
}

void frmImportWizard::Form_Load()
{
    placeInFrame(this, shareOfWidth, shareOfHeight);
    applyCaptions(this, {{"frmImportWizard", "frmImportWizardCaption"},
                         {"lblInstruction", "lblInstruction"},
                         {"frmImpFileData", "frmImpFileDataCaption"},
                         {"lblLocName", "lblLocNameCaption"},
                         {"lblImpType", "lblImpTypeCaption"},
                         {"lblImpFileFormat", "lblImpFileFormat"},
                         {"cmdBrowse", "cmdBrowseCaption"},
                         {"cmdCancel", "cmdImpCancelCaption"},
                         {"cmdImport", "cmdImportNowCaption"},
                         {"Verzamel", "optVerzamelCaption"},
                         {"Enkel", "optEnkelCaption"},
                         {"Genest", "optGenestCaption"},
                         {"Plat", "optPlatCaption"}});
    setImportEnabled(false);
}

void frmImportWizard::Form_Unload()
{
    setImportEnabled(true);
}

void frmImportWizard::cmdBrowse_Click()
{
    const QString name = Desktop::current().openFileName(
        {windowTitle(), QFileInfo(gImportFile).path(), GetMessage("xTextFiles"), {}});
    if (name.isEmpty())
        return;
    gImportFile = name;
    mUi->txtFileName->setText(shortened(name));
    mUi->txtFileName->setToolTip(Qt::convertFromPlainText(name, Qt::WhiteSpaceNormal));
}

void frmImportWizard::txtFileName_Change()
{
    mUi->cmdImport->setEnabled(!mUi->txtFileName->text().isEmpty());
}

void frmImportWizard::takeFormat()
{
    const bool compilations = mUi->Verzamel->isChecked(), nested = mUi->Genest->isChecked();
    gImportCompilationNested = compilations && nested;
    gImportCompilationFlat = compilations && !nested;
    gImportAlbumNested = !compilations && nested;
    gImportAlbumFlat = !compilations && !nested;
}

// Nothing of this screen may be used once the next one is shown: it may be gone by then.
void frmImportWizard::cmdImport_Click()
{
    takeFormat();
    Unload();
    Desktop::current().pump();
    defaultInstance<frmImportBusy>().ShowModal();
}
