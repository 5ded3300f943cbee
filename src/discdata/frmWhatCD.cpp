#include "discdata/frmWhatCD.h"

#include "catalogue/quoting.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/list/listcolumns.h"
#include "discdata/ui_frmWhatCD.h"
#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

// The condition that a title holds this text, which comes doubled; nothing asks for all.
QString titleHolds(const std::optional<QString> &text)
{
    return text ? u"trim(cdt.titel) like '%"_s + *text + u"%' and "_s : QString();
}

QString compilations(const QString &type, const std::optional<QString> &text)
{
    return u" SELECT cdt.id as ID, cdt.titel as titel  FROM CDTitels cdt where "_s +
           titleHolds(text) + u"cd_type = '"_s + type + u"' order by cdt.titel"_s;
}

QString albums(const QString &type, const std::optional<QString> &text)
{
    return u" SELECT cdt.id as ID, art.naam as artiest, cdt.titel as titel  FROM   CDTitels cdt, "
           "Artiesten art where art.id = cdt.Artiest_ID and "_s +
           titleHolds(text) + u"cd_type = '"_s + type + u"' order by art.naam, cdt.titel"_s;
}

// A remark in brackets behind the title is not looked for: the main title still is found.
QString wordsOf(const QString &searchKey)
{
    const qsizetype bracket = searchKey.indexOf(u'(');
    return doubled((bracket < 0 ? searchKey : searchKey.left(bracket)).trimmed());
}

bool isCompilation(const QString &type)
{
    return type == "V"_L1;
}

} // namespace

frmWhatCD::frmWhatCD() : Form(u"frmWhatCD"_s), mUi(std::make_unique<Ui::frmWhatCD>())
{
    mUi->setupUi(this);
    setDefaultButton(mUi->OKButton);
    setCancelButton(mUi->CancelButton);
    connectControls();
}

frmWhatCD::~frmWhatCD() = default;

void frmWhatCD::connectControls()
{
    connect(mUi->CDList, &DBListViewCTL::DblClick, this, &frmWhatCD::OKButton_Click);
    connect(mUi->cmdShowAll, &QPushButton::clicked, this, &frmWhatCD::cmdShowAll_Click);
    connect(mUi->OKButton, &QPushButton::clicked, this, &frmWhatCD::OKButton_Click);
    connect(mUi->CancelButton, &QPushButton::clicked, this, &frmWhatCD::CancelButton_Click);
}

void frmWhatCD::Form_Load()
{
    placeInFrame(this, 0.25, 0.2);
    applyCaptions(this, {{"frmWhatCD", "xWhatCDCaption"},
                         {"lblInstruction", "WhatCDInstruction"},
                         {"cmdShowAll", "ShowAllButtonCaption"},
                         {"OKButton", "OKButtonCaption"},
                         {"CancelButton", "CancelButtonCaption"}});
    mUi->CDList->setAccessibleName(GetMessage("xWhatCDCaption"));
    fill([this] { return showTitles(wordsOf(SearchKey)) || showTitles({}); });
}

void frmWhatCD::Form_Activate()
{
    if (mUi->CDList->isEnabled())
        mUi->CDList->setFocus();
    else
        mUi->CancelButton->setFocus();
}

// False if there is none.
bool frmWhatCD::showTitles(const std::optional<QString> &text)
{
    const auto titles = std::make_shared<ADODB::Recordset>();
    titles->Open(isCompilation(CDType) ? compilations(CDType, text) : albums(CDType, text),
                 *gConnection);
    std::vector<ListColumn> columns = {{ListColumn::Hidden}};
    if (!isCompilation(CDType))
        columns.push_back({ListColumn::Text, "Artiest", 1});
    columns.push_back({ListColumn::Text, "Titel", 1});
    delete mColumns;
    mColumns = new ListColumns(mUi->CDList, columns);
    mColumns->show(titles);
    const bool any = titles->RecordCount() > 0;
    titles->Close(); // the list holds its own rows
    return any;
}

template <typename Fill> void frmWhatCD::fill(Fill fillList)
{
    try {
        const bool any = fillList();
        mUi->CDList->setEnabled(any);
        if (!any) {
            errorBox(GetMessage("MsgStillNoCDOfThisType"));
            CD_ID = 0;
        }
    } catch (const Error &error) {
        errorBox(QString::number(error.Number) + u'-' + error.Description, GetMessage("MsgSysErr"));
    }
}

void frmWhatCD::cmdShowAll_Click()
{
    fill([this] { return showTitles({}); });
}

void frmWhatCD::OKButton_Click()
{
    const auto item = mUi->CDList->SelectedItem();
    CD_ID = mUi->CDList->isEnabled() && item ? item.Text().toLongLong() : 0;
    Unload();
}

void frmWhatCD::CancelButton_Click()
{
    CD_ID = 0;
    Unload();
}
