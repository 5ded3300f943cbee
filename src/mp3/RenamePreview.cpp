#include "mp3/RenamePreview.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "mp3/ui_RenamePreview.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

const std::vector<ListColumn> columns = {{ListColumn::Number, "Volgnummer"},
                                         {ListColumn::Text, "xOldName", 5},
                                         {ListColumn::Text, "xNewName", 8},
                                         {ListColumn::Text, "xRemark", 6}};

bool hasItAlready(const PreviewedName &name)
{
    return name.newName.oldPath == name.newName.newPath;
}

QString remarkOn(const PreviewedName &name)
{
    switch (name.newName.obstacle) {
    case NameObstacle::TagMissing:
        return GetMessage("xRemarkNoTag");
    case NameObstacle::ForbiddenSymbols:
        return GetMessage("xRemarkSymbols");
    case NameObstacle::LetterRefused:
        return GetMessage("xRemarkLetter");
    case NameObstacle::TooLong:
        return GetMessage("xRemarkTooLong");
    case NameObstacle::OfAnotherRow:
        return GetMessage("xRemarkRow") + QString::number(name.newName.otherRow);
    case NameObstacle::OfAFolder:
        return GetMessage("xRemarkFolder");
    case NameObstacle::IsThere:
        return GetMessage(hasItAlready(name) ? "xRemarkSame" : "xRemarkIsThere");
    case NameObstacle::FileGone:
        return GetMessage("xRemarkGone");
    case NameObstacle::None:
    case NameObstacle::MovedAlready:
        break;
    }
    return {};
}

// A file that has its name already is no conflict.
bool isConflict(const PreviewedName &name)
{
    return !hasItAlready(name) && !remarkOn(name).isEmpty();
}

} // namespace

RenamePreview::RenamePreview(const std::vector<PreviewedName> &names)
    : Form(u"RenamePreview"_s), mUi(std::make_unique<Ui::RenamePreview>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdClose);
    setCancelButton(mUi->cmdClose);
    applyCaptions(this, {{"RenamePreview", "xRenamePreviewCaption"}, {"cmdClose", "xClose"}});
    mUi->NameList->setAccessibleName(GetMessage("xRenamePreviewCaption"));
    fillList(names);
    countNames(names);
    connect(mUi->cmdClose, &QPushButton::clicked, this, &Form::Unload);
}

RenamePreview::~RenamePreview() = default;

void RenamePreview::Form_Load()
{
    placeInFrame(this, 0.1, 0.1);
}

void RenamePreview::Form_Activate()
{
    mUi->NameList->setFocus();
}

void RenamePreview::fillList(const std::vector<PreviewedName> &names)
{
    const auto rows = std::make_shared<ADODB::Recordset>();
    for (const char *field : {"row", "old", "new", "remark"})
        rows->appendField(QLatin1String(field), ADODB::adVarWChar);
    rows->Open();
    for (const PreviewedName &name : names) {
        rows->AddNew();
        const bool hasName = name.newName.obstacle != NameObstacle::TagMissing;
        rows->Fields(0).setValue(QString::number(name.row));
        rows->Fields(1).setValue(name.oldName);
        rows->Fields(2).setValue(hasName ? name.newName.name : QString());
        rows->Fields(3).setValue(remarkOn(name));
    }
    (new ListColumns(mUi->NameList, columns))->show(rows);
    auto items = mUi->NameList->ListItems();
    for (size_t place = 0; place < names.size(); ++place)
        items.Item(int(place) + 1).setBold(isConflict(names[place]));
}

void RenamePreview::countNames(const std::vector<PreviewedName> &names)
{
    const auto conflicts = std::count_if(names.begin(), names.end(), isConflict);
    mUi->lblCount->setText(names.empty() ? GetMessage("xNoRowsSelected")
                           : conflicts == 0
                               ? GetMessage("xNoConflicts")
                               : GetMessage("xConflicts") + QString::number(conflicts));
}
