// What frmCDRootMP3 does with the files of the selected rows, and the screens that it hands them
// to.

#include "mp3/frmCDRootMP3.h"

#include "controls/list/DBListViewCTL.h"
#include "mp3/collectionfolder.h"
#include "mp3/importascd.h"
#include "mp3/renaming.h"
#include "mp3/ui_frmCDRootMP3.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"

// The tag screens are still to come.
void frmCDRootMP3::enableTagScreens(bool, bool)
{
    mUi->cmdUpdateID3->setEnabled(false);
    mUi->cmdTagWizard->setEnabled(false);
}

std::vector<CollectionRow> frmCDRootMP3::rowsAt(const std::vector<int> &indexes) const
{
    auto items = mUi->TheMP3Collection->ListItems();
    std::vector<CollectionRow> rows;
    for (const int index : indexes) {
        const ListItem item = items.Item(index);
        CollectionRow &row = rows.emplace_back();
        row.index = index;
        for (int field = 0; field < collectionFields; ++field)
            row.texts[std::size_t(field)] = item.SubItems(field);
    }
    return rows;
}

// With their names alone.
std::vector<CollectionRow> frmCDRootMP3::allRows() const
{
    std::vector<CollectionRow> rows(std::size_t(mRows.count()));
    for (std::size_t i = 0; i < rows.size(); ++i) {
        rows[i].index = int(i) + 1;
        rows[i][CollectionField::FileName] = mRows.fileName(qsizetype(i));
    }
    return rows;
}

// The list is not read again: the new names show at once, and what has failed at the next refresh.
void frmCDRootMP3::cmdRename_Click()
{
    const auto renamed = [this](const CollectionRow &row, const QString &newName) {
        const ListItem item = mUi->TheMP3Collection->ListItems().Item(row.index);
        item.setSubItems(int(CollectionField::FileName), newName);
        mRows.setFileName(row[CollectionField::Volgnummer], newName);
    };
    renameFiles(*this, folder(), rowsAt(selectedRows()), renamed, allRows());
}

void frmCDRootMP3::cmdPreview_Click()
{
    previewRenaming(*this, folder(), rowsAt(selectedRows()), allRows());
}

void frmCDRootMP3::cmdImportAsCD_Click()
{
    if (mUi->cmdImportAsCD->isEnabled())
        importAsCD(*this, mUi->txtTitel->text(), rowsAt(selectedRows()));
}

void frmCDRootMP3::cmdUpdateID3_Click()
{
    if (!mUi->cmdUpdateID3->isEnabled() || !LongWork::mayBegin(*this))
        return;
    const Hourglass hourglass(this);
    const ListItem item = mUi->TheMP3Collection->SelectedItem();
    const QString path = pathInFolder(folder(), item.SubItems(int(CollectionField::FileName)));
    if (FileExists(path)) {
        RedrawLocked = true;
        Form_Activate();
        RedrawLocked = false;
    } else {
        RefreshAndHandleButtons();
        Form_Activate();
    }
}

void frmCDRootMP3::cmdTagWizard_Click()
{
    if (!mUi->cmdTagWizard->isEnabled() || !LongWork::mayBegin(*this))
        return;
    const Hourglass hourglass(this);
    for (const CollectionRow &row : rowsAt(selectedRows())) {
        if (FileExists(pathInFolder(folder(), row[CollectionField::FileName])))
            continue;
        RefreshAndHandleButtons();
        Form_Activate();
        return;
    }
    RedrawLocked = true;
    Form_Activate();
    RedrawLocked = false;
}
