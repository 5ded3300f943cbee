// The rows of frmCDRootMP3: how they are selected, added, deleted and moved.

#include "mp3/frmCDRootMP3.h"

#include "controls/list/DBListViewCTL.h"
#include "mp3/rownames.h"
#include "mp3/ui_frmCDRootMP3.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/messages.h"

#include <algorithm>

using namespace Qt::StringLiterals;

namespace
{

constexpr int rightButton = 2;
constexpr int keyUp = 38, keyDown = 40, keyInsert = 45, keyDelete = 46;
constexpr int shiftAlone = 1;

} // namespace

void frmCDRootMP3::command(const std::function<void()> &routine)
{
    if (!LongWork::mayBegin(*this))
        return;
    const LongWork work(*this);
    const Hourglass hourglass(this);
    routine();
}

std::vector<int> frmCDRootMP3::selectedRows() const
{
    std::vector<int> rows;
    for (const QItemSelectionRange &range : mUi->TheMP3Collection->selectionModel()->selection()) {
        for (int row = range.top(); row <= range.bottom(); ++row)
            rows.push_back(row + 1);
    }
    std::sort(rows.begin(), rows.end());
    return rows;
}

// In one piece: there may be very many.
void frmCDRootMP3::selectAdded()
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    const int count = list.ListItems().Count(), first = count - AddedCount;
    if (AddedCount == 0 || first < 0)
        return;
    const QItemSelection added(list.model()->index(first, 0),
                               list.model()->index(count - 1, list.model()->columnCount() - 1));
    list.setSelectedItem(list.ListItems().Item(first + 1));
    list.selectionModel()->select(added, QItemSelectionModel::Select);
}

// All that is selected is shown as far as there is room, the row of the cursor in any case.
void frmCDRootMP3::SyncSelection()
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    if (FilesAdded)
        selectAdded();
    const auto rows = selectedRows();
    SelectedCount = int(rows.size());
    if (!rows.empty()) {
        list.ListItems().Item(rows.front()).EnsureVisible();
        list.ListItems().Item(rows.back()).EnsureVisible();
        list.SelectedItem().EnsureVisible();
    }
    enableTagScreens(SelectedCount == 1, SelectedCount != 1);
    mUi->cmdImportAsCD->setEnabled(true);
    mUi->cmdRename->setEnabled(true);
    mUi->cmdPreview->setEnabled(true);
}

void frmCDRootMP3::SelectOnlyCurrentItem()
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    list.setSelectedItem(list.SelectedItem());
}

void frmCDRootMP3::backToList()
{
    if (!mUi->TheMP3Collection->isEnabled())
        return;
    SyncSelection();
    mUi->TheMP3Collection->setFocus();
}

void frmCDRootMP3::list_ItemClick()
{
    SyncSelection();
    CurrentRow = mUi->TheMP3Collection->SelectedItem().Index();
}

void frmCDRootMP3::list_KeyUp(int keyCode, int shift)
{
    if (const ListItem item = mUi->TheMP3Collection->SelectedItem())
        CurrentRow = item.Index();
    if (keyCode == keyInsert) {
        cmdAdd_Click();
    } else if (keyCode == keyDelete) {
        cmdDelete_Click();
    } else {
        if ((keyCode == keyUp || keyCode == keyDown) && shift != shiftAlone)
            SelectOnlyCurrentItem();
        SyncSelection();
    }
}

void frmCDRootMP3::list_MouseDown(int button, int x, int y)
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    if (button != rightButton || isBusy())
        return;
    list.selectionModel()->clearSelection();
    SyncSelection();
    DragItem = list.HitTest(x, y);
    if (!DragItem)
        return;
    DragActive = true;
    DragFromRow = DragToRow = DragItem.Index();
    list.setDragIcon(DragIconValid);
    list.Drag(1);
}

void frmCDRootMP3::list_DragOver(int x, int y)
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    DragItem = list.HitTest(x, y);
    if (!DragItem) {
        DragItem = list.ListItems().Item(list.ListItems().Count());
        list.setDragIcon(DragIconInvalid);
        return;
    }
    DragActive = true;
    list.setDragIcon(DragIconValid);
    list.setDropHighlight(DragItem);
    DragToRow = DragItem.Index();
}

