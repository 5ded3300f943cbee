#include "discdata/discimport.h"

#include "catalogue/quoting.h"
#include "catalogue/songs.h"
#include "discdata/frmWhatCD.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

/// A row of the disc with what stands in for the missing.
struct DiscImport::Track {
    Track(ADODB::Recordset &rows, bool withArtist);

    QString number, artist, title, genre, year;
    QString shownArtist; // in the question: as statements have it
};

namespace
{

const QString noValue = u"NULL"_s; // as it stands in a statement

QString compilationsWithTitle(const QString &title)
{
    return u"SELECT '1' FROM CDTitels where cd_type='V' and titel= "_s + quoted(title);
}

QString albumsWithTitle(qint64 artist, const QString &title)
{
    return u"SELECT '1' FROM CDTitels where cd_type='E' and artiest_id = "_s +
           QString::number(artist) + u" and titel= "_s + quoted(title);
}

QString compilationOfTitle(const QString &title)
{
    return u"Select id as N from CDTitels where cd_type='V' and titel="_s + quoted(title);
}

QString albumOfTitle(qint64 artist, const QString &title)
{
    return u"Select id as N from CDTitels where cd_type='E' and artiest_id = "_s +
           QString::number(artist) + u" and titel="_s + quoted(title);
}

QString artistsOfName(const QString &name)
{
    return u"SELECT id as ID FROM artiesten where naam = "_s + quoted(name);
}

QString nextDiscOf(qint64 title)
{
    return u"SELECT max(diskno)+1 AS volgnr FROM CompactDiscs where CDtitels_id="_s +
           QString::number(title);
}

QString tracksOfTitle(qint64 artist, const QString &title)
{
    return u"SELECT id,genre,hitjaar From Tracks where artiest_id = "_s + QString::number(artist) +
           u" and Titel = "_s + quoted(title);
}

QString otherDiscsOf(qint64 track, qint64 title)
{
    return u"select '1' from compactdiscs where cdtitels_id <> "_s + QString::number(title) +
           u" and track_id = "_s + QString::number(track);
}

QString valuesOfTrack(qint64 track, const QString &genre, const QString &year)
{
    return u"Update Tracks set genre="_s + genre + u", hitjaar="_s + year + u" where id = "_s +
           QString::number(track);
}

ADODB::Recordset select(const QString &statement)
{
    return gConnection->Execute(statement);
}

// The first column where there is exactly one row.
std::optional<qint64> onlyId(const QString &statement)
{
    auto rows = select(statement);
    return rows.RecordCount() == 1 ? std::optional(rows.Fields(0).Value().toLong()) : std::nullopt;
}

QString orNoValue(const QString &text)
{
    return text.trimmed().isEmpty() ? noValue : text;
}

QString textOf(ADODB::Recordset &rows, QStringView name)
{
    return rows.Fields(name).Value().toText();
}

std::string utf8(const QString &text)
{
    return text.toStdString();
}

// The text of a value of a row as a statement would have it.
QString storedText(ADODB::Recordset &rows, QStringView name)
{
    const ADODB::Value value = rows.Fields(name).Value();
    return value.isNull() ? noValue : value.toText();
}

std::string trimmedUtf8(const QString &text)
{
    return text.trimmed().isEmpty() ? std::string() : text.toStdString();
}

qint64 makeTitle(Songs &songs, const DiscToImport &disc, std::optional<qint64> artist)
{
    const qint64 id = nextId(Table::CDTitels);
    const std::string title = utf8(disc.title), genre = trimmedUtf8(disc.genre),
                      year = trimmedUtf8(disc.year);
    songs.makeTitle({id, title, artist, textOrNull(genre), wholeOrNull(year)});
    return id;
}

template <typename Import> bool told(Import import)
{
    try {
        return import();
    } catch (const Error &error) {
        errorBox(QString::number(error.Number) + u'-' + error.Description, GetMessage("MsgSysErr"));
        return false;
    }
}

} // namespace

DiscImport::Track::Track(ADODB::Recordset &rows, bool withArtist)
    : number(textOf(rows, u"Nr")),
      artist(withArtist ? textOf(rows, u"Artiest") : QString()),
      title(textOf(rows, u"Titel")),
      genre(orNoValue(textOf(rows, u"Genre"))),
      year(orNoValue(textOf(rows, u"Hitjaar")))
{
    if (artist.trimmed().isEmpty())
        artist = u"?"_s;
    if (title.trimmed().isEmpty())
        title = u"?"_s;
}

bool DiscImport::ImportCompilation()
{
    return told([this] { return importCompilation(); });
}

bool DiscImport::ImportAlbum()
{
    return told([this] { return importAlbum(); });
}

bool DiscImport::isLaterDisc() const
{
    return mDisc.numberInSet.toDouble() > 1;
}

bool DiscImport::importCompilation()
{
    std::optional<qint64> title;
    if (isLaterDisc()) {
        title = compilationOfSet();
        if (!title || !isNextDisc(*title))
            return false;
    } else if (!mayDouble(compilationsWithTitle(mDisc.title), "QuestImportSameCompTitle")) {
        return false;
    }
    ADODB::Transaction transaction(*gConnection);
    Songs songs(*gConnection);
    if (!title)
        title = makeTitle(songs, mDisc, {});
    if (!writeTracks(songs, *title, {})) {
        transaction.RollbackTrans();
        return false;
    }
    transaction.CommitTrans();
    return true;
}

