#include "mp3/frmTagWizardPg1.h"

#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "discdata/cddbcontrol.h"
#include "discdata/cddbtagmanager.h"
#include "discdata/discservice.h"
#include "mp3/frmMatchWithSongcase.h"
#include "mp3/matchchoice.h"
#include "mp3/matchedcells.h"
#include "mp3/matchtags.h"
#include "mp3/tagrow.h"
#include "mp3/ui_frmTagWizardPg1.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/options.h"
#include "platform/work/longwork.h"
#include "services/captions.h"
#include "services/fileutilities.h"
#include "services/frame.h"
#include "services/messages.h"
#include "tags/filenameparts.h"

using namespace Qt::StringLiterals;

namespace
{

// Widths in tenths of the list's: what does not fit is scrolled to.
const std::vector<ListColumn> columns = {{ListColumn::Number, "TagsProcVolgnummer", 1},
                                         {ListColumn::Text, "TagsProcFileName", 4},
                                         {ListColumn::Text, "TagsProcAlbum", 4},
                                         {ListColumn::Text, "TagsProcArtist", 3},
                                         {ListColumn::Text, "TagsProcTitle", 4},
                                         {ListColumn::Text, "TagsProcTrackPosition", 1},
                                         {ListColumn::Text, "TagsProcPartOfSet", 1},
                                         {ListColumn::Text, "TagsProcTrackYear", 1},
                                         {ListColumn::Text, "TagsProcGenre", 1},
                                         {ListColumn::Text, "TagsProcCopyrightHolder", 1},
                                         {ListColumn::Text, "TagsProcLabel", 1},
                                         {ListColumn::Text, "TagsProcComments", 1},
                                         {ListColumn::Hidden}};
constexpr int whole = 10;

// By design: these two are English in either language.
const QString aborted = u"Operation aborted"_s;
const QString occurred = u"error occurred"_s;

void tellFailure(const Error &error)
{
    errorBox(error.numbered(), GetMessage("MsgSysErr"));
}

} // namespace

frmTagWizardPg1::frmTagWizardPg1()
    : Form(u"frmTagWizardPg1"_s),
      mUi(std::make_unique<Ui::frmTagWizardPg1>()),
      mControl(std::make_unique<CDDBControl>()),
      mTagManager(mControl->GetTagManager())
{
    mUi->setupUi(this);
    mColumns = new ListColumns(mUi->TheFileList, columns, whole);
    mCells = new MatchedCells(mUi->TheFileList);
    mUi->TheFileList->setItemDelegate(mCells);
    mUi->TheFileList->setSelectionMode(QAbstractItemView::ExtendedSelection);
    mUi->TheFileList->setCheckBoxes(true);
    setDefaultButton(mUi->cmdSaveTags);
    setCancelButton(mUi->CancelButton);
    connectControls();
}

frmTagWizardPg1::~frmTagWizardPg1() = default;

void frmTagWizardPg1::connectControls()
{
    connect(mUi->OKButton, &QPushButton::clicked, this, &frmTagWizardPg1::OKButton_Click);
    connect(mUi->cmdSaveTags, &QPushButton::clicked, this, &frmTagWizardPg1::cmdSaveTags_Click);
    connect(mUi->CancelButton, &QPushButton::clicked, this, &Form::Unload);
    connect(mUi->TheFileList, &DBListViewCTL::ItemCheck, this, &frmTagWizardPg1::followChecks);
}

void frmTagWizardPg1::setCaptions()
{
    applyCaptions(this, {{"frmTagWizardPg1", "xTagsProcessorCaption"},
                         {"lblWhat", "TagsProcessorWhat"},
                         {"optRelateToCDDB", "optRelateToCDDB"},
                         {"optRelateToDatabase", "optRelateToDatabase"},
                         {"OKButton", "OKButton"},
                         {"cmdSaveTags", "cmdSaveTags"},
                         {"CancelButton", "CancelButton"}});
    mUi->TheFileList->setAccessibleName(GetMessage("xFilesToTag"));
}

