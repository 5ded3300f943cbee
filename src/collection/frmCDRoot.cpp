#include "collection/frmCDRoot.h"

#include "catalogue/quoting.h"
#include "collection/ui_frmCDRoot.h"
#include "platform/ado/error.h"
#include "platform/desktop/desktop.h"
#include "shell/services/captions.h"
#include "shell/services/messages.h"

frmCDRoot::frmCDRoot()
    : CdEditor(QStringLiteral("frmCDRoot")), mUi(std::make_unique<Ui::frmCDRoot>())
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
           .positionTitle = QStringLiteral("Systeemfout"),
           .idBeforeTransaction = true});
}

frmCDRoot::~frmCDRoot() = default;

void frmCDRoot::setTexts()
{
    applyCaptions(this, {{"frmCDRoot", "frmCDRootCaption"}, {"cmdCancel", "cmdCancelCaption"}});
    mUi->lblTitle->setText(GetMessage("Titel") + QLatin1Char(':'));
    mUi->lblGenre->setText(GetMessage("Genre") + QLatin1Char(':'));
    mUi->lblYear->setText(GetMessage("HitYear") + QLatin1Char(':'));
}

const char *frmCDRoot::gapIn(const Header &header) const
{
    return header.title.trimmed().isEmpty() ? "MsgCompNoTitle" : nullptr;
}

QString frmCDRoot::selectRecord(qint64 id) const
{
    return QStringLiteral("select cdt.id as CdId,"
                          "       cdt.titel as CDTitle, "
                          "       cdt.genre as Genre, "
                          "       cdt.hitjaar as hitjaar, "
                          "       max(cds.diskno) as DiscNum "
                          "from  CDTitels cdt, "
                          "      Compactdiscs cds "
                          "where cdt.id = cds.CDtitels_Id "
                          "and   cdt.id = ") +
           QString::number(id) + QStringLiteral(" group by cdt.id,cdt.titel,cdt.genre,cdt.hitjaar");
}

QString frmCDRoot::selectIsOwn(qint64 id, const Header &saved) const
{
    return QStringLiteral("select iif(cd_type = 'V' and titel = ") + quoted(saved.title) +
           QStringLiteral(", 1, 0) as Own from CDTitels where id = ") + QString::number(id);
}

QString frmCDRoot::insertTitle(qint64 id, const Header &header) const
{
    return QStringLiteral("Insert into CDTitels(id,titel,cd_type,genre,hitjaar) "
                          " values (") +
           QString::number(id) + QLatin1Char(',') + quoted(header.title) +
           QStringLiteral(", 'V',") + quotedOrNull(header.genre) + QLatin1Char(',') +
           numberOrNull(header.year) + QLatin1Char(')');
}

QString frmCDRoot::updateTitle(qint64 id, const Header &header) const
{
    return QStringLiteral("Update CDTitels set titel = ") + quoted(header.title) +
           QStringLiteral(", genre = ") + quotedOrNull(header.genre) +
           QStringLiteral(", hitjaar = ") + numberOrNull(header.year) +
           QStringLiteral(" where ID = ") + QString::number(id);
}

QWidget *frmCDRoot::behindLastTrack() const
{
    return mUi->txtTitel;
}

void frmCDRoot::RestoreDiskPosition()
{
    try {
        CdEditor::RestoreDiskPosition();
    } catch (const ADODB::Error &error) {
        errorBox(error.numbered(), GetMessage("MsgSysErr"));
    }
}
