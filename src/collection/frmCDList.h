#pragma once

#include "collection/firststeps.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/form.h"
#include "services/browser.h"

#include <array>
#include <memory>
#include <optional>
#include <vector>

class DBListViewCTL;
class ListColumns;
class ListItem;
class RecordTree;
namespace Ui
{
class frmCDList;
}

/// The browser of the whole collection: compilations, albums, records and MP3 collections, a page
/// each. It shows the key fields only; its own changes to the catalogue are the deletions.
class frmCDList : public Form, public Browser
{
    Q_OBJECT

public:
    frmCDList();
    ~frmCDList() override;

    /// Reads all pages anew; column widths and the remembered rows are kept.
    void RefreshLists() override;

    // Fill the node of this key with the artists, tracks or discs below it, by one statement. Throw
    // Error.
    void FillArtistNode(RecordTree &TheTree, const QString &TheKey);
    void FillTrackNode(RecordTree &TheTree, const QString &TheKey);
    void FillCDNode(RecordTree &TheTree, const QString &TheKey);

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    enum PageIndex { Compilations, Albums, Records, MP3Collections };

    /// What the three pages with a list have alike.
    struct ListPage {
        PageIndex page;
        DBListViewCTL *list;
        ADODB::RecordsetPtr (*read)();
        ListColumns *columns;
        const char *countKey;
        FirstSteps *steps; // in place of an empty list
        const char *emptyKey;
        FirstSteps::Step firstStep;
        qsizetype count = 0;
        bool stale = true; // to be read when it is looked at
        int index = 1;     // of the remembered row, from 1
    };

    void connectControls();
    void connectList(ListPage &page);
    void setCaptions();
    void LoadLists();
    void read(void (frmCDList::*what)());
    void readPages();
    void readWhatShows();
    void loadPage(ListPage &page);
    static void showSteps(const ListPage &page);
    void CDTab_Click();
    void showPage();
    void setTabStops();
    void showCount();
    void focusList();
    void RestoreSelection(ListPage &page);
    void rememberSelection(ListPage &page);
    void list_KeyDown(int keyCode, int shift);
    void list_ColumnClick(ListPage &page, int column);
    void Platenbak_Expand(const QString &key);
    void Platenbak_NodeClick(const QString &key);
    void cmdInsert_Click();
    void cmdUpdate_Click();
    void cmdDelete_Click();
    void cmdStartReport_Click();
    void DeleteCD();
    void DeleteMP3Collection();
    void deleteSelected(ListPage &page, void (*remove)(qint64));
    ListPage *current(); // nothing on the page of the tree

    std::unique_ptr<Ui::frmCDList> mUi;
    std::array<ListPage, 3> mPages;
    std::optional<qint64> mTrackCount; // counted when its page shows
    bool mColFocusDone = false;        // the remembered row of ColList was restored on this focus
    bool mLoading = true;
};
