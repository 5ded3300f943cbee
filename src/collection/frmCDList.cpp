#include "collection/frmCDList.h"

#include "catalogue/cleanorphans.h"
#include "catalogue/errorboxes.h"
#include "collection/browserlists.h"
#include "controls/DBListViewCTL.h"
#include "platform/desktop/desktop.h"
#include "shell/services/captions.h"
#include "shell/services/frame.h"
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "ui_frmCDList.h"

#include <QHeaderView>

namespace
{

constexpr int idColumn = 1;     // columns are counted from 1
constexpr int firstSortKey = 1; // sort keys from 0: the first column that shows
constexpr int keyDelete = 46;

} // namespace

frmCDList::frmCDList() : Form(QStringLiteral("frmCDList")), mUi(std::make_unique<Ui::frmCDList>())
{
    mUi->setupUi(this);
    mPages = {
        ListPage{
            Compilations, mUi->ColList, browserlists::compilations, {"Titel"}, "NumCompCol", {}},
        ListPage{Albums, mUi->SngList, browserlists::albums, {"Artiest", "Titel"}, "NumAlbCol", {}},
        ListPage{MP3Collections,
                 mUi->MP3List,
                 browserlists::mp3Collections,
                 {"Map", "Titel"},
                 "NumMP3Coll",
                 {}}};
    setCancelButton(mUi->cmdCancel);
    setCaptions();
    connectControls();
}

frmCDList::~frmCDList() = default;

void frmCDList::setCaptions()
{
    applyCaptions(this, {{"frmCDList", "TTYourcollection"},
                         {"cmdInsert", "TTInsertCD", Caption::ToolTip},
                         {"cmdUpdate", "TTUpdateCD", Caption::ToolTip},
                         {"cmdDelete", "TTDeleteCD", Caption::ToolTip},
                         {"cmdStartReport", "xPrint", Caption::ToolTip},
                         {"cmdCancel", "cmdCancelCaption"}});
    const char *tabs[] = {"VerzamelCDs", "EnkelCDs", "Platenbak", "MP3Collections"};
    QWidget *pages[] = {mUi->ColList, mUi->SngList, mUi->Platenbak, mUi->MP3List};
    for (int i = 0; i < 4; ++i) {
        const QString caption = GetMessage(tabs[i]);
        mUi->CDTab->setTabText(i, caption);
        pages[i]->setAccessibleName(QString(caption).remove(QLatin1Char('&')));
    }
}

