#pragma once

#include "discdata/lookup.h"
#include "discdata/rippedfiles.h"
#include "tags/filenameparts.h"

struct TrackOfFileId;

/// Asks the services which disc an MP3 file is from, until something is found: the disc that all
/// MP3 files of its folder make, by their playing times, in the order of their names and in that of
/// the numbers in their tags; then the words of its tags, and of its name. A file that lies alone
/// is asked for by its words first: a playing time alone fits too many discs.
class FileLookup
{
public:
    /// Either the disc and its track, or what may be it, or nothing.
    struct Found {
        std::optional<DiscRecord> disc; // whole
        int track = 0;                  // of the disc, from 1
        std::vector<DiscRecord> candidates;
        std::optional<QDate> keptOn; // an answer of that day
    };

    FileLookup(Lookup &services, LongWork &work) : mServices(services), mWork(work) {}

    /// Both throw Error as Lookup does, where nothing was found and somebody could not be asked.
    Found byFile(const QString &path);
    Found byId(const TrackOfFileId &id);

private:
    // What the folder says; read in a worker.
    struct Folder {
        QString path;                  // of the file in question
        std::vector<RippedFile> files; // none where they can be no disc
        RippedFile own;
        int count = 0; // of MP3 files
    };
    // What the file says of its track.
    struct Hints {
        QString title;
        int number = 0, length = -1;
    };

    static Folder readFolder(const QString &path, const std::stop_token &stop);
    std::optional<Found> byTable(std::vector<RippedFile> files);
    std::optional<Found> byTables();
    std::optional<Found> byWords();
    std::optional<Found> bySearch(const SearchWords &words, const Hints &hints);
    Found decided(Lookup::Found found, const std::function<int(const DiscRecord &disc)> &trackIn);
    std::optional<Lookup::Found> ask(const std::function<Lookup::Found()> &ask);
    static int trackIn(const DiscRecord &disc, const Hints &hints);

    Lookup &mServices;
    LongWork &mWork;
    Folder mFolder;
    std::optional<Error> mFailure; // the first
};