void frmTagWizardPg1::Form_Load()
{
    setCaptions();
    chooseOption(mUi->optRelateToCDDB);
    placeInFrame(this, 0.25, 0.25);
}

// By design: each time the form becomes the active one the list is made anew, and matches that were
// not saved are gone. The end of a dialog that belongs to a match does not count. What handles
// events or asks has to wait until the toolkit is through with the activation.
void frmTagWizardPg1::Form_Activate()
{
    if (mPassOver || isBusy()) {
        mPassOver = false;
        return;
    }
    fillList();
    mUi->TheFileList->setFocus();
    QMetaObject::invokeMethod(this, &frmTagWizardPg1::InitializeCDDBControl, Qt::QueuedConnection);
}

void frmTagWizardPg1::Form_Unload()
{
    mControl->ShutDown();
}

void frmTagWizardPg1::fillList()
{
    if (!FileRecords)
        return;
    const Freeze freeze(this);
    if (FileRecords->RecordCount() > 0)
        FileRecords->MoveFirst();
    mColumns->show(FileRecords);
    mCells->setBefore(FileRecords->rows());
    const ListItem first = mUi->TheFileList->ListItems().Item(1);
    first.setChecked(true);
    mUi->TheFileList->setSelectedItem(first);
}

// Who does not sign up is asked once, not at each activation.
void frmTagWizardPg1::InitializeCDDBControl()
{
    if (isUnloaded())
        return;
    try {
        mIsSetUp = true;
        setUpCddb(*mControl, this, false);
        if (mControl->IsUserRegistered(0) != 0 || mSignUpAsked)
            return;
        mSignUpAsked = true;
        mPassOver = true;
        mControl->IsUserRegistered(1);
    } catch (const Error &error) {
        showCddbError(error);
    }
}

int frmTagWizardPg1::rowCount() const
{
    return mUi->TheFileList->ListItems().Count();
}

QString frmTagWizardPg1::pathOf(int row) const
{
    return systemPath(Folder + mUi->TheFileList->ListItems().Item(row).SubItems(tagrow::fileName));
}

void frmTagWizardPg1::followChecks()
{
    DBListViewCTL &list = *mUi->TheFileList;
    const QModelIndex current = list.currentIndex(); // where the keys go on
    auto items = list.ListItems();
    for (int row = 1; row <= items.Count(); ++row)
        items.Item(row).setSelected(items.Item(row).Checked());
    list.selectionModel()->setCurrentIndex(current, QItemSelectionModel::NoUpdate);
}

bool frmTagWizardPg1::AnyFileChecked() const
{
    auto items = mUi->TheFileList->ListItems();
    for (int row = 1; row <= items.Count(); ++row) {
        if (items.Item(row).Checked())
            return true;
    }
    return false;
}

bool frmTagWizardPg1::AnyTagPresent() const
{
    auto items = mUi->TheFileList->ListItems();
    for (int row = 1; row <= items.Count(); ++row) {
        for (int item = tagrow::firstTag; item <= tagrow::lastShownTag; ++item) {
            if (!items.Item(row).SubItems(item).isEmpty())
                return true;
        }
    }
    return false;
}

void frmTagWizardPg1::OKButton_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    try {
        if (!AnyFileChecked()) {
            warningBox(GetMessage("MP3TagsProcCheckFiles"));
            return;
        }
        if (AnyTagPresent() && askYesNo(GetMessage("AllTagsWillBeOverwritten")) != vbYes)
            return;
        if (isUnloaded()) // behind the box
            return;
        mCancelled = false;
        if (!match() && !mCancelled && !isUnloaded())
            errorBox(GetMessage("MP3TagsProcNoMatchFound"));
    } catch (const Error &) {
        errorBox(occurred);
    }
}

bool frmTagWizardPg1::match()
{
    return mUi->optRelateToCDDB->isChecked() ? matchChecked() : MatchFilesWithCatalogue(rowCount());
}

// The first that finds its disc is enough.
bool frmTagWizardPg1::matchChecked()
{
    auto items = mUi->TheFileList->ListItems();
    for (int row = 1; row <= items.Count() && !isUnloaded() && !mCancelled; ++row) {
        if (items.Item(row).Checked() && MatchFileWithCDDB(pathOf(row)))
            return true;
    }
    return false;
}

