#pragma once

#include "catalogue/ids.h"
#include "platform/ado/command.h"

#include <array>
#include <optional>
#include <string>
#include <unordered_map>

/// Artists, tracks, titles and links of the catalogue, found or made: the one way in which every
/// screen does it. Exactly one row that fits is used, in any other case a new one is made. For one
/// routine, within its transaction: it hands out the next ids of each table, and remembers the
/// artists found, until it sees that someone else has written over the connection. Texts are UTF-8.
/// All functions throw Error.
class Songs
{
public:
    explicit Songs(ADODB::Connection &connection);

    qint64 findOrMakeArtist(std::string_view name);

    /// By title; nothing unless there is exactly one.
    std::optional<qint64> findTrack(qint64 artist, std::string_view title);
    qint64 makeTrack(qint64 artist, std::string_view title, ADODB::Parameter genre,
                     ADODB::Parameter year);

    /// A title: an album of its artist, or, without one, a compilation.
    struct Title {
        qint64 id;
        std::string_view name;
        std::optional<qint64> artist = {};
        ADODB::Parameter genre = nullptr, year = nullptr;
    };
    void makeTitle(const Title &title);

    /// The place of a track on a disc of a title.
    struct Link {
        qint64 title, disc, trackNo, track;
    };
    void makeLink(qint64 id, const Link &link);
    qint64 makeLink(const Link &link);

private:
    void noticeOthers();
    qint64 next(Table table);
    void insert(ADODB::Command &command, std::initializer_list<ADODB::Parameter> values);

    ADODB::Connection &mConnection;
    ADODB::Command mFindArtist, mAddArtist, mFindTrack, mAddTrack, mAddTitle, mAddLink;

    struct Hash : std::hash<std::string_view> {
        using is_transparent = void;
    };
    std::unordered_map<std::string, qint64, Hash, std::equal_to<>> mArtists;
    std::array<qint64, 4> mNext{}; // by Table, 0: not known
    qint64 mChanges;               // of the connection, as far as they are known here
};
