#include "mp3/frmMatchWithSongcase.h"

#include "controls/list/accessiblecells.h"
#include "mp3/matchchoice.h"
#include "mp3/matchtree.h"
#include "mp3/ui_frmMatchWithSongcase.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "platform/error/error.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QKeyEvent>

frmMatchWithSongcase::frmMatchWithSongcase()
    : Form(QStringLiteral("frmMatchWithSongcase")),
      mUi(std::make_unique<Ui::frmMatchWithSongcase>()),
      mTree(new MatchTree(this))
{
    mUi->setupUi(this);
    mUi->TreeViewCD->setModel(mTree);
    setDefaultButton(mUi->cmdSearch);
    setCancelButton(mUi->cmdCancel);
    setCaptions();
    connectControls();
}

frmMatchWithSongcase::~frmMatchWithSongcase() = default;

void frmMatchWithSongcase::setCaptions()
{
    applyCaptions(this, {{"frmMatchWithSongcase", "frmMatchWithSongcaseCaption"},
                         {"frmMatchWith", "FrmMatchFilesWith"},
                         {"frmFindResults", "FrmFindResults"},
                         {"frmSearchOptions", "FrmSearchOptions"},
                         {"chkCompilations", "chkCompilations"},
                         {"chkAlbums", "chkAlbums"},
                         {"lblArtist", "lblArtistMatch"},
                         {"lblTitle", "lblTitleMatch"},
                         {"chkExactMatchArtist", "chkExactMatchArtist"},
                         {"chkExactMatchTitle", "chkExactMatchTitle"},
                         {"cmdChoose", "BtnChoose"},
                         {"cmdCancel", "BtnCancel"},
                         {"cmdSearch", "BtnSearch"}});
    mUi->TreeViewCD->setAccessibleName(GetMessage("FrmFindResults"));
}

void frmMatchWithSongcase::connectControls()
{
    const auto follow = &frmMatchWithSongcase::followChecks;
    connect(mUi->chkCompilations, &QCheckBox::clicked, this, follow);
    connect(mUi->chkAlbums, &QCheckBox::clicked, this, follow);
    connect(mUi->cmdSearch, &QPushButton::clicked, this, &frmMatchWithSongcase::cmdSearch_Click);
    connect(mUi->cmdChoose, &QPushButton::clicked, this, &frmMatchWithSongcase::cmdChoose_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, [this] {
        mChosen = false;
        Unload();
    });
    QTreeView *tree = mUi->TreeViewCD;
    connect(tree, &QTreeView::doubleClicked, this, &frmMatchWithSongcase::cmdChoose_Click);
    const auto tell = [tree](const QModelIndex &node) { tellExpanded(tree, node); };
    connect(tree, &QTreeView::expanded, this, tell);
    connect(tree, &QTreeView::collapsed, this, tell);
    tree->installEventFilter(this);
    connect(mTree, &MatchTree::failed, this, plainBox, Qt::QueuedConnection);
}

// Both kinds are searched until the user says otherwise.
void frmMatchWithSongcase::Form_Load()
{
    placeInFrame(this, 0.25, 0.25);
    mUi->txtArtist->setText(Artist);
    mUi->txtTitle->setText(Title);
    FillTreeWithDefaultText();
}

// What is proposed is there to be searched for at once, or to be typed over.
void frmMatchWithSongcase::Form_Activate()
{
    if (mShown)
        return;
    mShown = true;
    mUi->txtTitle->selectAll();
    mUi->txtArtist->selectAll();
    QLineEdit *first = Artist.isEmpty() && !Title.isEmpty() ? mUi->txtTitle : mUi->txtArtist;
    first->setFocus();
}

void frmMatchWithSongcase::Form_Unload()
{
    gMatchChosen = mChosen;
}

// Compilations have no artist of their own.
void frmMatchWithSongcase::followChecks()
{
    const bool albums = mUi->chkAlbums->isChecked();
    mUi->txtArtist->setEnabled(albums);
    mUi->txtTitle->setEnabled(albums || mUi->chkCompilations->isChecked());
}

