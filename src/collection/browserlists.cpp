#include "collection/browserlists.h"

#include "mp3/collections.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace browserlists
{

namespace
{

const auto selectCompilations = u" select cdt.id as Id, cdt.titel as Titel from cdtitels as cdt"
                                " where cdt.cd_type='V' order by cdt.titel asc "_s;

const auto selectAlbums =
    u" select cdt.id as Id, art.naam as Artiest, cdt.titel as Titel from cdtitels as "
    "cdt, artiesten as art"
    " where cdt.cd_type='E' and cdt.artiest_id=art.id order by cdt.titel asc "_s;

const auto selectMP3Collections =
    u" select mcs.id as Id, mcs.map as Map, mcs.album as Album from mp3collections as mcs"
    " order by mcs.album asc "_s;

const auto countTracks = u"SELECT COUNT(*) AS AANTAL FROM TRACKS"_s;

// By the rows themselves, for which the plus stands: an index of a large file is not compared with
// its table at the start, and one that is damaged would leave links of a record that goes. The
// engine tells of it here.
QString deleteDiscsOf(qint64 title)
{
    return u" delete from compactdiscs where +cdtitels_id = "_s + QString::number(title);
}

QString deleteTitleRow(qint64 title)
{
    return u" delete from cdtitels where id = "_s + QString::number(title);
}

QString deleteFilesOf(qint64 collection)
{
    return u" delete from mp3files where collectionid = "_s + QString::number(collection);
}

QString deleteCollectionRow(qint64 collection)
{
    return u" delete from mp3collections where id = "_s + QString::number(collection);
}

ADODB::RecordsetPtr open(const QString &statement)
{
    auto rows = std::make_shared<ADODB::Recordset>();
    rows->Open(statement, *gConnection, ADODB::adOpenForwardOnly, ADODB::adLockReadOnly);
    return rows;
}

// Children first.
void executeBoth(const QString &children, const QString &parent)
{
    ADODB::Transaction transaction(*gConnection);
    gConnection->Execute(children);
    gConnection->Execute(parent);
    transaction.CommitTrans();
}

} // namespace

ADODB::RecordsetPtr compilations()
{
    return open(selectCompilations);
}

ADODB::RecordsetPtr albums()
{
    return open(selectAlbums);
}

ADODB::RecordsetPtr mp3Collections()
{
    return open(selectMP3Collections);
}

qint64 trackCount()
{
    return open(countTracks)->Fields(u"Aantal").Value().toLong();
}

void deleteTitle(qint64 id)
{
    executeBoth(deleteDiscsOf(id), deleteTitleRow(id));
}

void deleteMP3Collection(qint64 id)
{
    executeBoth(deleteFilesOf(id), deleteCollectionRow(id));
    collections::tellDeleted(id);
}

} // namespace browserlists
