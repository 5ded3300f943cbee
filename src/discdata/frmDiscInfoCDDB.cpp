#include "discdata/frmDiscInfoCDDB.h"

#include "catalogue/typedtext.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "discdata/SearchByWords.h"
#include "discdata/cddbcontrol.h"
#include "discdata/discservice.h"
#include "discdata/mmcontrol.h"
#include "discdata/ui_frmDiscInfoCDDB.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/options.h"
#include "platform/work/longwork.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

// Shares of the width of the list, and what they are parts of.
const std::vector<ListColumn> compilationColumns = {{ListColumn::Number, "Track", 2},
                                                    {ListColumn::Text, "Artiest", 4},
                                                    {ListColumn::Text, "Titel", 8},
                                                    {ListColumn::Text, "Genre", 2},
                                                    {ListColumn::Number, "HitYear", 2}};
constexpr int compilationWhole = 17; // by design: the shares add up to one more

const std::vector<ListColumn> albumColumns = {{ListColumn::Number, "Track", 2},
                                              {ListColumn::Text, "Titel", 8},
                                              {ListColumn::Text, "Genre", 2},
                                              {ListColumn::Number, "HitYear", 2}};
constexpr int albumWhole = 14;

constexpr int longestText = 255;

// As a record keeps it, and as the fields of the catalogue have room for.
QString kept(const QString &foreign)
{
    return typedtext::keep(foreign).text;
}

// "Last, First" of a person, as printed of all others.
QString sortedName(const QString &artist, const CddbFullName &name)
{
    const bool isPerson =
        !name.FirstName().trimmed().isEmpty() && !name.LastName().trimmed().isEmpty();
    return isPerson ? name.LastName() + u", "_s + name.FirstName() : artist;
}

QString artistOf(const CddbDisc &disc)
{
    if (disc.IsCompilation() != 0 || disc.Artist().trimmed().isEmpty())
        return disc.Artist();
    return sortedName(disc.Artist(), disc.FullName());
}

QString artistOf(const CddbTrack &track)
{
    return track.Artist().trimmed().isEmpty() ? track.Artist()
                                              : sortedName(track.Artist(), track.FullName());
}

} // namespace

frmDiscInfoCDDB::frmDiscInfoCDDB()
    : Form(u"frmDiscInfoCDDB"_s),
      mUi(std::make_unique<Ui::frmDiscInfoCDDB>()),
      TheCDDB(std::make_unique<CDDBControl>()),
      MCICtl(std::make_unique<MMControl>(*this))
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdDownload);
    setCancelButton(mUi->cmdCancel);
    connectControls();
    keepReadable();
}

frmDiscInfoCDDB::~frmDiscInfoCDDB() = default;

// The fields are disabled and yet there to be read.
void frmDiscInfoCDDB::keepReadable()
{
    for (QWidget *shown : std::initializer_list<QWidget *>{
             mUi->txtArtist, mUi->txtTitle, mUi->txtGenre, mUi->txtYear, mUi->txtDiscNo,
             mUi->txtTotalDiscs, mUi->OptCmpYes, mUi->OptCmpNo}) {
        QPalette palette = shown->palette();
        for (const auto role : {QPalette::Text, QPalette::WindowText})
            palette.setBrush(QPalette::Disabled, role, palette.brush(QPalette::Active, role));
        shown->setPalette(palette);
    }
}

void frmDiscInfoCDDB::connectControls()
{
    const auto on = [this](QPushButton *button, auto command) {
        connect(button, &QPushButton::clicked, this, command);
    };
    on(mUi->cmdDownload, &frmDiscInfoCDDB::cmdDownload_Click);
    on(mUi->cmdImport, &frmDiscInfoCDDB::cmdImport_Click);
    on(mUi->cmdUpdateInfo, &frmDiscInfoCDDB::cmdUpdateInfo_Click);
    on(mUi->cmdSubmitDisc, &frmDiscInfoCDDB::cmdSubmitDisc_Click);
    on(mUi->cmdCancel, &Form::Unload);
}

void frmDiscInfoCDDB::Form_Load()
{
    placeInFrame(this, 0.42, 0);
    setButtonsEnabled(false);
    InitializeCDDBControl();
    setCaptions();
    ClearDiscInfo();
}

void frmDiscInfoCDDB::setCaptions()
{
    applyCaptions(this, {{"frmDiscInfoCDDB", "frmDiscInfoCDDBCaption"},
                         {"lblIntroText", "lblIntroText"},
                         {"lblDrive", "lblDrive"},
                         {"lblDisc", "lblDisc"},
                         {"lblTotalDiscs", "lblTotalDiscs"},
                         {"lblCompilation", "lblCompilation"},
                         {"cmdDownload", "cmdDownloadCaption"},
                         {"cmdCancel", "cmdCancelCaption"},
                         {"cmdUpdateInfo", "cmdUpdateInfoCaption"},
                         {"cmdSubmitDisc", "cmdSubmitDiscCaption"},
                         {"cmdImport", "cmdImportCaption"},
                         {"OptCmpYes", "Ja"},
                         {"OptCmpNo", "Nee"}});
    mUi->lblArtist->setText(GetMessage("Artiest") + u':');
    mUi->lblTitle->setText(GetMessage("Titel") + u':');
    mUi->lblGenre->setText(GetMessage("Genre") + u':');
    mUi->lblYear->setText(GetMessage("HitYear") + u':');
    mUi->DlvTracks->setAccessibleName(GetMessage("xTracks"));
}