void frmMatchWithSongcase::FillTreeWithDefaultText()
{
    mTree->showText(GetMessage("DefaultTreeText"));
    mUi->TreeViewCD->setCurrentIndex(mTree->index(0, 0));
}

MatchQuestion frmMatchWithSongcase::question() const
{
    MatchQuestion question;
    question.albums = mUi->chkAlbums->isChecked();
    question.compilations = mUi->chkCompilations->isChecked();
    question.artist = mUi->txtArtist->text();
    question.title = mUi->txtTitle->text();
    question.exactArtist = mUi->chkExactMatchArtist->isChecked();
    question.exactTitle = mUi->chkExactMatchTitle->isChecked();
    question.numberOfTracks = NumberOfTracks;
    return question;
}

void frmMatchWithSongcase::cmdSearch_Click()
{
    if (!mUi->chkAlbums->isChecked() && !mUi->chkCompilations->isChecked()) {
        warningBox(GetMessage("PleaseCheckMatchFilesWith"));
        FillTreeWithDefaultText();
        return;
    }
    try {
        search();
    } catch (const Error &error) {
        plainBox(error.numbered());
    }
}

void frmMatchWithSongcase::search()
{
    ADODB::Recordset found;
    {
        const Hourglass hourglass(this);
        found.Open(matchingDiscs(question()), *gConnection);
    }
    if (found.RecordCount() == 0) {
        showNothing();
        return;
    }
    const Freeze freeze(this);
    mTree->showDiscs(found.rows(), ChooseTracks);
    mUi->TreeViewCD->setCurrentIndex(mTree->index(0, 0));
    if (ChooseTracks && found.RecordCount() == 1)
        proposeTrack();
    mUi->cmdChoose->setEnabled(true);
    mUi->TreeViewCD->setFocus();
    tellCurrentRow(mUi->TreeViewCD);
}

// Of the only disc: the one that the caller thinks of, or the first.
void frmMatchWithSongcase::proposeTrack()
{
    const QModelIndex disc = mTree->index(0, 0);
    mUi->TreeViewCD->expand(disc);
    QModelIndex proposed = mTree->index(0, 0, disc);
    for (int row = 0; row < mTree->rowCount(disc); ++row) {
        const QModelIndex track = mTree->index(row, 0, disc);
        QString key = track.data(MatchTree::keyRole).toString();
        if (Track > 0 && matchkey::takeNumber(key, QStringLiteral("Trackno")) == Track)
            proposed = track;
    }
    if (proposed.isValid())
        mUi->TreeViewCD->setCurrentIndex(proposed);
}

void frmMatchWithSongcase::showNothing()
{
    errorBox(GetMessage("NoMatchFound"));
    const Freeze freeze(this);
    FillTreeWithDefaultText();
    mUi->cmdChoose->setEnabled(false);
}

// Enter on a node is the node's: else the form would search.
bool frmMatchWithSongcase::eventFilter(QObject *watched, QEvent *event)
{
    if (watched == mUi->TreeViewCD && event->type() == QEvent::KeyPress) {
        const auto *key = static_cast<QKeyEvent *>(event);
        if (key->key() == Qt::Key_Return || key->key() == Qt::Key_Enter) {
            cmdChoose_Click();
            return true;
        }
    }
    return Form::eventFilter(watched, event);
}

void frmMatchWithSongcase::cmdChoose_Click()
{
    const QModelIndex node = mUi->TreeViewCD->currentIndex();
    QString key = node.data(MatchTree::keyRole).toString();
    if (key.isEmpty() || key == matchkey::root || !mUi->cmdChoose->isEnabled())
        return;
    gMatchTrackNo = matchkey::takeNumber(key, QStringLiteral("Trackno"));
    mChosen = !ChooseTracks || gMatchTrackNo != 0;
    if (!mChosen) { // a disc is no answer to the question for a track
        mUi->TreeViewCD->setExpanded(node, !mUi->TreeViewCD->isExpanded(node));
        return;
    }
    gMatchDiscNo = matchkey::takeNumber(key, QStringLiteral("Discno"));
    gMatchCDId = matchkey::takeNumber(key, QStringLiteral("CD"));
    Unload();
}
