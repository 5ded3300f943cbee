#include "mp3/matchstatements.h"

#include "catalogue/quoting.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int anyNumber = -99;

const QString selectAlbums = u"select cdt.id as id "
                             ",      art.naam as naam "
                             ",      cdt.titel as titel "
                             ",      cds.diskno as diskno "
                             ",      count(*) as numtracks "
                             "from cdtitels cdt "
                             ",    artiesten art "
                             ",    compactdiscs cds "
                             "where art.id = cdt.artiest_id "
                             "and   cdt.id = cds.cdtitels_id "
                             "and   cdt.cd_type = 'E' "_s;
const QString groupAlbums = u" group by cdt.id, art.naam, cdt.titel,cds.diskno "_s;

const QString selectCompilations = u"select cdt.id as id "
                                   ",      null as naam "
                                   ",      cdt.titel as titel "
                                   ",      cds.diskno as diskno "
                                   ",      count(*) as numtracks "
                                   "from cdtitels cdt "
                                   ",    compactdiscs cds "
                                   "where   cdt.id = cds.cdtitels_id "
                                   "and   cdt.cd_type = 'V' "_s;
const QString groupCompilations = u" group by cdt.id, cdt.titel,cds.diskno "_s;

QString like(const QString &column, const QString &text, bool exact)
{
    if (text.isEmpty())
        return {};
    const QString wild = exact ? QString() : u"%"_s;
    return "and "_L1 + column + " like "_L1 + quoted(wild + text + wild) + u' ';
}

QString having(int numberOfTracks)
{
    return numberOfTracks > anyNumber ? "having count(*)= "_L1 + QString::number(numberOfTracks)
                                      : QString();
}

QString albums(const MatchQuestion &question)
{
    return selectAlbums + like(u"art.naam"_s, question.artist, question.exactArtist) +
           like(u"cdt.titel"_s, question.title, question.exactTitle) + groupAlbums +
           having(question.numberOfTracks);
}

// By design: they have no artist of their own, so that text does not narrow them.
QString compilations(const MatchQuestion &question)
{
    return selectCompilations + like(u"cdt.titel"_s, question.title, question.exactTitle) +
           groupCompilations + having(question.numberOfTracks);
}

} // namespace

QString matchingDiscs(const MatchQuestion &question)
{
    if (!question.compilations)
        return albums(question) + " order by 2,3"_L1;
    if (!question.albums)
        return compilations(question) + " order by 3"_L1;
    return albums(question) + " union "_L1 + compilations(question) + " order by 2,3"_L1;
}

QString tracksOfDisc(qint64 cdId, qint64 discNo)
{
    return " select art.naam as artiest, "
           "        trk.titel as titel, "
           "        cds.trackno as trackno "
           " from   artiesten art, "
           "        tracks    trk,  "
           "        compactdiscs cds "
           " where  art.id = trk.artiest_id "
           " and    trk.id = cds.track_id "
           " and    cds.cdtitels_id = "_L1 +
           QString::number(cdId) + " and    cds.diskno = "_L1 + QString::number(discNo) +
           " order by cds.trackno"_L1;
}
