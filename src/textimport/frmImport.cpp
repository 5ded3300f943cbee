#include "textimport/frmImport.h"

#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/frmImportDBBusy.h"
#include "textimport/importrecords.h"
#include "textimport/ui_frmImport.h"

#include <QStyle>

using namespace Qt::StringLiterals;

namespace
{

// The columns, in the order of importfield: the key of the head, and the share of the width that is
// left when those with a share of 0 have got what their heads and numbers need.
struct Column {
    const char *key;
    int percent;
};
constexpr Column columns[] = {{"No", 0},     {"Artiest", 29}, {"Titel", 34},
                              {"Genre", 14}, {"HitYear", 0},  {"CD-Titel", 23},
                              {"CD-nr", 0},  {"Disknr", 0},   {"Track", 0}};

int neededWidth(const Column &column, const QFontMetrics &metrics)
{
    const int head = metrics.horizontalAdvance(GetMessage(column.key) + u"mm"_s);
    return qMax(head, metrics.horizontalAdvance(u"000000"_s));
}

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
    mUi->ImportListView->setRecordset(gImportRecords);
    mUi->ImportListView->Populate();
    int index = 0;
    for (const Column &column : columns)
        mUi->ImportListView->ColumnHeaders().Item(++index).setText(GetMessage(column.key));
    fitColumns();
}

// The whole width is used, less the room of a scroll bar.
void frmImport::fitColumns()
{
    DBListViewCTL *list = mUi->ImportListView;
    if (list->ColumnHeaders().Count() == 0)
        return;
    const int scrollBar = style()->pixelMetric(QStyle::PM_ScrollBarExtent, nullptr, list);
    int left = list->width() - 2 * list->frameWidth() - scrollBar;
    for (const Column &column : columns)
        left -= column.percent == 0 ? neededWidth(column, list->fontMetrics()) : 0;
    int index = 0;
    for (const Column &column : columns) {
        const int width = column.percent == 0 ? neededWidth(column, list->fontMetrics())
                                              : left * column.percent / 100;
        list->ColumnHeaders().Item(++index).setWidth(qMax(1, width));
    }
}

void frmImport::resizeEvent(QResizeEvent *event)
{
    Form::resizeEvent(event);
    fitColumns();
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
