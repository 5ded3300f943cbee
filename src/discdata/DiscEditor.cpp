#include "discdata/DiscEditor.h"

#include "catalogue/discnumber.h"
#include "catalogue/hityear.h"
#include "catalogue/typedtext.h"
#include "discdata/ui_DiscEditor.h"
#include "discs/cddbanswer.h"
#include "discs/xmcd.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/modalloop.h"
#include "platform/desktop/options.h"
#include "platform/desktop/passingwheel.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int longestText = 255;

QString kept(const QString &typed)
{
    return typedtext::keep(typed).text;
}

// The category that most discs of a genre are found in.
QString categoryOf(const QString &genre)
{
    const QString name = genre.toLower();
    for (const QString &category : cddbCategories()) {
        if (category != "data"_L1 && name.contains(category))
            return category;
    }
    return u"misc"_s;
}

// Names of a person are those of this artist alone.
ArtistName renamed(const ArtistName &was, const QString &name)
{
    return name == was.name ? was : ArtistName{name, {}, {}};
}

} // namespace

DiscEditor::DiscEditor(const DiscRecord &disc, const std::optional<TableOfContents> &toc,
                       const QStringList &genres)
    : Form(u"DiscEditor"_s),
      mUi(std::make_unique<Ui::DiscEditor>()),
      mDisc(disc),
      mNewToc(toc),
      mIsNew(toc.has_value())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->OKButton);
    setCancelButton(mUi->CancelButton);
    setCaptions();
    mUi->cboGenre->addItems(genres);
    ignorePassingWheel(mUi->cboGenre);
    ignorePassingWheel(mUi->cboCategory);
    show();
    connectControls();
    OptCmp_Change();
    mBefore = shown();
}

DiscEditor::~DiscEditor() = default;

bool DiscEditor::isToBeSent() const
{
    return mIsNew && mUi->chkSend->isChecked();
}

void DiscEditor::Form_Load()
{
    placeInFrame(this, 0.2, 0.1);
}

void DiscEditor::Form_Activate()
{
    mUi->txtTitle->setFocus();
}

void DiscEditor::setCaptions()
{
    applyCaptions(this, {{"DiscEditor", mIsNew ? "xNewDiscCaption" : "xDiscEditorCaption"},
                         {"lblCompilation", "lblCompilation"},
                         {"OptCmpYes", "Ja"},
                         {"OptCmpNo", "Nee"},
                         {"lblDisc", "lblDisc"},
                         {"lblTotalDiscs", "lblTotalDiscs"},
                         {"lblArtist", "xDiscArtist"},
                         {"lblFirstName", "xFirstName"},
                         {"lblLastName", "xLastName"},
                         {"lblTitle", "xDiscTitle"},
                         {"lblYear", "xDiscYear"},
                         {"lblGenre", "xDiscGenre"},
                         {"lblCategory", "xCategory"},
                         {"chkSend", "xSendDisc"},
                         {"OKButton", "OKButtonCaption"},
                         {"CancelButton", "CancelButtonCaption"}});
}

void DiscEditor::connectControls()
{
    for (QLineEdit *field : {mUi->txtArtist, mUi->txtFirstName, mUi->txtLastName, mUi->txtTitle})
        field->setMaxLength(longestText);
    mUi->cboGenre->lineEdit()->setMaxLength(longestText);
    mUi->txtYear->setMaxLength(4);
    connect(mUi->OptCmpYes, &QRadioButton::toggled, this, &DiscEditor::OptCmp_Change);
    connect(mUi->NumberInSet, &QSpinBox::valueChanged, this, [this](int number) {
        mUi->TotalInSet->setMinimum(number); // a set has at least as many discs
    });
    for (TrackGrid *tracks : {static_cast<TrackGrid *>(mUi->CompilationTracks),
                              static_cast<TrackGrid *>(mUi->AlbumTracks)}) {
        tracks->setLanguage(gLanguage);
        tracks->setConnection(gConnection.get());
        connect(tracks, &TrackGrid::LeaveForward, this, [this] {
            (mIsNew ? static_cast<QWidget *>(mUi->chkSend) : mUi->OKButton)
                ->setFocus(Qt::TabFocusReason);
        });
        connect(tracks, &TrackGrid::LeaveBackward, this, [this] {
            (mUi->cboCategory->isEnabled() ? mUi->cboCategory : mUi->cboGenre)
                ->setFocus(Qt::BacktabFocusReason);
        });
        connect(tracks, &TrackGrid::RequestSave, mUi->OKButton, &QPushButton::click);
    }
    connect(mUi->OKButton, &QPushButton::clicked, this, &DiscEditor::OKButton_Click);
    connect(mUi->CancelButton, &QPushButton::clicked, this, &Form::Unload);
}

void DiscEditor::show()
{
    chooseOption(mDisc.isCompilation ? mUi->OptCmpYes : mUi->OptCmpNo);
    mUi->NumberInSet->setMaximum(highestDisc);
    mUi->TotalInSet->setMaximum(highestDisc);
    mUi->NumberInSet->setValue(mDisc.numberInSet.toInt());
    mUi->TotalInSet->setMinimum(mUi->NumberInSet->value());
    mUi->TotalInSet->setValue(mDisc.totalInSet.toInt());
    mUi->txtArtist->setText(mDisc.artist.name);
    mUi->txtFirstName->setText(mDisc.artist.first);
    mUi->txtLastName->setText(mDisc.artist.last);
    mUi->txtTitle->setText(mDisc.title);
    mUi->txtYear->setText(mDisc.year);
    mUi->cboGenre->setEditText(mDisc.genre);
    for (const TrackRecord &track : mDisc.tracks)
        mTracks.append({0, {track.artist.name, track.title, track.genre, track.year}});
    showCategories();
    mUi->chkSend->setVisible(mIsNew);
    mUi->chkSend->setChecked(mIsNew);
    showTracks();
}

