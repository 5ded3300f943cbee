#include "textimport/catalogueload.h"

#include "catalogue/ids.h"
#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/importrecords.h"

using namespace Qt::StringLiterals;

/// One track as the statements take it: texts with their quotes doubled, genre and year as finished
/// values, numbers as digits.
struct CatalogueLoad::Track {
    Track(const ADODB::Rows &rows, qsizetype row);

    QString artist, title, mainTitle;
    QString genre, year;
    QString listIndex, mainTitleIndex, disk, track;
};

namespace
{

using Literal = QLatin1String;

QString selectArtist(const QString &artist)
{
    return Literal("Select ID, Naam From Artiesten where Naam = '") + artist + Literal("'");
}

QString insertArtist(const QString &id, const QString &artist)
{
    return Literal("Insert into Artiesten(ID,Naam) values (") + id + Literal(",'") + artist +
           Literal("')");
}

QString selectTrack(const QString &title, const QString &artistId)
{
    return Literal("select tr.ID as trackid,  "
                   "       ar.id as artistid, "
                   "       tr.Titel as titel  "
                   " from Tracks tr, "
                   "      Artiesten ar "
                   " where ar.id = tr.artiest_id "
                   " and tr.Titel = '") +
           title + Literal("' and tr.artiest_id = ") + artistId;
}

QString insertTrack(const QString &id, const QString &artistId, const QString &title,
                    const QString &genre, const QString &year)
{
    return Literal("Insert into Tracks(ID,Artiest_ID,Titel,Genre,Hitjaar) values (") + id +
           Literal(",") + artistId + Literal(",'") + title + Literal("',") + genre + Literal(",") +
           year + Literal(")");
}

QString selectCompilation(const QString &title)
{
    return Literal("select '1' from CDTitels where Titel = '") + title + Literal("'");
}

QString selectAlbum(const QString &title, const QString &artistId)
{
    return Literal("select '1' from CDTitels where Titel = '") + title +
           Literal("' and Artiest_ID = ") + artistId;
}

QString insertCompilation(const QString &id, const QString &title)
{
    return Literal("Insert into CDTitels(ID,Titel,CD_Type) values (") + id + Literal(",'") + title +
           Literal("','V')");
}

QString insertAlbum(const QString &id, const QString &title, const QString &artistId)
{
    return Literal("Insert into CDTitels(ID,Titel,Artiest_ID,CD_Type) values (") + id +
           Literal(",'") + title + Literal("',") + artistId + Literal(",'E')");
}

QString insertLink(const QString &id, const QString &cd, const QString &disk, const QString &track,
                   const QString &trackId)
{
    return Literal("Insert into Compactdiscs(id,cdtitels_id,diskno,trackno,track_id) values (") +
           id + Literal(",") + cd + Literal(",") + disk + Literal(",") + track + Literal(",") +
           trackId + Literal(")");
}

const auto nextArtistId = u"Select max(ID)+1 as ID from Artiesten"_s;
const auto nextTrackId = u"select max(id+1) as ID from tracks"_s;

bool compilations()
{
    return gImportCompilationNested || gImportCompilationFlat;
}

// By design: an apostrophe in a genre is not doubled; it breaks the statement and so refuses the
// import.
QString genreValue(const QString &genre)
{
    return genre.isEmpty() ? u"NULL"_s : QString(u'\'' + genre + u'\'');
}

bool isThere(const QString &statement)
{
    ADODB::Recordset answer;
    answer.Open(statement, *gConnection);
    return answer.RecordCount() >= 1;
}

// The id, in digits, that the only row of the answer has in this field; empty for any other number
// of rows.
QString onlyId(const QString &statement, QStringView field)
{
    ADODB::Recordset answer;
    answer.Open(statement, *gConnection);
    return answer.RecordCount() == 1 ? answer.Fields(field).Value().toText() : QString();
}

QString findOrMakeArtist(const QString &artist)
{
    QString id = onlyId(selectArtist(artist), u"ID");
    if (id.isEmpty()) {
        id = QString::number(nextId(nextArtistId, "ID"_L1));
        gConnection->Execute(insertArtist(id, artist));
    }
    return id;
}

// A track that is there already keeps its genre and year, whatever the file says.
QString findOrMakeTrack(const QString &title, const QString &artistId, const QString &genre,
                        const QString &year)
{
    QString id = onlyId(selectTrack(title, artistId), u"trackid");
    if (id.isEmpty()) {
        id = QString::number(nextId(nextTrackId, "ID"_L1));
        gConnection->Execute(insertTrack(id, artistId, title, genre, year));
    }
    return id;
}

// By design: the names in the questions have their apostrophes doubled, as the statements do.
QString compilationQuestion(const QString &mainTitle)
{
    return GetMessage("QuestImpMainTitlePart1") + mainTitle + GetMessage("QuestImpMainTitlePart2");
}

QString albumQuestion(const QString &artist, const QString &mainTitle)
{
    return GetMessage("QuestImpAlbPart1") + artist + GetMessage("QuestImpAlbPart2") + mainTitle +
           GetMessage("QuestImpAlbPart3");
}

} // namespace

