#include "discdata/frmWhatNow.h"

#include "discdata/ui_frmWhatNow.h"
#include "platform/desktop/options.h"
#include "services/captions.h"
#include "services/frame.h"

using namespace Qt::StringLiterals;

// The two options exclude each other, as all do that stand side by side.
frmWhatNow::frmWhatNow()
    : Form(u"frmWhatNow"_s), Answer(u"0"_s), mUi(std::make_unique<Ui::frmWhatNow>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->OKButton);
    setCancelButton(mUi->CancelButton);
    connect(mUi->OKButton, &QPushButton::clicked, this, &frmWhatNow::OKButton_Click);
    connect(mUi->CancelButton, &QPushButton::clicked, this, [this] { answer(u"0"_s); });
}

frmWhatNow::~frmWhatNow() = default;

void frmWhatNow::Form_Load()
{
    placeInFrame(this, 0.3, 0.3);
    applyCaptions(this, {{"frmWhatNow", "frmDiscInfoCDDBCaption"},
                         {"lblWhatNowMsg", "lblWhatNowMsg"},
                         {"optEditCDDB", "optEditCDDBCaption"},
                         {"optInsertWithDummies", "optInsertWithDummiesCaption"},
                         {"OKButton", "WhatNowOK"},
                         {"CancelButton", "WhatNowCancel"}});
    chooseOption(mUi->optEditCDDB);
}

void frmWhatNow::answer(const QString &text)
{
    Answer = text;
    Unload();
}

void frmWhatNow::OKButton_Click()
{
    if (mUi->optEditCDDB->isChecked())
        answer(u"2"_s);
    else
        answer(mUi->optInsertWithDummies->isChecked() ? u"1"_s : u"0"_s);
}