void DiscEditor::showTracks()
{
    mUi->CompilationTracks->ShowTracks(mTracks);
    mUi->AlbumTracks->ShowTracks(mTracks);
}

// A record that a server has keeps its place there.
void DiscEditor::showCategories()
{
    mUi->cboCategory->addItems(cddbCategories());
    mUi->cboCategory->setCurrentText(mDisc.category.isEmpty() ? categoryOf(mDisc.genre)
                                                              : mDisc.category);
    mUi->cboCategory->setEnabled(mDisc.category.isEmpty());
}

TrackGrid *DiscEditor::grid() const
{
    return mUi->OptCmpYes->isChecked() ? static_cast<TrackGrid *>(mUi->CompilationTracks)
                                       : mUi->AlbumTracks;
}

// The other grid takes over what this one holds. The artists that an album's tracks do not show
// come back with the compilation.
void DiscEditor::OptCmp_Change()
{
    auto *before = static_cast<TrackGrid *>(mUi->Tracks->currentWidget());
    if (before != grid()) {
        before->CommitEdit();
        const QList<StoredTrack> held = before->Tracks();
        for (qsizetype i = 0; i < held.size(); ++i) {
            const QString artist = mTracks[i].texts[ArtistField];
            mTracks[i] = held[i];
            if (before == mUi->AlbumTracks)
                mTracks[i].texts[ArtistField] = artist;
        }
        showTracks();
        mUi->Tracks->setCurrentWidget(grid());
    }
    mUi->lblFirstName->setEnabled(!mUi->OptCmpYes->isChecked());
    mUi->txtFirstName->setEnabled(!mUi->OptCmpYes->isChecked());
    mUi->lblLastName->setEnabled(!mUi->OptCmpYes->isChecked());
    mUi->txtLastName->setEnabled(!mUi->OptCmpYes->isChecked());
}

ArtistName DiscEditor::shownArtist() const
{
    const ArtistName typed{kept(mUi->txtArtist->text()), kept(mUi->txtFirstName->text()),
                           kept(mUi->txtLastName->text())};
    const bool sameParts = typed.first == mDisc.artist.first && typed.last == mDisc.artist.last;
    return sameParts ? renamed(mDisc.artist, typed.name) : typed;
}

DiscRecord DiscEditor::shown() const
{
    DiscRecord disc = mDisc;
    disc.isCompilation = mUi->OptCmpYes->isChecked();
    disc.numberInSet = QString::number(mUi->NumberInSet->value());
    disc.totalInSet = QString::number(mUi->TotalInSet->value());
    disc.artist = shownArtist();
    disc.title = kept(mUi->txtTitle->text());
    disc.year = kept(mUi->txtYear->text());
    disc.genre = kept(mUi->cboGenre->currentText());
    takeTracks(disc);
    return disc;
}

void DiscEditor::takeTracks(DiscRecord &disc) const
{
    const QList<StoredTrack> held = grid()->Tracks();
    for (size_t i = 0; i < disc.tracks.size() && i < size_t(held.size()); ++i) {
        TrackRecord &track = disc.tracks[i];
        const TrackTexts &texts = held[qsizetype(i)].texts;
        track.title = texts[TitleField];
        track.genre = texts[GenreField];
        track.year = texts[YearField];
        if (disc.isCompilation)
            track.artist = renamed(track.artist, texts[ArtistField]);
        else if (track.artist == mDisc.artist)
            track.artist = disc.artist;
    }
}

// Tells the first year that is none; the cursor stands there behind the box.
bool DiscEditor::refusesYears()
{
    const auto wrong = [](const QString &year) { return !year.isEmpty() && !isHitYear(year); };
    if (wrong(mUi->txtYear->text())) {
        mUi->txtYear->setFocus();
        errorBox(GetMessage("MsgInvalidYear"));
        return true;
    }
    const QList<StoredTrack> tracks = grid()->Tracks();
    for (int row = 0; row < tracks.size(); ++row) {
        if (wrong(tracks[row].texts[YearField])) {
            grid()->goToCell(row, YearField);
            errorBox(GetMessage("MsgInvalidYear"));
            return true;
        }
    }
    return false;
}

// Tells why a disc cannot be sent as it is.
bool DiscEditor::refusesSending(const DiscRecord &disc)
{
    const char *key = isToBeSent() ? notToBeSent(disc, *mNewToc) : nullptr;
    if (key)
        errorBox(GetMessage(QLatin1String(key)) + u'\r' + GetMessage("xNotSentHint"));
    return key;
}

void DiscEditor::OKButton_Click()
{
    grid()->CommitEdit();
    const DiscRecord typed = shown();
    if (refusesYears() || refusesSending(typed))
        return;
    mDisc = typed;
    mChanged = mDisc != mBefore;
    // No change of the disc: it only says where a new one goes.
    mDisc.category = mUi->cboCategory->currentText();
    mAccepted = true;
    Unload();
}

// A disc typed in is not thrown away by a slip of the hand.
bool DiscEditor::QueryUnload()
{
    if (mAccepted || shown() == mBefore)
        return true;
    return askYesNo(GetMessage("xDiscardChanges"), windowTitle()) == vbYes || modalWasRefused();
}
