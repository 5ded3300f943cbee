#include "textimport/frmImport.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/frmImportDBBusy.h"
#include "textimport/importrecords.h"
#include "textimport/ui_frmImport.h"

using namespace Qt::StringLiterals;

namespace
{

// In the order of importfield.
const std::vector<ListColumn> columns = {
    {ListColumn::Number, "No"},      {ListColumn::Text, "Artiest", 29},
    {ListColumn::Text, "Titel", 34}, {ListColumn::Text, "Genre", 14},
    {ListColumn::Number, "HitYear"}, {ListColumn::Text, "CD-Titel", 23},
    {ListColumn::Number, "CD-nr"},   {ListColumn::Number, "Disknr"},
    {ListColumn::Number, "Track"}};

} // namespace

frmImport::frmImport() : Form(u"frmImport"_s), mUi(std::make_unique<Ui::frmImport>())
{
    mUi->setupUi(this);
    connect(mUi->StartDBImport, &QPushButton::clicked, this, &frmImport::StartDBImport_Click);
}

frmImport::~frmImport() = default;

void frmImport::Form_Load()
{
    const Hourglass hourglass(this);
    applyCaptions(this, {{"frmImport", "frmImportCaption"},
                         {"lbltext", "lblImport"},
                         {"StartDBImport", "StartDBImportCaption"}});
    mUi->ImportListView->setAccessibleName(GetMessage("xTracksRead"));
    fillList();
    mUi->StartDBImport->setEnabled(gImportRecords->RecordCount() > 0);
    releaseFrame();
    setFramePointer(vbDefault);
}

void frmImport::fillList()
{
    if (!gImportRecords)
        gImportRecords = newImportRecords();
    auto *list = new ListColumns(mUi->ImportListView, columns);
    list->show(gImportRecords);
}

// Nothing of this screen may be used behind this: a load that succeeds unloads it.
void frmImport::StartDBImport_Click()
{
    defaultInstance<frmImportDBBusy>().ShowModal();
}

void frmImport::Form_Unload()
{
    if (gImportRecords && gImportRecords->State() == ADODB::adStateOpen)
        gImportRecords->Close();
    gImportRecords.reset();
    setImportEnabled(true);
}
