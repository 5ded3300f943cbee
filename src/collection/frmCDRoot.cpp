#include "collection/frmCDRoot.h"

#include "catalogue/quoting.h"
#include "collection/ui_frmCDRoot.h"
#include "platform/desktop/desktop.h"
#include "platform/error/error.h"
#include "services/captions.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

frmCDRoot::frmCDRoot() : CdEditor(u"frmCDRoot"_s), mUi(std::make_unique<Ui::frmCDRoot>())
{
    mUi->setupUi(this);
    setTexts();
    // By design: the save command's box is titled in Dutch in both languages.
    setUp({{nullptr, mUi->txtTitel, mUi->Genre, mUi->txtYear},
           mUi->DiscsTab,
           mUi->TheDiskToolbar,
           mUi->TheDisk,
           mUi->cmdCancel},
          {.left = 0.2,
           .unknownMode = GetMessage("MsgModeFalse"),
           .positionTitle = u"Systeemfout"_s,
           .idBeforeTransaction = true});
}

frmCDRoot::~frmCDRoot() = default;

void frmCDRoot::setTexts()
{
    applyCaptions(this, {{"frmCDRoot", "frmCDRootCaption"}, {"cmdCancel", "cmdCancelCaption"}});
    mUi->lblTitle->setText(GetMessage("Titel") + u':');
    mUi->lblGenre->setText(GetMessage("Genre") + u':');
    mUi->lblYear->setText(GetMessage("HitYear") + u':');
}

const char *frmCDRoot::gapIn(const Header &header) const
{
    return header.title.trimmed().isEmpty() ? "MsgCompNoTitle" : nullptr;
}

QString frmCDRoot::selectRecord(qint64 id) const
{
    return u"select cdt.id as CdId,"
           "       cdt.titel as CDTitle, "
           "       cdt.genre as Genre, "
           "       cdt.hitjaar as hitjaar, "
           "       max(cds.diskno) as DiscNum "
           "from  CDTitels cdt, "
           "      Compactdiscs cds "
           "where cdt.id = cds.CDtitels_Id "
           "and   cdt.id = "_s +
           QString::number(id) + u" group by cdt.id,cdt.titel,cdt.genre,cdt.hitjaar"_s;
}

QString frmCDRoot::insertTitle(qint64 id, const Header &header) const
{
    return u"Insert into CDTitels(id,titel,cd_type,genre,hitjaar) "
           " values ("_s +
           QString::number(id) + u',' + quoted(header.title) + u", 'V',"_s +
           quotedOrNull(header.genre) + u',' + numberOrNull(header.year) + u')';
}

QString frmCDRoot::updateTitle(qint64 id, const Header &header) const
{
    return u"Update CDTitels set titel = "_s + quoted(header.title) + u", genre = "_s +
           quotedOrNull(header.genre) + u", hitjaar = "_s + numberOrNull(header.year) +
           u" where ID = "_s + QString::number(id);
}

QWidget *frmCDRoot::behindLastTrack() const
{
    return mUi->txtTitel;
}

void frmCDRoot::RestoreDiskPosition()
{
    try {
        CdEditor::RestoreDiskPosition();
    } catch (const Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}