void frmCDRootMP3::list_DragDrop()
{
    DBListViewCTL &list = *mUi->TheMP3Collection;
    list.Drag(2);
    if (DragActive && DragFromRow != DragToRow) {
        command([this] { moveRow(DragFromRow, DragToRow); });
        return;
    }
    list.setSelectedItem(DragItem);
    SelectOnlyCurrentItem();
    list_ItemClick();
}

void frmCDRootMP3::cmdAdd_Click()
{
    if (!mUi->cmdAdd->isEnabled())
        return;
    command([this] {
        RedrawLocked = true;
        OpenMP3FileDialog(folder());
        RedrawLocked = false;
    });
}

void frmCDRootMP3::OpenMP3FileDialog(const QString &folder)
{
    const FileQuestion question{GetMessage("KiesMP3files"), folder, u"MP3 Files (*.mp3)"_s, {}};
    for (bool again = true; again && !isUnloaded();) {
        FilesAdded = false;
        AddedCount = 0;
        const auto chosen = rownames::ofChosen(folder, Desktop::current().openFileNames(question));
        appendNames(chosen.names);
        again = chosen.askAgain;
        if (chosen.refusal)
            errorBox(GetMessage(chosen.refusal));
    }
    showAdded();
}

void frmCDRootMP3::cmdScan_Click()
{
    FilesAdded = false;
    AddedCount = 0;
    LongWork work(*this, GetMessage("xScanning"));
    QStringList found;
    const bool whole = work.eachOf<QStringList>(
        1,
        [folder = folder()](qsizetype, const std::stop_token &stop) {
            return filesInTree(folder, u"*.mp3"_s, stop);
        },
        [&](qsizetype, QStringList &&files) { found = std::move(files); });
    if (!whole)
        return;
    appendNames(rownames::ofFound(folder(), found));
    RedrawLocked = true;
    showAdded();
    RedrawLocked = false;
}

// Of files that are in the list already the user decides.
void frmCDRootMP3::appendNames(const QStringList &names)
{
    QSet<QString> known = mRows.fileNames();
    QStringList fresh;
    for (const QString &name : names) {
        if (!known.contains(name))
            fresh.append(name);
        known.insert(name);
    }
    const qsizetype twice = names.size() - fresh.size();
    const bool leaveOut =
        twice > 0 && askYesNo(GetMessage("xFilesTwicePart1") + QString::number(twice) +
                              GetMessage("xFilesTwicePart2")) == vbYes;
    const QStringList &added = leaveOut ? fresh : names;
    mRows.append(added);
    AddedCount += int(added.size());
    FilesAdded = AddedCount > 0;
}

void frmCDRootMP3::showAdded()
{
    RefreshAndHandleButtons();
    backToList();
    FilesAdded = false;
    AddedCount = 0;
}

void frmCDRootMP3::cmdDelete_Click()
{
    command([this] {
        RedrawLocked = true;
        DeleteSelectedFiles();
        RedrawLocked = false;
    });
}

void frmCDRootMP3::DeleteSelectedFiles()
{
    if (!mUi->cmdDelete->isEnabled())
        return;
    QStringList names;
    for (const int row : selectedRows())
        names.append(mRows.fileName(row - 1));
    mRows.remove(names);
    RefreshAndHandleButtons();
    backToList();
}

// By design: RedrawLocked stays true.
void frmCDRootMP3::moveRow(int from, int to)
{
    RedrawLocked = true;
    mRows.move(from - 1, to - 1);
    CurrentRow = to;
    RefreshAndHandleButtons();
    backToList();
}

void frmCDRootMP3::moveCurrentBy(int step)
{
    const ListItem item = mUi->TheMP3Collection->SelectedItem();
    const int from = item.Index(), to = from + step;
    if (item.Selected() && to >= 1 && to <= mRows.count())
        command([&] { moveRow(from, to); });
}
