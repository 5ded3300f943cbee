#include "collection/frmCDRootE.h"

#include "catalogue/quoting.h"
#include "collection/albumartist.h"
#include "collection/ui_frmCDRootE.h"
#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

frmCDRootE::frmCDRootE() : CdEditor(u"frmCDRootE"_s), mUi(std::make_unique<Ui::frmCDRootE>())
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
           .unknownMode = u"MsgModeFalse"_s,
           .positionTitle = GetMessage("MsgSysErr"),
           .idBeforeTransaction = false});
}

frmCDRootE::~frmCDRootE() = default;

void frmCDRootE::setTexts()
{
    applyCaptions(this, {{"frmCDRootE", "frmCDRootECaption"}, {"cmdCancel", "cmdCancelCaption"}});
    mUi->lblArtist->setText(GetMessage("Artiest") + u':');
    mUi->lblTitle->setText(GetMessage("Titel") + u':');
    mUi->lblGenre->setText(GetMessage("Genre") + u':');
    mUi->lblHitYear->setText(GetMessage("HitYear") + u':');
}

const char *frmCDRootE::gapIn(const Header &header) const
{
    if (header.artist.trimmed().isEmpty())
        return "MsgAlbNoArtist";
    return header.title.trimmed().isEmpty() ? "MsgAlbNoTitle" : nullptr;
}

QString frmCDRootE::selectRecord(qint64 id) const
{
    return u"select cdt.id as CdId,"
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
           "and   cdt.id = "_s +
           QString::number(id) + u" group by cdt.id,art.naam, cdt.titel,cdt.genre,cdt.hitjaar"_s;
}

QString frmCDRootE::insertTitle(qint64 id, const Header &header) const
{
    return u"Insert into CDTitels(id,titel,artiest_id,cd_type,genre,hitjaar) "
           " values ("_s +
           QString::number(id) + u',' + quoted(header.title) + u", "_s +
           QString::number(mArtistId) + u",'E',"_s + quotedOrNull(header.genre) + u',' +
           numberOrNull(header.year) + u')';
}

QString frmCDRootE::updateTitle(qint64 id, const Header &header) const
{
    return u" Update CDTitels set artiest_id = "_s + QString::number(mArtistId) + u", titel = "_s +
           quoted(header.title) + u", genre = "_s + quotedOrNull(header.genre) + u", hitjaar = "_s +
           numberOrNull(header.year) + u" where ID = "_s + QString::number(id);
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

// A name is found whatever the case of its letters, and stays as it is.
Header frmCDRootE::asStored(const Header &header)
{
    Header stored = header;
    stored.artist = albumartist::nameOf(mArtistId);
    if (stored.artist == header.artist)
        return header;
    releaseFrame();
    informationBox(GetMessage("xKeptArtist") + stored.artist);
    return stored;
}

QWidget *frmCDRootE::behindLastTrack() const
{
    return mUi->txtArtiest;
}
