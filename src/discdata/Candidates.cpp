#include "discdata/Candidates.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "discdata/ui_Candidates.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

const std::vector<ListColumn> columns = {{ListColumn::Hidden},
                                         {ListColumn::Text, "Artiest", 5},
                                         {ListColumn::Text, "Titel", 6},
                                         {ListColumn::Number, "xYear"},
                                         {ListColumn::Text, "xDiscOf"},
                                         {ListColumn::Number, "xTracksHead"},
                                         {ListColumn::Text, "xLabelName", 4},
                                         {ListColumn::Text, "xCountry"},
                                         {ListColumn::Text, "xSource", 4}};

QString numberOrNothing(int number)
{
    return number > 0 ? QString::number(number) : QString();
}

// "2 / 3", nothing for the only one.
QString partOf(const DiscRecord &disc)
{
    return disc.totalInSet == "1"_L1 ? QString() : disc.numberInSet + u" / "_s + disc.totalInSet;
}

QString sourceOf(const DiscRecord &disc)
{
    return disc.category.isEmpty() ? disc.barcode : disc.category;
}

} // namespace

Candidates::Candidates(const std::vector<DiscRecord> &candidates)
    : Form(u"Candidates"_s), mUi(std::make_unique<Ui::Candidates>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->OKButton);
    setCancelButton(mUi->CancelButton);
    applyCaptions(this, {{"Candidates", "xCandidatesCaption"},
                         {"lblWhich", "xCandidatesWhich"},
                         {"OKButton", "OKButtonCaption"},
                         {"CancelButton", "CancelButtonCaption"}});
    mUi->CandidateList->setAccessibleName(GetMessage("xCandidatesCaption"));
    fillList(candidates);
    connect(mUi->CandidateList, &DBListViewCTL::DblClick, this, &Candidates::choose);
    connect(mUi->OKButton, &QPushButton::clicked, this, &Candidates::choose);
    connect(mUi->CancelButton, &QPushButton::clicked, this, &Form::Unload);
}

Candidates::~Candidates() = default;

void Candidates::Form_Load()
{
    placeInFrame(this, 0.2, 0.2);
}

void Candidates::Form_Activate()
{
    mUi->CandidateList->setFocus();
}

void Candidates::fillList(const std::vector<DiscRecord> &candidates)
{
    auto rows = std::make_shared<ADODB::Recordset>();
    for (const char *name :
         {"place", "artist", "title", "year", "part", "tracks", "label", "country", "source"})
        rows->appendField(QLatin1String(name), ADODB::adVarWChar, 255);
    rows->Open();
    for (size_t place = 0; place < candidates.size(); ++place) {
        const DiscRecord &disc = candidates[place];
        const QString cells[] = {QString::number(place),
                                 disc.artist.name,
                                 disc.title,
                                 disc.year,
                                 partOf(disc),
                                 numberOrNothing(disc.trackCount),
                                 disc.label,
                                 disc.country,
                                 sourceOf(disc)};
        rows->AddNew();
        for (int column = 0; const QString &cell : cells)
            rows->Fields(column++).setValue(cell.left(255));
        rows->Update();
    }
    if (!candidates.empty())
        rows->MoveFirst();
    auto *list = new ListColumns(mUi->CandidateList, columns);
    list->show(rows);
}

void Candidates::choose()
{
    const auto item = mUi->CandidateList->SelectedItem();
    if (!item)
        return;
    mChosen = item.Text().toULongLong();
    Unload();
}