void frmDiscInfoCDDB::Form_Activate()
{
    mUi->TheDrive->setFocus();
}

void frmDiscInfoCDDB::Form_Unload()
{
    TheCDDB->ShutDown();
    mGenres.reset();
    mTrackRows.reset();
}

void frmDiscInfoCDDB::InitializeCDDBControl()
{
    try {
        setUpCddb(*TheCDDB, this);
    } catch (const Error &error) {
        errorBox(error.Description);
    }
}

void frmDiscInfoCDDB::setButtonsEnabled(bool enabled)
{
    for (QPushButton *button : {mUi->cmdUpdateInfo, mUi->cmdImport, mUi->cmdSubmitDisc})
        button->setEnabled(enabled);
}

// The list shows one empty row whose only column is hidden.
void frmDiscInfoCDDB::ClearDiscInfo()
{
    for (QLineEdit *field : {mUi->txtArtist, mUi->txtTitle, mUi->txtGenre, mUi->txtYear,
                             mUi->txtDiscNo, mUi->txtTotalDiscs})
        field->clear();
    mTrackRows = std::make_shared<ADODB::Recordset>();
    mTrackRows->appendField(u"Dummy"_s, ADODB::adVarWChar, longestText);
    mTrackRows->Open();
    mTrackRows->AddNew();
    mTrackRows->Update();
    delete mColumns;
    mColumns = new ListColumns(mUi->DlvTracks, {{ListColumn::Hidden}});
    mColumns->show(mTrackRows);
    setButtonsEnabled(false);
    mEditFlags = 0; // those of the disc before say nothing about the next
}

