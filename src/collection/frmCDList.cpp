#include "collection/frmCDList.h"

#include "catalogue/cleanorphans.h"
#include "catalogue/errorboxes.h"
#include "collection/browserlists.h"
#include "collection/editors.h"
#include "collection/recordnodes.h"
#include "collection/ui_frmCDList.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "mp3/collections.h"
#include "platform/desktop/desktop.h"
#include "platform/text/textrules.h"
#include "platform/work/longwork.h"
#include "reports/reports.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <functional>

using namespace Qt::StringLiterals;

namespace
{

constexpr qsizetype readAtOnce = 10'000; // rows: some milliseconds
constexpr int firstSortKey = 1;          // sort keys from 0: the first column that shows
constexpr int keyEnter = 13, keyInsert = 45, keyDelete = 46;

using TextOf = std::function<QString(const ADODB::Rows &rows, qsizetype row)>;

QString secondText(const ADODB::Rows &rows, qsizetype row)
{
    return rows.text(row, 1);
}

QString textOfDisc(const ADODB::Rows &rows, qsizetype row)
{
    return rows.text(row, 1) + u" (Track "_s + rows.text(row, 3) + GetMessage("VanDisc") +
           rows.text(row, 2) + u')';
}

// Nodes of the tree from rows that begin with an id. One that has none has no key either.
std::vector<RecordTree::Node> nodesOf(const ADODB::Recordset &recordset, QChar keyLetter,
                                      const TextOf &text = secondText)
{
    const auto rows = recordset.rows();
    std::vector<RecordTree::Node> nodes;
    nodes.reserve(std::size_t(rows->rowCount()));
    for (qsizetype row = 0; row < rows->rowCount(); ++row) {
        if (rows->kind(row, 0) == ADODB::Rows::Kind::Integer)
            nodes.push_back({keyLetter + rows->text(row, 0), text(*rows, row)});
    }
    return nodes;
}

template <typename PrintedReport> void startReport()
{
    const auto rows = gConnection->Execute(PrintedReport::command(), ADODB::adOptionUnspecified);
    auto &report = defaultInstance<PrintedReport>();
    report.setDataSource(rows);
    report.setCaption(PrintedReport::caption());
    report.Show();
}

} // namespace

frmCDList::frmCDList() : Form(u"frmCDList"_s), mUi(std::make_unique<Ui::frmCDList>())
{
    mUi->setupUi(this);
    // Id is hidden; a dragged width is kept over a reload.
    const auto columns = [](DBListViewCTL *list, std::initializer_list<const char *> captions) {
        std::vector<ListColumn> all{{ListColumn::Hidden}};
        for (const char *caption : captions)
            all.push_back({ListColumn::Text, caption, 1});
        return new ListColumns(list, std::move(all));
    };
    mPages = {ListPage{Compilations,
                       mUi->ColList,
                       browserlists::compilations,
                       columns(mUi->ColList, {"Titel"}),
                       "NumCompCol",
                       mUi->noCompilations,
                       "xNoCompilations",
                       {"xStepTypeDisc", "mnuCDInsert"}},
              ListPage{Albums,
                       mUi->SngList,
                       browserlists::albums,
                       columns(mUi->SngList, {"Artiest", "Titel"}),
                       "NumAlbCol",
                       mUi->noAlbums,
                       "xNoAlbums",
                       {"xStepTypeDisc", "mnuInsertEnkelCD"}},
              ListPage{MP3Collections,
                       mUi->MP3List,
                       browserlists::mp3Collections,
                       columns(mUi->MP3List, {"Map", "Titel"}),
                       "NumMP3Coll",
                       mUi->noMP3,
                       "xNoMP3Collections",
                       {"xStepMP3", "mnuMP3"}}};
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
        pages[i]->setAccessibleName(QString(caption).remove(u'&'));
    }
}

