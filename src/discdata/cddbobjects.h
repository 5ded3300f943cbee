#pragma once

#include "discs/discrecord.h"
#include "discs/genretable.h"

#include <memory>
#include <variant>

// What CDDBControl hands out. All strings; a number is its decimal text.

/// The name of an artist in its parts; both empty for a group.
class CddbFullName
{
public:
    explicit CddbFullName(const ArtistName &name) : mName(name) {}
    QString FirstName() const { return mName.first; }
    QString LastName() const { return mName.last; }

private:
    ArtistName mName;
};

class CddbTrack
{
public:
    CddbTrack(const TrackRecord &track, QString genreId)
        : mTrack(track), mGenreId(std::move(genreId))
    {
    }
    QString Title() const { return mTrack.title; }
    QString Artist() const { return mTrack.artist.name; }
    QString Year() const { return mTrack.year; }
    QString GenreId() const { return mGenreId; }
    CddbFullName FullName() const { return CddbFullName(mTrack.artist); }

private:
    TrackRecord mTrack;
    QString mGenreId;
};

/// In the order of the disc.
class CddbTracks : public std::vector<CddbTrack>
{
public:
    int Count() const { return int(size()); }
    const CddbTrack &Item(int position) const { return at(size_t(position - 1)); } // from 1
};

/// A disc: the record of a service, one of its candidates, or one that the user has typed. It is
/// shared: the control's editor changes it in place.
class CddbDisc
{
public:
    CddbDisc(DiscRecord disc, std::shared_ptr<GenreTable> genres)
        : record(std::move(disc)), mGenres(std::move(genres))
    {
    }
    QString Title() const { return record.title; }
    QString Artist() const { return record.artist.name; }
    QString Year() const { return record.year; }
    int TrackCount() const { return int(record.tracks.size()); }
    QString DiscKeyB() const { return record.keyB; }
    QString DiscKeyA() const { return record.keyA; }
    QString GenreId() const { return mGenres->idOf(record.genre); }
    QString TotalInSet() const { return record.totalInSet; }
    QString NumberInSet() const { return record.numberInSet; }
    CddbTracks Tracks() const;
    CddbFullName FullName() const { return CddbFullName(record.artist); }
    int IsCompilation() const { return record.isCompilation ? 1 : 0; }

    DiscRecord record;  // the control's own
    QString toc;        // that it was looked up by
    bool isNew = false; // no service knows it

private:
    std::shared_ptr<GenreTable> mGenres;
};
using CddbDiscPtr = std::shared_ptr<CddbDisc>;

class CddbGenreList
{
public:
    explicit CddbGenreList(std::shared_ptr<GenreTable> genres) : mGenres(std::move(genres)) {}
    QString GetGenreName(const QString &genreId) const { return mGenres->nameOf(genreId); }

private:
    std::shared_ptr<GenreTable> mGenres;
};
using CddbGenreListPtr = std::shared_ptr<CddbGenreList>;

/// Candidates, only passed back to the control.
struct CddbMatchList {
    std::vector<DiscRecord> candidates;
    QString toc;
};
using CddbMatchListPtr = std::shared_ptr<CddbMatchList>;

/// One disc, several candidates, or nothing.
using CddbMatch = std::variant<std::monostate, CddbDiscPtr, CddbMatchListPtr>;

struct CddbOptions {
    QString ClientLanguage;
    QString ProxyServer;
    int ProxyServerPortNumber = 0;
    QString ProxyUserName;
    QString ProxyPassword;
    int ExtraOption = 0;
};
