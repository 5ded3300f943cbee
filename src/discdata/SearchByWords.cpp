#include "discdata/SearchByWords.h"

#include "discdata/ui_SearchByWords.h"
#include "services/captions.h"
#include "services/frame.h"

using namespace Qt::StringLiterals;

SearchByWords::SearchByWords()
    : Form(u"SearchByWords"_s), mUi(std::make_unique<Ui::SearchByWords>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->OKButton);
    setCancelButton(mUi->CancelButton);
    applyCaptions(this, {{"SearchByWords", "xWordsCaption"},
                         {"lblWords", "xWordsWhich"},
                         {"lblArtist", "xDiscArtist"},
                         {"lblTitle", "xDiscTitle"},
                         {"lblBarcode", "xBarcode"},
                         {"OKButton", "xWordsSearch"},
                         {"CancelButton", "CancelButtonCaption"}});
    const auto follow = [this] { mUi->OKButton->setEnabled(!typed().isEmpty()); };
    for (QLineEdit *field : {mUi->txtArtist, mUi->txtTitle, mUi->txtBarcode})
        connect(field, &QLineEdit::textChanged, this, follow);
    connect(mUi->OKButton, &QPushButton::clicked, this, &SearchByWords::OKButton_Click);
    connect(mUi->CancelButton, &QPushButton::clicked, this, &Form::Unload);
    follow();
}

SearchByWords::~SearchByWords() = default;

void SearchByWords::Form_Load()
{
    placeInFrame(this, 0.3, 0.25);
}

// A barcode is often typed as it is printed, in groups.
SearchWords SearchByWords::typed() const
{
    QString barcode = mUi->txtBarcode->text();
    barcode.removeIf([](QChar c) { return c.isSpace() || c == u'-'; });
    return {mUi->txtArtist->text().trimmed(), mUi->txtTitle->text().trimmed(), barcode};
}

void SearchByWords::OKButton_Click()
{
    mWords = typed();
    Unload();
}
