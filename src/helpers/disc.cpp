#include "helpers/disc.h"

#include <algorithm>
#include <cdio/cdio.h>
#include <cdio/cdtext.h>
#include <cdio/logging.h>
#include <cstdio>
#include <memory>

namespace disc
{

namespace
{

constexpr int firstFrame = 150;
constexpr int mostTracks = 99;

struct Close {
    void operator()(CdIo_t *disc) const { cdio_destroy(disc); }
};
using Disc = std::unique_ptr<CdIo_t, Close>;

struct Range {
    track_t first = 0;
    int count = 0;
    track_t last() const { return track_t(first + count - 1); }
};

Range tracksOf(const CdIo_t *disc)
{
    return {cdio_get_first_track_num(disc), cdio_get_num_tracks(disc)};
}

bool isPossible(const Range &tracks)
{
    return tracks.first != CDIO_INVALID_TRACK && tracks.first >= 1 && tracks.count >= 1 &&
           tracks.first + tracks.count - 1 <= mostTracks;
}

bool printTable(const CdIo_t *disc, const Range &tracks)
{
    for (track_t track = tracks.first; track <= tracks.last(); ++track) {
        const lsn_t start = cdio_get_track_lsn(disc, track);
        if (start == CDIO_INVALID_LSN)
            return false;
        const bool sound = cdio_get_track_format(disc, track) == TRACK_FORMAT_AUDIO;
        std::printf("track %d %d %s\n", int(track), int(start) + firstFrame,
                    sound ? "audio" : "data");
    }
    const lsn_t end = cdio_get_track_lsn(disc, CDIO_CDROM_LEADOUT_TRACK);
    if (end == CDIO_INVALID_LSN)
        return false;
    std::printf("leadout %d\nend\n", int(end) + firstFrame);
    std::fflush(stdout); // whatever becomes of the rest
    return true;
}

void printText(const cdtext_t *text, cdtext_field_t field, const char *name, track_t track)
{
    const char *value = cdtext_get_const(text, field, track);
    if (!value || !*value)
        return;
    std::string line = value;
    std::replace_if(
        line.begin(), line.end(), [](unsigned char c) { return c < ' '; }, ' ');
    std::printf("text %d %s %s\n", int(track), name, line.c_str());
}

void printTexts(CdIo_t *disc, const Range &tracks)
{
    const cdtext_t *text = cdio_get_cdtext(disc);
    if (!text)
        return;
    printText(text, CDTEXT_FIELD_TITLE, "title", 0);
    printText(text, CDTEXT_FIELD_PERFORMER, "performer", 0);
    printText(text, CDTEXT_FIELD_GENRE, "genre", 0);
    printText(text, CDTEXT_FIELD_UPC_EAN, "barcode", 0);
    for (track_t track = tracks.first; track <= tracks.last(); ++track) {
        printText(text, CDTEXT_FIELD_TITLE, "title", track);
        printText(text, CDTEXT_FIELD_PERFORMER, "performer", track);
    }
}

Result print(const std::string &name, driver_id_t driver)
{
    const Disc disc(cdio_open(name.c_str(), driver));
    if (!disc)
        return Result::NotOpened;
    const Range tracks = tracksOf(disc.get());
    if (!isPossible(tracks) || !printTable(disc.get(), tracks))
        return Result::NoTable;
    printTexts(disc.get(), tracks);
    return Result::Read;
}

} // namespace

Result printImage(const std::string &file)
{
    return print(file, DRIVER_NRG);
}

Result printDrive(const std::string &device)
{
    return print(device, DRIVER_DEVICE);
}

Result printDrives()
{
    char **drives = cdio_get_devices(DRIVER_DEVICE);
    for (char **drive = drives; drive && *drive; ++drive)
        std::printf("drive %s\n", *drive);
    cdio_free_device_list(drives);
    return Result::Read;
}

} // namespace disc