bool DiscImport::importAlbum()
{
    std::optional<qint64> title;
    if (isLaterDisc()) {
        title = albumOfSet();
        if (!title || !isNextDisc(*title))
            return false;
    }
    ADODB::Transaction transaction(*gConnection);
    Songs songs(*gConnection);
    const qint64 artist = songs.findOrMakeArtist(utf8(mDisc.artist));
    if (!title) {
        if (!mayDouble(albumsWithTitle(artist, mDisc.title), "QuestImportSameAlbum")) {
            transaction.RollbackTrans(); // a new artist goes too
            return false;
        }
        title = makeTitle(songs, mDisc, artist);
    }
    if (!writeTracks(songs, *title, artist)) {
        transaction.RollbackTrans();
        return false;
    }
    transaction.CommitTrans();
    return true;
}

// The title that a later disc of a compilation belongs to, after telling why there is none.
std::optional<qint64> DiscImport::compilationOfSet() const
{
    auto count = select(u"select count(*) as aantal from cdtitels where cd_type='V'"_s);
    if (count.Fields(u"Aantal").Value().toLong() == 0) {
        errorBox(GetMessage("MsgCDTypeNotInDatabase"));
        return {};
    }
    const auto only = onlyId(compilationOfTitle(mDisc.title));
    return only ? only : chooseTitle(u"V"_s);
}

std::optional<qint64> DiscImport::albumOfSet() const
{
    const auto artist = onlyId(artistsOfName(mDisc.artist));
    if (!artist) {
        errorBox(GetMessage("MsgFirstCD"));
        return {};
    }
    const auto only = onlyId(albumOfTitle(*artist, mDisc.title));
    return only ? only : chooseTitle(u"E"_s);
}

std::optional<qint64> DiscImport::chooseTitle(const QString &type) const
{
    frmWhatCD &question = defaultInstance<frmWhatCD>();
    question.SearchKey = mDisc.title;
    question.CDType = type;
    question.CD_ID = 0;
    question.ShowModal();
    return question.CD_ID == 0 ? std::nullopt : std::optional(question.CD_ID);
}

// By design: both comparisons are of texts, so the third disc of twelve is refused.
bool DiscImport::isNextDisc(qint64 title) const
{
    auto rows = select(nextDiscOf(title));
    const QString next = rows.Fields(u"volgnr").Value().toText();
    if (next > mDisc.totalInSet) {
        errorBox(GetMessage("MsgTotalInSetAlreadyInDatabase"));
        return false;
    }
    if (next != mDisc.numberInSet) {
        errorBox(GetMessage("MsgWrongDiscNumberPart1") + next +
                 GetMessage("MsgWrongDiscNumberPart2"));
        return false;
    }
    return true;
}

bool DiscImport::mayDouble(const QString &statement, const char *question) const
{
    return select(statement).isEOF() || askYesNo(GetMessage(question)) == vbYes;
}

// Without an artist each track has its own.
bool DiscImport::writeTracks(Songs &songs, qint64 title, std::optional<qint64> artist)
{
    ADODB::Recordset &rows = *mDisc.tracks;
    if (rows.RecordCount() == 0) {
        errorBox(GetMessage("MsgNoTracks"));
        return false;
    }
    const qint64 disc = ADODB::Value(mDisc.numberInSet).toLong();
    for (rows.MoveFirst(); !rows.isEOF(); rows.MoveNext()) {
        Track track(rows, !artist);
        track.shownArtist = artist ? quoted(mDisc.artist) : doubled(track.artist);
        const qint64 by = artist ? *artist : songs.findOrMakeArtist(utf8(track.artist));
        const qint64 id = trackOf(songs, track, title, by);
        songs.makeLink({title, disc, ADODB::Value(track.number).toLong(), id});
    }
    return true;
}

qint64 DiscImport::trackOf(Songs &songs, const Track &track, qint64 title, qint64 artist) const
{
    auto known = select(tracksOfTitle(artist, track.title));
    if (known.RecordCount() != 1) {
        const std::string name = utf8(track.title);
        const std::string genre = track.genre == noValue ? std::string() : utf8(track.genre);
        const std::string year = track.year == noValue ? std::string() : utf8(track.year);
        return songs.makeTrack(artist, name, textOrNull(genre), wholeOrNull(year));
    }
    const qint64 id = known.Fields(u"id").Value().toLong();
    if (storedText(known, u"genre") != track.genre || storedText(known, u"hitjaar") != track.year)
        updateTrack(track, title, id);
    return id;
}

// What other discs say of the song is changed only if the user wants it.
void DiscImport::updateTrack(const Track &track, qint64 title, qint64 id) const
{
    const bool isShared = !select(otherDiscsOf(id, title)).isEOF();
    const QString question = GetMessage("QuestUpdateTrackPart1") + track.number +
                             GetMessage("QuestUpdateTrackPart2") + track.shownArtist +
                             GetMessage("QuestUpdateTrackPart3");
    if (isShared && askYesNo(question, u"Wijzigen track"_s) != vbYes)
        return;
    const QString genre = track.genre == noValue ? noValue : quoted(track.genre);
    const QString year =
        track.year == noValue ? noValue : QString::number(ADODB::Value(track.year).toLong());
    select(valuesOfTrack(id, genre, year));
}