void frmCDList::connectControls()
{
    for (ListPage &page : mPages)
        connectList(page);
    connect(mUi->CDTab, &QTabWidget::currentChanged, this, &frmCDList::CDTab_Click);
    connect(mUi->cmdDelete, &QPushButton::clicked, this, &frmCDList::cmdDelete_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
    connect(mUi->ColList, &DBListViewCTL::LostFocus, this, [this] { mColFocusDone = false; });
}

void frmCDList::connectList(ListPage &page)
{
    connect(page.list, &DBListViewCTL::ItemClick, this, [this, &page] { rememberSelection(page); });
    connect(page.list, &DBListViewCTL::KeyUp, this, [this, &page] { rememberSelection(page); });
    connect(page.list, &DBListViewCTL::KeyDown, this, [this](int key) { list_KeyDown(key); });
    connect(page.list, &DBListViewCTL::ColumnClick, this,
            [this, &page](int column) { list_ColumnClick(page, column); });
    connect(page.list, &DBListViewCTL::GotFocus, this, [this, &page] {
        if (page.page == Compilations && std::exchange(mColFocusDone, true))
            return;
        RestoreSelection(page);
    });
}

void frmCDList::Form_Load()
{
    const Freeze freeze(this);
    mLoading = true;
    mUi->CDTab->setCurrentIndex(Compilations);
    for (ListPage &page : mPages)
        page.index = 1;
    mColFocusDone = false;
    setFirstWidths();
    LoadLists();
    setTabStops();
    showPage();
    mLoading = false;
}

// Id is hidden. The last column takes what the others leave free.
void frmCDList::setFirstWidths()
{
    const int half = (width() - 60) / 2;
    mPages[0].widths = {0, half};
    mPages[1].widths = mPages[2].widths = {0, half, half / 2};
    for (ListPage &page : mPages)
        page.list->horizontalHeader()->setStretchLastSection(true);
}

void frmCDList::RefreshLists()
{
    LoadLists();
}

void frmCDList::LoadLists()
{
    setFramePointer(vbHourglass);
    try {
        if (!gConnection)
            throw ADODB::makeError(ADODB::errObjectClosed);
        SaveColumnWidths();
        loadPage(mPages[0]);
        loadPage(mPages[1]);
        mTrackCount = browserlists::trackCount();
        mUi->Platenbak->resetRoots();
        loadPage(mPages[2]);
        showPage();
    } catch (const ADODB::Error &error) {
        showDatabaseErrors(error, GetMessage("UFL"));
        releaseFrame();
    }
    setFramePointer(vbDefault);
}

void frmCDList::loadPage(ListPage &page)
{
    DBListViewCTL &list = *page.list;
    const auto rows = page.read();
    list.setRecordset(rows);
    list.Populate();
    auto headers = list.ColumnHeaders();
    for (int i = 0; i < int(page.widths.size()); ++i)
        headers.Item(i + idColumn).setWidth(page.widths[std::size_t(i)]);
    for (int i = 0; i < int(page.headers.size()); ++i)
        headers.Item(i + idColumn + 1).setText(GetMessage(page.headers[std::size_t(i)]));
    list.setSorted(true);
    list.setSortKey(firstSortKey);
    page.count = rows->RecordCount();
    list.setEnabled(page.count != 0);
    rows->Close();
    if (page.index > 1)
        RestoreSelection(page);
}

void frmCDList::SaveColumnWidths()
{
    if (mLoading)
        return;
    for (ListPage &page : mPages) {
        for (int i = 0; i < int(page.widths.size()); ++i)
            page.widths[std::size_t(i)] = page.list->ColumnHeaders().Item(i + idColumn).Width();
    }
}

frmCDList::ListPage *frmCDList::current()
{
    for (ListPage &page : mPages) {
        if (page.page == mUi->CDTab->currentIndex())
            return &page;
    }
    return nullptr;
}

void frmCDList::CDTab_Click()
{
    if (mLoading)
        return;
    const Freeze freeze(this);
    setTabStops();
    showPage();
    focusList();
}

// Adding and editing wait for the editors, printing for the reports.
void frmCDList::showPage()
{
    const ListPage *page = current();
    mUi->cmdInsert->setVisible(page);
    mUi->cmdUpdate->setVisible(page);
    mUi->cmdDelete->setVisible(page);
    mUi->cmdInsert->setEnabled(false);
    mUi->cmdUpdate->setEnabled(false);
    mUi->cmdDelete->setEnabled(page && page->count > 0);
    mUi->cmdStartReport->setEnabled(false);
    showCount();
}

void frmCDList::setTabStops()
{
    const ListPage *page = current();
    for (const ListPage &p : mPages)
        p.list->setFocusPolicy(&p == page && p.count > 0 ? Qt::StrongFocus : Qt::ClickFocus);
    mUi->Platenbak->setFocusPolicy(page ? Qt::ClickFocus : Qt::StrongFocus);
}

void frmCDList::showCount()
{
    const ListPage *page = current();
    const QString text = page ? GetMessage(page->countKey) + QString::number(page->count)
                              : GetMessage("DiffTracks") + QString::number(mTrackCount);
    mUi->TheStatusBar->showMessage(text);
}

void frmCDList::focusList()
{
    ListPage *page = current();
    if (!page)
        mUi->Platenbak->setFocus();
    else if (page->count > 0)
        page->list->setFocus();
}

void frmCDList::Form_Activate()
{
    const bool restored = current() == &mPages[0] && mColFocusDone;
    if (!restored)
        focusList();
}

void frmCDList::rememberSelection(ListPage &page)
{
    if (const auto item = page.list->SelectedItem())
        page.index = item.Index();
}

void frmCDList::RestoreSelection(ListPage &page)
{
    if (page.count == 0)
        return;
    page.index = int(std::min<qsizetype>(page.index, page.count));
    const auto item = page.list->ListItems().Item(page.index);
    page.list->setSelectedItem(item);
    item.EnsureVisible();
}

void frmCDList::list_KeyDown(int keyCode)
{
    if (keyCode == keyDelete)
        cmdDelete_Click();
}

// ColList has one column that shows: it is sorted on that one whichever was clicked.
void frmCDList::list_ColumnClick(ListPage &page, int column)
{
    page.list->setSorted(true);
    page.list->setSortKey(page.page == Compilations ? firstSortKey : column - 1);
}

void frmCDList::cmdDelete_Click()
{
    if (mUi->CDTab->currentIndex() == MP3Collections)
        DeleteMP3Collection();
    else
        DeleteCD();
}

void frmCDList::DeleteCD()
{
    ListPage *page = current();
    if (page && askYesNo(GetMessage("QuestDelete"), GetMessage("Delete")) == vbYes)
        deleteSelected(*page, browserlists::deleteTitle);
    // By design: also after a no. What nothing points at goes, whoever left it.
    CleanOrphans();
    releaseFrame();
}

void frmCDList::DeleteMP3Collection()
{
    if (askYesNo(GetMessage("QuestDeleteMP3"), GetMessage("Delete")) == vbYes)
        deleteSelected(*current(), browserlists::deleteMP3Collection);
    releaseFrame();
}

void frmCDList::deleteSelected(ListPage &page, void (*remove)(qint64))
{
    const Hourglass hourglass(this);
    const auto item = page.list->SelectedItem();
    if (!item)
        return;
    freezeFrame();
    try {
        remove(item.Text().toLongLong());
        LoadLists();
        Desktop::current().pump();
        focusList();
    } catch (const ADODB::Error &error) {
        gConnection->RollbackTrans();
        showDatabaseErrors(error);
        releaseFrame();
    }
}
