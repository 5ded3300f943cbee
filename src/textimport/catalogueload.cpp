#include "textimport/catalogueload.h"

#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"
#include "platform/text/normalform.h"
#include "services/globals.h"
#include "services/messages.h"
#include "textimport/importrecords.h"

#include <charconv>

using namespace Qt::StringLiterals;

/// One track as its row has it; the texts are those of the row.
struct CatalogueLoad::Track {
    Track(const ADODB::Rows &rows, qsizetype row);

    std::string_view artist, title, genre, year, mainTitle;
    qint64 listIndex, mainTitleIndex, disk, track;
};

namespace
{

bool compilations()
{
    return gImportCompilationNested || gImportCompilationFlat;
}

std::string_view textOf(const ADODB::Rows &rows, qsizetype row, importfield::Column column)
{
    const bool isText = rows.kind(row, column) == ADODB::Rows::Kind::Text;
    return isText ? rows.utf8(row, column) : std::string_view();
}

// The readers write most numbers as texts.
qint64 numberOf(const ADODB::Rows &rows, qsizetype row, importfield::Column column)
{
    if (rows.kind(row, column) == ADODB::Rows::Kind::Integer)
        return rows.integer(row, column);
    qint64 number = 0;
    const auto digits = textOf(rows, row, column);
    std::from_chars(digits.data(), digits.data() + digits.size(), number);
    return number;
}

// By design: the names in the questions have their apostrophes doubled, as the statements do.
QString compilationQuestion(std::string_view mainTitle)
{
    return GetMessage("QuestImpMainTitlePart1") + doubled(text::fromUtf8(mainTitle)) +
           GetMessage("QuestImpMainTitlePart2");
}

QString albumQuestion(std::string_view artist, std::string_view mainTitle)
{
    return GetMessage("QuestImpAlbPart1") + doubled(text::fromUtf8(artist)) +
           GetMessage("QuestImpAlbPart2") + doubled(text::fromUtf8(mainTitle)) +
           GetMessage("QuestImpAlbPart3");
}

bool isThere(std::initializer_list<ADODB::Parameter> values)
{
    ADODB::Command titles(*gConnection,
                          values.size() == 1
                              ? "select ID from CDTitels where Titel = ?"
                              : "select ID from CDTitels where Titel = ? and Artiest_ID = ?");
    return titles.find(values).rows >= 1;
}

} // namespace

CatalogueLoad::Track::Track(const ADODB::Rows &rows, qsizetype row)
    : artist(textOf(rows, row, importfield::Artist)),
      title(textOf(rows, row, importfield::TrackTitle)),
      genre(textOf(rows, row, importfield::Genre)),
      year(textOf(rows, row, importfield::Hitjaar)),
      mainTitle(textOf(rows, row, importfield::MainTitle)),
      listIndex(numberOf(rows, row, importfield::ListIndex)),
      mainTitleIndex(numberOf(rows, row, importfield::MainTitleIndex)),
      disk(numberOf(rows, row, importfield::DiskIndex)),
      track(numberOf(rows, row, importfield::TrackIndex))
{
}

CatalogueLoad::Outcome CatalogueLoad::run()
{
    ADODB::Transaction transaction(*gConnection);
    mImportedCount = 0;
    mLastCdIndex = 0;
    const auto rows = gImportRecords->rows();
    mSongs.emplace(*gConnection);
    takeIds(*rows);
    for (qsizetype row = 0; row < rows->rowCount(); ++row) {
        if (!step(row + 1, rows->rowCount()) || !load(Track(*rows, row))) {
            transaction.RollbackTrans();
            return Outcome::Cancelled;
        }
    }
    transaction.CommitTrans();
    return Outcome::Committed;
}

// The ids of titles and links are those that the readers counted. What has been saved since the
// file was read may have taken some of them: then all move up behind it.
void CatalogueLoad::takeIds(const ADODB::Rows &rows)
{
    if (rows.rowCount() == 0)
        return;
    const Track first(rows, 0);
    mTitleShift = std::max<qint64>(0, nextId(Table::CDTitels) - first.mainTitleIndex);
    mLinkShift = std::max<qint64>(0, nextId(Table::CompactDiscs) - first.listIndex);
}

// By design: artist and track come before the question about their CD and stay when it is answered
// No; the next clean-up takes those that nothing else points at.
bool CatalogueLoad::load(const Track &track)
{
    const qint64 artist = mSongs->findOrMakeArtist(track.artist);
    const qint64 trackId = findOrMakeTrack(track, artist);
    if (track.mainTitleIndex != mLastCdIndex && !beginCd(track, artist))
        return false;
    if (mCdAnswer == vbYes) {
        mSongs->makeLink(track.listIndex + mLinkShift,
                         {track.mainTitleIndex + mTitleShift, track.disk, track.track, trackId});
        ++mImportedCount;
    }
    return true;
}

// A track that is there already keeps its genre and year, whatever the file says.
// By design: an apostrophe in the genre of a new one is not doubled, and so refuses the import.
qint64 CatalogueLoad::findOrMakeTrack(const Track &track, qint64 artist)
{
    if (const auto found = mSongs->findTrack(artist, track.title))
        return *found;
    const std::string genre = undoubled(*gConnection, track.genre);
    return mSongs->makeTrack(artist, track.title, textOrNull(genre), wholeOrNull(track.year));
}

bool CatalogueLoad::beginCd(const Track &track, qint64 artist)
{
    mCdAnswer = answerFor(track, artist);
    if (mCdAnswer == vbCancel)
        return false;
    if (mCdAnswer == vbYes)
        mSongs->makeTitle({track.mainTitleIndex + mTitleShift, track.mainTitle,
                           compilations() ? std::nullopt : std::optional(artist)});
    mLastCdIndex = track.mainTitleIndex;
    return true;
}

BoxAnswer CatalogueLoad::answerFor(const Track &track, qint64 artist)
{
    if (compilations())
        return isThere({track.mainTitle}) ? ask(compilationQuestion(track.mainTitle)) : vbYes;
    return isThere({track.mainTitle, artist}) ? ask(albumQuestion(track.artist, track.mainTitle))
                                              : vbYes;
}
