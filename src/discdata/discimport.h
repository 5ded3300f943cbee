#pragma once

#include "platform/ado/recordset.h"

#include <optional>

/// A disc on its way into the catalogue: the fields as they stand on the screen, the part of the
/// set as the disc says it, and the rows "Nr", "Artiest" (of a compilation alone), "Titel",
/// "Genre", "Hitjaar".
struct DiscToImport {
    QString artist, title, genre, year;
    QString numberInSet, totalInSet;
    ADODB::RecordsetPtr tracks;
};

/// Writes a disc into the catalogue over gConnection, in one transaction, as a compilation or as an
/// album; a disc above number 1 joins the title of its set. What is missing becomes "?". Questions,
/// refusals and errors are told here; the result is true when the disc stands in the catalogue.
///
/// By design: an error leaves the transaction open. It is rolled back before anything else is
/// written.
class DiscImport
{
public:
    explicit DiscImport(DiscToImport disc) : mDisc(std::move(disc)) {}

    bool ImportCompilation();
    bool ImportAlbum();

private:
    struct Track;
    bool importCompilation();
    bool importAlbum();
    bool isLaterDisc() const;
    std::optional<qint64> compilationOfSet() const;
    std::optional<qint64> albumOfSet() const;
    std::optional<qint64> chooseTitle(const QString &type) const;
    bool isNextDisc(qint64 title) const;
    bool mayDouble(const QString &statement, const char *question) const;
    bool writeTracks(class Songs &songs, qint64 title, std::optional<qint64> artist);
    qint64 trackOf(Songs &songs, const Track &track, qint64 title, qint64 artist) const;
    void updateTrack(const Track &track, qint64 title, qint64 id) const;

    const DiscToImport mDisc;
};