void frmDiscInfoCDDB::cmdDownload_Click()
{
    if (!LongWork::mayBegin(*this))
        return;
    const Form::Busy busy(*this);
    try {
        download();
    } catch (const Error &error) {
        // By design: the pointer stays the hourglass.
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}

void frmDiscInfoCDDB::download()
{
    Desktop &desktop = Desktop::current();
    desktop.setPointer(this, vbHourglass);
    ClearDiscInfo();
    desktop.pump();
    const auto device = deviceName();
    const bool hasToc = device && openDevice(*device) && readToc();
    desktop.setPointer(this, vbDefault);
    if (hasToc)
        LookupCurrentDisc();
}

// Where to look, after asking where the entry is a question. "0" stands for no drive at all;
// nothing means that the user has thought better of it.
std::optional<QString> frmDiscInfoCDDB::deviceName()
{
    MCICtl->Words = {};
    QString name = mUi->TheDrive->Drive().trimmed();
    if (mUi->TheDrive->entry() == DriveBox::Image) {
        name = Desktop::current().openFileName(
            {GetMessage("xImageTitle"), mFolder, GetMessage("xImageFiles"), {}});
    } else if (mUi->TheDrive->entry() == DriveBox::Folder) {
        name = Desktop::current().folderName({GetMessage("xFolderTitle"), mFolder, {}, {}});
    } else if (mUi->TheDrive->entry() == DriveBox::Words) {
        auto *question = new SearchByWords;
        question->ShowModal();
        MCICtl->Words = question->words();
        name = MCICtl->Words.isEmpty() ? QString() : u"0"_s;
    } else if (name.isEmpty()) {
        return u"0"_s;
    }
    if (mUi->TheDrive->entry() == DriveBox::Image || mUi->TheDrive->entry() == DriveBox::Folder)
        mFolder = name.isEmpty() ? mFolder : QFileInfo(name).path(); // the next one is beside it
    return name.isEmpty() ? std::nullopt : std::optional(name);
}

bool frmDiscInfoCDDB::openDevice(const QString &device)
{
    MCICtl->DeviceType = u"CDAudio"_s;
    MCICtl->FileName = device;
    MCICtl->Command(u"Open"_s);
    Desktop::current().pump();
    if (MCICtl->Tracks() > 0)
        return true;
    const QString problem = MCICtl->problem();
    if (!MCICtl->wasCancelled())
        warningBox(GetMessage("MsgNoDisc") + (problem.isEmpty() ? problem : u'\r' + problem));
    MCICtl->Command(u"Close"_s);
    return false;
}

bool frmDiscInfoCDDB::readToc()
{
    // By design: the answer of the sign-up is not looked at; the look-up goes on in any case.
    if (TheCDDB->IsUserRegistered(0) == 0)
        TheCDDB->IsUserRegistered(1);
    const QString toc = TheCDDB->GetTocFromDevice(MCICtl->DeviceID());
    if (toc.isEmpty()) {
        errorBox(GetMessage("MsgInvalidTOC"));
        return false; // by design: the device stays open
    }
    mToc = toc;
    MCICtl->Command(u"Close"_s); // before the network is used
    return true;
}

void frmDiscInfoCDDB::LookupCurrentDisc()
{
    try {
        lookUp();
    } catch (const Error &error) {
        // By design: any other failure ends the look-up without a word.
        if (error.Number == errHostNotFound)
            errorBox(GetMessage("MsgHostNotFound"));
    }
}

void frmDiscInfoCDDB::lookUp()
{
    mGenres = TheCDDB->GetGenreList(0);
    const int result = TheCDDB->LookupDisc(mToc, 0);
    const CddbMatch match = TheCDDB->GetMatch();
    if (result == cddbExact)
        ShowDiscInfo(std::get<CddbDiscPtr>(match));
    else if (result == cddbSeveral)
        takeOneOf(std::get<CddbMatchListPtr>(match));
    else if (result == cddbNoMatch && askYesNo(GetMessage("QuestNoMatchFound")) == vbYes)
        newDisc();
}

void frmDiscInfoCDDB::takeOneOf(const CddbMatchListPtr &list)
{
    CddbDiscPtr chosen = TheCDDB->ShowFuzzyDialog(list);
    if (!chosen) {
        informationBox(GetMessage("MsgFuzzyMatchDialogCancelled"));
        return;
    }
    if (!chosen->DiscKeyA().isEmpty() || !chosen->DiscKeyB().isEmpty())
        chosen = TheCDDB->GetFullDisc(chosen, 0);
    ShowDiscInfo(chosen);
}

// What the user has typed can be imported whether it was sent or not.
void frmDiscInfoCDDB::newDisc()
{
    const CddbDiscPtr disc = TheCDDB->CreateDisc(mToc, {}, {});
    mDisc = disc;
    mEditFlags = 2;
    mEditFlags = TheCDDB->ShowEditDialog(disc, 2);
    try {
        if (mEditFlags & cddbToSend) {
            TheCDDB->SubmitDisc(disc, 0);
            mEditFlags = 1; // once is enough
            informationBox(GetMessage("MsgDiscSubmitted"));
        }
    } catch (const Error &error) {
        if (error.Number == errHostNotFound)
            errorBox(GetMessage("MsgHostNotFound"));
    }
    ShowDiscInfo(disc);
}

void frmDiscInfoCDDB::ShowDiscInfo(const CddbDiscPtr &disc)
{
    mDisc = disc;
    showFields(*disc);
    makeTrackRows(*disc);
    showTracks(disc->IsCompilation() == 1);
    Desktop::current().pump();
    setButtonsEnabled(!isUnloaded());
}

void frmDiscInfoCDDB::showFields(const CddbDisc &disc)
{
    mUi->txtTitle->setText(kept(disc.Title()));
    mUi->txtArtist->setText(kept(artistOf(disc)));
    mUi->txtYear->setText(disc.Year());
    mUi->txtGenre->setText(kept(genreName(disc.GenreId())));
    mUi->txtDiscNo->setText(disc.NumberInSet());
    mUi->txtTotalDiscs->setText(disc.TotalInSet());
    chooseOption(disc.IsCompilation() == 1 ? mUi->OptCmpYes : mUi->OptCmpNo);
}

QString frmDiscInfoCDDB::genreName(const QString &id) const
{
    return id.isEmpty() || !mGenres ? QString() : mGenres->GetGenreName(id);
}

void frmDiscInfoCDDB::makeTrackRows(const CddbDisc &disc)
{
    const bool withArtist = disc.IsCompilation() == 1;
    const auto rows = std::make_shared<ADODB::Recordset>();
    for (const char *name : {"Nr", "Artiest", "Titel", "Genre", "Hitjaar"}) {
        if (withArtist || QLatin1String(name) != "Artiest"_L1)
            rows->appendField(QLatin1String(name), ADODB::adVarWChar, longestText);
    }
    rows->Open();
    for (int number = 0; const CddbTrack &track : disc.Tracks()) {
        rows->AddNew();
        rows->Fields(u"Nr").setValue(QString::number(++number));
        if (withArtist)
            rows->Fields(u"Artiest").setValue(kept(artistOf(track)));
        rows->Fields(u"Titel").setValue(kept(track.Title()));
        if (!track.GenreId().isEmpty())
            rows->Fields(u"Genre").setValue(kept(genreName(track.GenreId())));
        rows->Fields(u"Hitjaar").setValue(track.Year());
        rows->Update();
        Desktop::current().pump();
    }
    mTrackRows = rows;
}

void frmDiscInfoCDDB::showTracks(bool withArtist)
{
    if (mTrackRows->RecordCount() > 0)
        mTrackRows->MoveFirst();
    const Freeze freeze(this);
    delete mColumns;
    mColumns = withArtist ? new ListColumns(mUi->DlvTracks, compilationColumns, compilationWhole)
                          : new ListColumns(mUi->DlvTracks, albumColumns, albumWhole);
    mColumns->show(mTrackRows);
}