bool frmTagWizardPg1::MatchFileWithCDDB(const QString &path)
{
    CddbDiscPtr disc;
    CddbMatchListPtr matches;
    try {
        disc = lookUp(path, matches);
        if (!disc && !matches)
            return false;
    } catch (const Error &error) {
        mCancelled = error.Number == errLookupCancelled;
        if (!mCancelled)
            tellFailure(error);
        warningBox(aborted);
        return false;
    }
    try {
        if (!disc)
            disc = chosenOf(matches);
        if (disc)
            return !isUnloaded() && takeDisc(*disc);
    } catch (const Error &error) {
        mCancelled = error.Number == errLookupCancelled;
    }
    warningBox(aborted);
    return false;
}

CddbDiscPtr frmTagWizardPg1::lookUp(const QString &path, CddbMatchListPtr &matches)
{
    if (!mIsSetUp) // pressed at once
        InitializeCDDBControl();
    const Hourglass hourglass(this);
    int track = 0;
    CddbDiscPtr disc = mTagManager->LookupByFile(path, 0, track);
    if (!disc)
        matches = mControl->GetFileMatches();
    return disc;
}

CddbDiscPtr frmTagWizardPg1::chosenOf(const CddbMatchListPtr &matches)
{
    mPassOver = true;
    const CddbDiscPtr chosen = mControl->ShowFuzzyDialog(matches);
    Desktop::current().pump();
    return chosen ? mControl->GetFullDisc(chosen, 0) : nullptr;
}

// By design: row i is track i, whatever stands in it.
bool frmTagWizardPg1::takeDisc(const CddbDisc &disc)
{
    if (disc.TrackCount() != rowCount()) {
        errorBox(GetMessage("MP3ProcNumberFilesNotCorrespond"));
        return false;
    }
    std::vector<CddbID3Tag> tags;
    for (int track = 1; track <= disc.TrackCount(); ++track)
        tags.push_back(mTagManager->TagForTrack(disc, track));
    fillRows(tags);
    informationBox(GetMessage("MP3ProcTagItemsSubstituted"));
    return true;
}

void frmTagWizardPg1::fillRows(const std::vector<CddbID3Tag> &tags)
{
    const Freeze freeze(this);
    auto items = mUi->TheFileList->ListItems();
    for (int row = 1; row <= std::min(items.Count(), int(tags.size())); ++row) {
        const ListItem item = items.Item(row);
        for (int n = tagrow::firstTag; const TagField field : tagrow::fields)
            item.setSubItems(n++, tags[size_t(row) - 1].field(field));
    }
}

bool frmTagWizardPg1::MatchFilesWithCatalogue(int count)
{
    try {
        if (!chooseFromCatalogue(count) || isUnloaded())
            return false;
        fillRows(tagsOfDisc(gMatchCDId, gMatchDiscNo));
        informationBox(GetMessage("MP3ProcTagItemsSubstituted"));
        return true;
    } catch (const Error &error) {
        tellFailure(error);
        warningBox(aborted);
        return false;
    }
}

// What the first file says of itself is proposed. The activation that follows the end of the search
// has to come before the rows are filled, whenever the window system tells of it.
bool frmTagWizardPg1::chooseFromCatalogue(int count)
{
    const CddbID3Tag first = tagOfRow(1);
    const FileNameParts name = filenameParts(pathOf(1));
    auto &search = defaultInstance<frmMatchWithSongcase>();
    search.NumberOfTracks = count;
    search.ChooseTracks = false;
    search.Artist = !first.LeadArtist().isEmpty() ? first.LeadArtist()
                    : name.albumArtist.isEmpty()  ? name.artist
                                                  : name.albumArtist;
    search.Title =
        !first.Album().isEmpty() || name.albumArtist.isEmpty() ? first.Album() : name.album;
    mPassOver = true;
    search.ShowModal();
    Desktop::current().pump();
    if (isUnloaded())
        return false;
    fillList();
    return gMatchChosen;
}
