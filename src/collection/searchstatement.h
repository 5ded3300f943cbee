#pragma once

#include <QString>

/// What a search looks for; empty texts ask for nothing.
struct SearchKey {
    enum Mode { FullWord, PartWord, BeginWord, EndWord }; // of artist, title and genre alike

    Mode mode = PartWord;
    QString artist, title, genre;
    QString firstYear, lastYear; // as isSearchYear() takes them
};

/// Whether a text is a year that can be searched: 4 characters, numeric in the loose way ("1e10"
/// passes), from 1900 on, which is one year more than the editors take.
bool isSearchYear(const QString &text);

/// The select statement of a search. Its rows are the tracks of the discs, ordered by artist,
/// title, title of the CD, disc and track: artiest, titel, disk, track, verzamelcd, genre, hitjaar,
/// type.
/// "%" and "_" in the texts are wild.
QString searchStatement(const SearchKey &key);
