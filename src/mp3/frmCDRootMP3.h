#pragma once

#include "controls/list/listitems.h"
#include "mp3/collectionrows.h"
#include "mp3/collectionstore.h"
#include "mp3/followednames.h"
#include "platform/desktop/form.h"

#include <QCursor>

class ListColumns;
namespace Ui
{
class frmCDRootMP3;
}

/// The editor of one collection of MP3 files: a folder, a title and an ordered list of files, with
/// what their tags say. The catalogue keeps the folder, the title and the names alone; tags are
/// read from the files at each refresh. Nothing is written to the catalogue before cmdOK.
///
/// A command makes the form busy: what comes in while events are handled is passed over.
class frmCDRootMP3 : public Form, public FollowsNames
{
    Q_OBJECT

public:
    frmCDRootMP3();
    ~frmCDRootMP3() override;

    // To be set before Show().
    QString Mode;            // "I" a new collection, "U" an existing one
    qint64 CollectionId = 0; // MP3Collections.ID

    /// Whether this is the editor of a stored collection.
    bool holds(qint64 collection) const { return Mode != u"I" && CollectionId == collection; }

    void collectionDeleted(); // by somebody else: a save will make a new one

    bool HasRecordSetChanged() const { return mRows.haveChanged(); }

    /// Shows the rows, with what is on the disk now. To be called after every change of them.
    void RefreshAndHandleButtons();

    /// Lets the user add files that are in this folder, or below it.
    void OpenMP3FileDialog(const QString &folder);

    /// What the files are and hold has been changed from outside: they are read again when the
    /// form is activated.
    void followNames(const RenamedFiles &renamed) override;

protected:
    void Form_Load() override;
    void Form_Activate() override;
    void activate(); // also when a screen that it has opened has closed
    bool eventFilter(QObject *watched, QEvent *event) override;

private:
    enum class ButtonState { NoRows, InvalidHeader, AllThere, FileMissing };

    void connectControls();
    void connectList();
    void setCaptions();
    void LoadCollection();

    // The head.
    QString folder() const;
    void setFolder(const QString &folder);
    void txtFolder_Validate();
    void ValidateFolderAndTitle();
    bool asksToClear() const;
    void cmdBrowse_Click();
    bool changeFolder(const QString &from, const QString &to);

    // The list and the buttons.
    void cmdRefreshList_Click();
    void setButtons(ButtonState state, bool isHeaderValid);
    void setNoButtons();
    void enableTagScreens(bool edit, bool wizard);
    void markMissingFiles();
    void tellUnreadable(const QStringList &names);
    void RestoreListPosition();
    void SyncSelection();
    void selectAdded();
    void SelectOnlyCurrentItem();
    void backToList();
    void list_ItemClick();
    void list_KeyUp(int keyCode, int shift);
    void list_MouseDown(int button, int x, int y);
    void list_DragOver(int x, int y);
    void list_DragDrop();
    std::vector<int> selectedRows() const; // of the items, from 1

    // Row operations.
    void command(const std::function<void()> &routine);
    void cmdAdd_Click();
    void cmdScan_Click();
    void appendNames(const QStringList &names);
    void showAdded();
    void cmdDelete_Click();
    void DeleteSelectedFiles();
    void moveRow(int from, int to);
    void moveCurrentBy(int step);

    // Commands of their own.
    std::vector<CollectionRow> rowsAt(const std::vector<int> &indexes) const;
    std::vector<CollectionRow> allRows() const;
    void cmdRename_Click();
    void cmdPreview_Click();
    void cmdImportAsCD_Click();
    void cmdUpdateID3_Click();
    void cmdTagWizard_Click();
    void openTagWizard(const std::vector<CollectionRow> &rows);
    void backFromTagScreen();

    // Save.
    void cmdOK_Click();
    bool save();
    bool write(const collectionstore::Header &header);

    std::unique_ptr<Ui::frmCDRootMP3> mUi;
    CollectionRows mRows;
    ListColumns *mColumns;
    std::optional<collectionstore::Header> mStored; // what the catalogue said when it was read
    QString LoadedFolder, LoadedTitle;
    QString LastGoodFolder;
    bool FormReady = false;
    bool mFilesChanged = false; // from outside, since the last refresh
    bool RedrawLocked = false;
    int CurrentRow = 1;
    int SelectedCount = 0;

    // Of rows that were just added.
    bool FilesAdded = false;
    int AddedCount = 0;

    // The running drag.
    ListItem DragItem;
    int DragFromRow = 0, DragToRow = 0;
    bool DragActive = false;
    const QCursor DragIconValid{Qt::DragMoveCursor}, DragIconInvalid{Qt::ForbiddenCursor};
};
