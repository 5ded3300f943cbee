// What frmCDRootMP3 does with the files of the selected rows, and the screens that it hands them
// to.

#include "mp3/frmCDRootMP3.h"

#include "controls/list/DBListViewCTL.h"
#include "mp3/EditMP3Tags.h"
#include "mp3/collectionfolder.h"
#include "mp3/frmTagWizardPg1.h"
#include "mp3/importascd.h"
#include "mp3/renaming.h"
#include "mp3/ui_frmCDRootMP3.h"
#include "platform/desktop/desktop.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"

#include <QDir>

namespace
{

// The fields that the Tags Processor takes its rows with, and the row's own that goes into each. By
// design the last one is told "y", that the file is there: the file id does not travel.
constexpr std::pair<const char *, CollectionField> taggedFields[] = {
    {"Nr", CollectionField::Volgnummer},
    {"Filename", CollectionField::FileName},
    {"Album", CollectionField::Album},
    {"Artist", CollectionField::LeadArtist},
    {"Title", CollectionField::Title},
    {"TrackPosition", CollectionField::TrackPosition},
    {"PartOfSet", CollectionField::PartOfSet},
    {"TrackYear", CollectionField::TrackYear},
    {"Genre", CollectionField::Genre},
    {"CopyrightHolder", CollectionField::CopyrightHolder},
    {"Label", CollectionField::Label},
    {"Comments", CollectionField::Comments},
    {"ID", CollectionField::DoesFileExist}};

ADODB::RecordsetPtr recordsetOf(const std::vector<CollectionRow> &rows)
{
    auto records = std::make_shared<ADODB::Recordset>();
    for (const auto &[name, field] : taggedFields)
        records->appendField(QLatin1String(name), field == CollectionField::Volgnummer
                                                      ? ADODB::adBigInt
                                                      : ADODB::adVarWChar);
    records->Open();
    for (const CollectionRow &row : rows) {
        records->AddNew();
        for (const auto &[name, field] : taggedFields)
            records->Fields(QString::fromLatin1(name)).setValue(row[field]);
        records->Update();
    }
    return records;
}

} // namespace

void frmCDRootMP3::enableTagScreens(bool edit, bool wizard)
{
    mUi->cmdUpdateID3->setEnabled(edit);
    mUi->cmdTagWizard->setEnabled(wizard);
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
    QHash<QString, QString> names;
    const auto renamed = [&](const CollectionRow &row, const QString &newName) {
        const ListItem item = mUi->TheMP3Collection->ListItems().Item(row.index);
        item.setSubItems(int(CollectionField::FileName), newName);
        names.insert(row[CollectionField::Volgnummer], newName);
    };
    renameFiles(*this, folder(), rowsAt(selectedRows()), renamed, allRows());
    mRows.setFileNames(names);
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
    const ListItem item = mUi->TheMP3Collection->SelectedItem();
    if (!mUi->cmdUpdateID3->isEnabled() || !item.Selected() || !LongWork::mayBegin(*this))
        return;
    const Hourglass hourglass(this);
    const QString path = pathInFolder(folder(), item.SubItems(int(CollectionField::FileName)));
    if (FileExists(path)) {
        EditMP3Tags::edit(path);
        backFromTagScreen();
    } else {
        RefreshAndHandleButtons();
        activate();
    }
}

// Its list is read again if a tag was written.
void frmCDRootMP3::backFromTagScreen()
{
    if (isUnloaded())
        return;
    RedrawLocked = true;
    activate();
    RedrawLocked = false;
}

void frmCDRootMP3::cmdTagWizard_Click()
{
    if (!mUi->cmdTagWizard->isEnabled() || !LongWork::mayBegin(*this))
        return;
    const Hourglass hourglass(this);
    const std::vector<CollectionRow> rows = rowsAt(selectedRows());
    for (const CollectionRow &row : rows) {
        if (FileExists(pathInFolder(folder(), row[CollectionField::FileName])))
            continue;
        RefreshAndHandleButtons();
        activate();
        return;
    }
    try {
        openTagWizard(rows);
    } catch (const Error &error) {
        plainBox(error.numbered());
    }
}

void frmCDRootMP3::openTagWizard(const std::vector<CollectionRow> &rows)
{
    auto &wizard = defaultInstance<frmTagWizardPg1>();
    wizard.Folder = folder() + QDir::separator(); // two of them behind a drive's root
    wizard.FileRecords = recordsetOf(rows);
    Desktop::current().pump();
    wizard.ShowModal();
    backFromTagScreen();
}