CatalogueLoad::Track::Track(const ADODB::Rows &rows, qsizetype row)
    : artist(doubled(rows.text(row, importfield::Artist))),
      title(doubled(rows.text(row, importfield::TrackTitle))),
      mainTitle(doubled(rows.text(row, importfield::MainTitle))),
      genre(genreValue(rows.text(row, importfield::Genre))),
      year(numberOrNull(rows.text(row, importfield::Hitjaar))),
      listIndex(rows.text(row, importfield::ListIndex)),
      mainTitleIndex(rows.text(row, importfield::MainTitleIndex)),
      disk(rows.text(row, importfield::DiskIndex)),
      track(rows.text(row, importfield::TrackIndex))
{
}

CatalogueLoad::Outcome CatalogueLoad::run()
{
    ADODB::Transaction transaction(*gConnection);
    mImportedCount = 0;
    mLastCdIndex = 0;
    const auto rows = gImportRecords->rows();
    for (qsizetype row = 0; row < rows->rowCount(); ++row) {
        if (!step(row + 1, rows->rowCount()) || !load(Track(*rows, row))) {
            transaction.RollbackTrans();
            return Outcome::Cancelled;
        }
    }
    transaction.CommitTrans();
    return Outcome::Committed;
}

// By design: artist and track come before the question about their CD and stay when it is answered
// No; the next clean-up takes those that nothing else points at.
bool CatalogueLoad::load(const Track &track)
{
    const QString artistId = findOrMakeArtist(track.artist);
    const QString trackId = findOrMakeTrack(track.title, artistId, track.genre, track.year);
    const bool newCd = track.mainTitleIndex.toLongLong() != mLastCdIndex;
    if (newCd && !beginCd(track, artistId))
        return false;
    if (mCdAnswer == vbYes) {
        gConnection->Execute(
            insertLink(track.listIndex, track.mainTitleIndex, track.disk, track.track, trackId));
        ++mImportedCount;
    }
    return true;
}

bool CatalogueLoad::beginCd(const Track &track, const QString &artistId)
{
    mCdAnswer = answerFor(track, artistId);
    if (mCdAnswer == vbCancel)
        return false;
    if (mCdAnswer == vbYes)
        gConnection->Execute(compilations()
                                 ? insertCompilation(track.mainTitleIndex, track.mainTitle)
                                 : insertAlbum(track.mainTitleIndex, track.mainTitle, artistId));
    mLastCdIndex = track.mainTitleIndex.toLongLong();
    return true;
}

BoxAnswer CatalogueLoad::answerFor(const Track &track, const QString &artistId) const
{
    const bool isCompilation = compilations();
    if (!isThere(isCompilation ? selectCompilation(track.mainTitle)
                               : selectAlbum(track.mainTitle, artistId)))
        return vbYes;
    return ask(isCompilation ? compilationQuestion(track.mainTitle)
                             : albumQuestion(track.artist, track.mainTitle));
}
