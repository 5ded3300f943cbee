#include "mp3/frmTracks.h"

#include "mp3/ui_frmTracks.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

frmTracks::frmTracks() : Form(u"frmTracks"_s), mUi(std::make_unique<Ui::frmTracks>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->cmdOK);
    setCancelButton(mUi->cmdCancel);
    applyCaptions(this, {{"frmTracks", "xSelectTrackCaption"},
                         {"lblSelectTrack", "SelectAssociatedTrack"},
                         {"cmdOK", "OKButtonCaption"},
                         {"cmdCancel", "CancelButtonCaption"}});
    mUi->lstTracks->setAccessibleName(GetMessage("xTracks"));
    connect(mUi->lstTracks, &QListWidget::itemDoubleClicked, this, &frmTracks::cmdOK_Click);
    connect(mUi->cmdOK, &QPushButton::clicked, this, &frmTracks::cmdOK_Click);
    connect(mUi->cmdCancel, &QPushButton::clicked, this, &Form::Unload);
}

frmTracks::~frmTracks() = default;

void frmTracks::Form_Load()
{
    placeInFrame(this, 0.3, 0.3);
}

void frmTracks::Form_Activate()
{
    mUi->lstTracks->setFocus();
}

void frmTracks::setDisc(const CddbDiscPtr &disc)
{
    mUi->lstTracks->clear();
    for (int position = 0; const CddbTrack &track : disc->Tracks())
        mUi->lstTracks->addItem(QString::number(++position) + u' ' + track.Artist() + u" - "_s +
                                track.Title());
    mUi->lstTracks->setCurrentRow(0);
}

void frmTracks::cmdOK_Click()
{
    mTrackNum = mUi->lstTracks->currentRow() + 1;
    Unload();
}
