#pragma once

#include "discs/discrecord.h"
#include "discs/toc.h"

#include <QByteArray>

/// A record in the xmcd form: comments with offsets, length, revision; lines KEY=text.
struct XmcdRecord {
    DiscRecord disc; // revision, discIds, tracks with notes; compilation, part of set found out
    std::vector<int> offsets; // empty where they do not rise
    int seconds = 0;
};

/// Reads a record, in UTF-8 or, where it is none, in Windows-1252; LF or CR LF. Lines that are not
/// understood are passed over; control signs are taken out of the texts.
/// Throws Error (errSyntax) where it has no DTITLE and no title of a track, and above 99 tracks.
XmcdRecord readXmcd(const QByteArray &bytes);

/// The record as it is sent: UTF-8, LF, lines of at most 256 bytes with their end, every key, in
/// the order of the protocol. `revision` is what stands in it as it is.
QByteArray writeXmcd(const DiscRecord &disc, const TableOfContents &toc, const QString &client,
                     const QString &version);

/// Why a record is not to be sent, as a key of the message table; nullptr if it may be: no artist
/// or title, tracks mostly untitled or "Track 1", "Track 2", another number of tracks than the
/// disc.
const char *notToBeSent(const DiscRecord &disc, const TableOfContents &toc);
