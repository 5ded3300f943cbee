#include "mp3/RenamePreview.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/fittedcolumns.h"
#include "mp3/ui_RenamePreview.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

const std::vector<ListColumn> columns = {{ListColumn::Number, "Volgnummer"},
                                         {ListColumn::Text, "xOldName", 1},
                                         {ListColumn::Text, "xNewName", 1},
                                         {ListColumn::Text, "xRemark"}};

QString remarkOn(const PreviewedName &name)
{
    if (name.isFolderClosed)
        return GetMessage("xRemarkClosed");
    const bool hasItAlready = name.newName.oldPath == name.newName.newPath;
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
        return GetMessage(hasItAlready ? "xRemarkSame" : "xRemarkIsThere");
    case NameObstacle::FileGone:
        return GetMessage("xRemarkGone");
    case NameObstacle::None:
    case NameObstacle::MovedAlready:
        break;
    }
    return {};
}

bool hasRemark(const PreviewedName &name)
{
    return !remarkOn(name).isEmpty();
}

} // namespace

RenamePreview::RenamePreview(const std::vector<PreviewedName> &names)
    : Form(u"RenamePreview"_s), mUi(std::make_unique<Ui::RenamePreview>())
{
    mUi->setupUi(this);
    mColumns = new FittedColumns(mUi->NameList, columns);
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
    mColumns->widen(this);
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
    mColumns->show(rows);
    auto items = mUi->NameList->ListItems();
    for (size_t place = 0; place < names.size(); ++place)
        items.Item(int(place) + 1).setBold(hasRemark(names[place]));
    mColumns->fit();
}

void RenamePreview::countNames(const std::vector<PreviewedName> &names)
{
    const auto remarks = std::count_if(names.begin(), names.end(), hasRemark);
    const auto closed = std::count_if(names.begin(), names.end(),
                                      [](const auto &name) { return name.isFolderClosed; });
    QString text = GetMessage(names.empty()  ? "xNoRowsSelected"
                              : remarks == 0 ? "xNoConflicts"
                                             : "xConflicts");
    if (remarks > 0)
        text += QString::number(remarks);
    if (closed > 0)
        text += u'\n' + GetMessage("xClosedFolder") + QString::number(closed);
    mUi->lblCount->setText(text);
}
