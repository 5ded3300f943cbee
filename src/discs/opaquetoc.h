#pragma once

#include "discs/discrecord.h"
#include "discs/toc.h"

/// What was found where a disc was looked for, as one text that goes from the drive to the look-up
/// and is nobody else's to read: a table of contents, what a sheet beside it says of the disc, or
/// the words to search by.
struct OpaqueToc {
    TableOfContents toc; // no tracks where there are only words
    DiscRecord known;    // titles and names of a cue sheet or of tags; mostly empty
    SearchWords words;

    /// One line of text; read again it gives the same value.
    QString toText() const;

    /// Nothing from a text that is none of these, or whose table no disc can have.
    static std::optional<OpaqueToc> fromText(const QString &text);
};
