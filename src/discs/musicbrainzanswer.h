#pragma once

#include "discs/discrecord.h"
#include "discs/toc.h"

#include <QByteArrayList>

/// What an answer of the web service in JSON says. All throw Error (errSyntax) where it is none of
/// theirs: cut off, HTML, another shape.

/// The answers to one look-up, page by page: by disc id or, for a disc that is not known there, by
/// the lengths of its tracks (the nearest of all pages first, those too far off left out). Whole
/// where tracks are listed.
std::vector<DiscRecord> musicBrainzDiscs(const QByteArrayList &pages, const TableOfContents &toc);

/// What a page of a look-up lists, whether it is of use or not: the next one goes on behind it.
struct MusicBrainzPage {
    int listed = 0; // releases; 0 in what is no such page
    int all = -1;   // of all pages; -1 where the answer does not tell
    QString first;  // id of the first release
};
MusicBrainzPage musicBrainzPage(const QByteArray &json);

/// One medium of a release; the numbers are those of the set, from 1.
DiscRecord musicBrainzRelease(const QByteArray &json, int medium);

/// The hits of a search for releases: candidates with both keys, release and medium. One of several
/// media gives a candidate for each.
std::vector<DiscRecord> musicBrainzSearch(const QByteArray &json);

/// The discs that hold a recording, which is asked for by words or by its id: candidates with both
/// keys and the track that was sought.
std::vector<DiscRecord> musicBrainzRecordings(const QByteArray &json);

/// The text of an "error" answer; empty if there is none.
QString musicBrainzError(const QByteArray &json);

/// The search text for these words, of releases or, with a track among them, of recordings: its
/// special signs escaped; not yet encoded for an address.
QString musicBrainzQuery(const SearchWords &words);