void frmCDList::connectControls()
{
    for (ListPage &page : mPages)
        connectList(page);
    connect(mUi->CDTab, &QTabWidget::currentChanged, this, &frmCDList::CDTab_Click);
    connect(mUi->Platenbak, &RecordTree::Expand, this, &frmCDList::Platenbak_Expand);
    connect(mUi->Platenbak, &RecordTree::NodeClick, this, &frmCDList::Platenbak_NodeClick);
    connect(mUi->cmdInsert, &QPushButton::clicked, this, &frmCDList::cmdInsert_Click);
    connect(mUi->cmdUpdate, &QPushButton::clicked, this, &frmCDList::cmdUpdate_Click);
    connect(mUi->cmdDelete, &QPushButton::clicked, this, &frmCDList::cmdDelete_Click);
    connect(mUi->cmdStartReport, &QPushButton::clicked, this, &frmCDList::cmdStartReport_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
    connect(mUi->ColList, &DBListViewCTL::LostFocus, this, [this] { mColFocusDone = false; });
}

void frmCDList::connectList(ListPage &page)
{
    connect(page.list, &DBListViewCTL::ItemClick, this, [this, &page] { rememberSelection(page); });
    connect(page.list, &DBListViewCTL::KeyUp, this, [this, &page] { rememberSelection(page); });
    connect(page.list, &DBListViewCTL::KeyDown, this, &frmCDList::list_KeyDown);
    connect(page.list, &DBListViewCTL::DblClick, this, &frmCDList::cmdUpdate_Click);
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
    LoadLists();
    setTabStops();
    showPage();
    mLoading = false;
}

void frmCDList::RefreshLists()
{
    LoadLists();
}

void frmCDList::LoadLists()
{
    read(&frmCDList::readPages);
}

void frmCDList::read(void (frmCDList::*what)())
{
    setFramePointer(vbHourglass);
    try {
        (this->*what)();
    } catch (const Error &error) {
        showDatabaseErrors(error, GetMessage("UFL"));
        releaseFrame();
    }
    setFramePointer(vbDefault);
}

// Large pages that do not show are read when they are looked at: a save must not wait for them.
void frmCDList::readPages()
{
    for (ListPage &page : mPages)
        page.stale = true;
    mTrackCount.reset();
    mUi->Platenbak->resetRoots();
    for (ListPage &page : mPages) {
        if (page.count <= readAtOnce)
            loadPage(page);
    }
    readWhatShows();
    showPage();
}

void frmCDList::readWhatShows()
{
    if (ListPage *page = current(); page && page->stale)
        loadPage(*page);
    else if (!page && !mTrackCount)
        mTrackCount = browserlists::trackCount();
}

void frmCDList::loadPage(ListPage &page)
{
    DBListViewCTL &list = *page.list;
    const auto rows = page.read();
    page.stale = false;
    page.columns->show(rows);
    list.sortBy(firstSortKey);
    page.count = rows->RecordCount();
    list.setEnabled(page.count != 0);
    showSteps(page);
    rows->Close();
    if (page.index > 1)
        RestoreSelection(page);
}

void frmCDList::showSteps(const ListPage &page)
{
    std::vector<FirstSteps::Step> steps{page.firstStep};
    if (page.page != MP3Collections)
        steps.insert(steps.end(), {{"xStepTextFile", "Import"}, {"xStepReadCD", "mnuCDDB"}});
    steps.push_back({"xStepGuide", "mnuHelp"});
    page.steps->showFor(page.count == 0, page.emptyKey, steps);
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
    read(&frmCDList::readWhatShows);
    setTabStops();
    showPage();
    focusList();
}

// There is no report of MP3 collections.
void frmCDList::showPage()
{
    const ListPage *page = current();
    mUi->cmdInsert->setVisible(page);
    mUi->cmdUpdate->setVisible(page);
    mUi->cmdDelete->setVisible(page);
    mUi->cmdInsert->setEnabled(page);
    mUi->cmdUpdate->setEnabled(page && page->count > 0);
    mUi->cmdDelete->setEnabled(page && page->count > 0);
    mUi->cmdStartReport->setEnabled(!page || page->page != MP3Collections);
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
                              : GetMessage("DiffTracks") + QString::number(mTrackCount.value_or(0));
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

// Ctrl+Insert copies, as everywhere.
void frmCDList::list_KeyDown(int keyCode, int shift)
{
    if (keyCode == keyDelete)
        cmdDelete_Click();
    else if (keyCode == keyEnter)
        cmdUpdate_Click();
    else if (keyCode == keyInsert && shift == 0)
        cmdInsert_Click();
}

// ColList has one column that shows: it is sorted on that one whichever was clicked.
void frmCDList::list_ColumnClick(ListPage &page, int column)
{
    page.list->sortBy(page.page == Compilations ? firstSortKey : column - 1);
}

void frmCDList::FillArtistNode(RecordTree &TheTree, const QString &TheKey)
{
    const auto rows = TheKey == GetMessage("Overige") ? recordnodes::artistsWithDigit()
                                                      : recordnodes::artists(TheKey);
    TheTree.addNodes(TheKey, RecordTree::Artist, nodesOf(*rows, u'A'));
}

void frmCDList::FillTrackNode(RecordTree &TheTree, const QString &TheKey)
{
    const auto rows = recordnodes::tracks(TheKey.sliced(1));
    TheTree.addNodes(TheKey, RecordTree::Track, nodesOf(*rows, u'T'));
}

void frmCDList::FillCDNode(RecordTree &TheTree, const QString &TheKey)
{
    const auto rows = recordnodes::discs(TheKey.sliced(1));
    TheTree.addNodes(TheKey, RecordTree::Disc, nodesOf(*rows, u'C', textOfDisc));
}

// A node is filled once: its placeholder tells that it was not yet. The length comes first, for "A"
// is a letter and "A12" an artist.
void frmCDList::Platenbak_Expand(const QString &key)
{
    RecordTree &tree = *mUi->Platenbak;
    const QTreeWidgetItem *node = tree.node(key);
    if (node->childCount() == 0 || !RecordTree::keyOf(node->child(0)).startsWith("dummy"_L1))
        return;
    tree.removeNode(RecordTree::keyOf(node->child(0)));
    if (key.size() == 1 || key == GetMessage("Overige"))
        FillArtistNode(tree, key);
    else if (key.startsWith(u'A'))
        FillTrackNode(tree, key);
    else if (key.startsWith(u'T'))
        FillCDNode(tree, key);
}

void frmCDList::Platenbak_NodeClick(const QString &key)
{
    const QString linkId = key.sliced(1);
    if (!key.startsWith(u'C') || !text::isNumeric(linkId))
        return;
    const auto title = recordnodes::titleOf(linkId);
    if (title.id == 0)
        return; // gone since the tree was read
    if (title.isCompilation)
        editors::editCompilation(title.id);
    else
        editors::editAlbum(title.id);
}

void frmCDList::cmdInsert_Click()
{
    if (mUi->CDTab->currentIndex() == Compilations)
        editors::newCompilation();
    else if (mUi->CDTab->currentIndex() == Albums)
        editors::newAlbum();
    else if (mUi->CDTab->currentIndex() == MP3Collections)
        collections::open();
}

void frmCDList::cmdUpdate_Click()
{
    ListPage *page = current();
    const auto item = page ? page->list->SelectedItem() : ListItem();
    if (!item)
        return;
    if (page->page == Compilations)
        editors::editCompilation(item.Text().toLongLong());
    else if (page->page == Albums)
        editors::editAlbum(item.Text().toLongLong());
    else
        collections::edit(item.Text().toLongLong());
}

void frmCDList::cmdDelete_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    if (mUi->CDTab->currentIndex() == MP3Collections)
        DeleteMP3Collection();
    else
        DeleteCD();
}

// By design: nothing is caught here. An error ends the program as any that nobody awaits, and the
// hourglass stays until then.
void frmCDList::cmdStartReport_Click()
{
    Desktop::current().setPointer(this, vbHourglass);
    switch (mUi->CDTab->currentIndex()) {
    case Compilations:
        startReport<CompilationReport>();
        break;
    case Albums:
        startReport<AlbumReport>();
        break;
    case Records:
        startReport<PlatenbakReport>();
        break;
    }
    Desktop::current().setPointer(this, vbDefault);
}

void frmCDList::DeleteCD()
{
    ListPage *page = current();
    if (page && askYesNo(GetMessage("QuestDelete"), GetMessage("Delete")) == vbYes)
        deleteSelected(*page, editors::deleteRecord);
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
    } catch (const Error &error) {
        gConnection->RollbackTrans();
        showDatabaseErrors(error);
        releaseFrame();
    }
}
