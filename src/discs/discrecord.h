#pragma once

#include <QDate>
#include <QString>
#include <QStringList>
#include <vector>

/// A name as printed and, of a person, in its parts; the parts are empty for groups and where a
/// service does not tell them.
struct ArtistName {
    QString name;
    QString first, last;
    bool operator==(const ArtistName &) const = default;
};

struct TrackRecord {
    QString title;
    ArtistName artist; // of an album the disc's where the track has none of its own
    QString year;      // four digits or empty
    QString genre;     // name or empty
    QString notes;
    int length = -1; // milliseconds; -1 unknown
    bool operator==(const TrackRecord &) const = default;
};

/// What is known of a disc: a record of a service, one of its candidates (whose tracks may still be
/// missing), or what the user has typed. Texts hold no control signs.
struct DiscRecord {
    QString title;
    ArtistName artist;
    QString year; // four digits or empty
    QString genre;
    QString numberInSet = QStringLiteral("1"), totalInSet = QStringLiteral("1");
    bool isCompilation = false;
    std::vector<TrackRecord> tracks;
    QString notes;

    // What else a list of candidates shows.
    QString label, country, barcode;
    int trackCount = 0;

    // Where it comes from: the service's name, and what it finds the whole record by. Both keys are
    // empty where the record is whole.
    QString service;
    QString keyA; // category, or release
    QString keyB; // disc id, or number of the medium

    // The same two of a record that is whole, by which it can be had again; empty where there is
    // no way back to it.
    QString fromA, fromB;

    // The track that was asked for by its words or its id, from 1; 0 where the whole disc was.
    int soughtTrack = 0;

    // Of a record of a CDDB server, for sending it back.
    QString category;
    QStringList discIds;
    int revision = -1; // -1: not known there

    bool isWhole() const { return keyA.isEmpty() && keyB.isEmpty(); }
    bool operator==(const DiscRecord &) const = default;
};

/// Words that a search goes by; those that are empty do not count. With the title of a track it is
/// that track which is searched, on any disc.
struct SearchWords {
    QString artist, title, barcode;
    QString track = {};
    bool isEmpty() const
    {
        return artist.isEmpty() && title.isEmpty() && barcode.isEmpty() && track.isEmpty();
    }
    bool operator==(const SearchWords &) const = default;
};
