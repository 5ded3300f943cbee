#include "collection/frmCDRootE.h"

#include "catalogue/quoting.h"
#include "collection/albumartist.h"
#include "collection/ui_frmCDRootE.h"
#include "shell/services/captions.h"
#include "shell/services/messages.h"

frmCDRootE::frmCDRootE()
    : CdEditor(QStringLiteral("frmCDRootE")), mUi(std::make_unique<Ui::frmCDRootE>())
{
    mUi->setupUi(this);
    setTexts();
    // By design: an unknown mode is told with the bare key.
    setUp({{mUi->txtArtiest, mUi->txtTitel, mUi->Genre, mUi->txtYear},
           mUi->DiscsTab,
           mUi->TheDiskToolbar,
           mUi->TheDiskE,
           mUi->cmdCancel},
          {.left = 0.42,
           .unknownMode = QStringLiteral("MsgModeFalse"),
           .positionTitle = GetMessage("MsgSysErr"),
           .idBeforeTransaction = false});
}

frmCDRootE::~frmCDRootE() = default;

void frmCDRootE::setTexts()
{
    applyCaptions(this, {{"frmCDRootE", "frmCDRootECaption"}, {"cmdCancel", "cmdCancelCaption"}});
    mUi->lblArtist->setText(GetMessage("Artiest") + QLatin1Char(':'));
    mUi->lblTitle->setText(GetMessage("Titel") + QLatin1Char(':'));
    mUi->lblGenre->setText(GetMessage("Genre") + QLatin1Char(':'));
    mUi->lblHitYear->setText(GetMessage("HitYear") + QLatin1Char(':'));
}

const char *frmCDRootE::gapIn(const Header &header) const
{
    if (header.artist.trimmed().isEmpty())
        return "MsgAlbNoArtist";
    return header.title.trimmed().isEmpty() ? "MsgAlbNoTitle" : nullptr;
}

QString frmCDRootE::selectRecord(qint64 id) const
{
    return QStringLiteral("select cdt.id as CdId,"
                          "       art.naam as Artiest, "
                          "       cdt.titel as CDTitle, "
                          "       cdt.genre as Genre, "
                          "       cdt.hitjaar as hitjaar, "
                          "       max(cds.diskno) as DiscNum "
                          "from  CDTitels cdt, "
                          "      Compactdiscs cds, "
                          "      Artiesten art "
                          "where cdt.id = cds.CDtitels_Id "
                          "and   art.id = cdt.artiest_id "
                          "and   cdt.id = ") +
           QString::number(id) +
           QStringLiteral(" group by cdt.id,art.naam, cdt.titel,cdt.genre,cdt.hitjaar");
}

QString frmCDRootE::selectIsOwn(qint64 id, const Header &saved) const
{
    return QStringLiteral("select iif(cdt.cd_type = 'E' and cdt.titel = ") + quoted(saved.title) +
           QStringLiteral(" and exists (select '1' from Artiesten art where art.id = "
                          "cdt.artiest_id and art.naam = ") +
           quoted(saved.artist) +
           QStringLiteral("), 1, 0) as Own from CDTitels cdt where cdt.id = ") +
           QString::number(id);
}

QString frmCDRootE::insertTitle(qint64 id, const Header &header) const
{
    return QStringLiteral("Insert into CDTitels(id,titel,artiest_id,cd_type,genre,hitjaar) "
                          " values (") +
           QString::number(id) + QLatin1Char(',') + quoted(header.title) + QStringLiteral(", ") +
           QString::number(mArtistId) + QStringLiteral(",'E',") + quotedOrNull(header.genre) +
           QLatin1Char(',') + numberOrNull(header.year) + QLatin1Char(')');
}

QString frmCDRootE::updateTitle(qint64 id, const Header &header) const
{
    return QStringLiteral(" Update CDTitels set artiest_id = ") + QString::number(mArtistId) +
           QStringLiteral(", titel = ") + quoted(header.title) + QStringLiteral(", genre = ") +
           quotedOrNull(header.genre) + QStringLiteral(", hitjaar = ") + numberOrNull(header.year) +
           QStringLiteral(" where ID = ") + QString::number(id);
}

void frmCDRootE::beforeTitle(const Header &header)
{
    mArtistId = albumartist::findOrMake(header.artist);
}

void frmCDRootE::afterTitle(const Header &header, const Header &saved)
{
    if (header.artist != saved.artist)
        albumartist::moveTracks(CdId, mArtistId);
}

QWidget *frmCDRootE::behindLastTrack() const
{
    return mUi->txtArtiest;
}
