#include "discs/candidates.h"
#include "discs/cuesheet.h"
#include "discs/tocsheet.h"
#include "fuzz/fuzz.h"

namespace
{

using Reader = std::optional<DiscSheet> (*)(QByteArrayView, const LengthOfFile &);

// What a sheet gives is a table that a disc can have, with as many tracks as it has names for; or
// the name of a file that is missing.
void runReader(Reader read, const QByteArray &input)
{
    const LengthOfFile lengthOf = [](const QString &name, LengthIn unit) {
        const qint64 length = unit == LengthIn::Bytes ? 1000 * 2352 : 1000;
        return name.size() % 8 == 7 ? std::nullopt : std::optional(length);
    };
    const auto sheet = read(input, lengthOf);
    if (!sheet)
        return;
    const std::size_t tracks = sheet->toc.tracks.size();
    fuzz::must(sheet->toc.isValid() || !sheet->missing.isEmpty(), "a table that no disc has");
    fuzz::must(tracks == 0 || tracks == sheet->known.tracks.size(), "tracks without a record");
    for (const TrackRecord &track : sheet->known.tracks)
        fuzz::must(track.title == cleanText(track.title), "a title with control signs");
}

fuzz::Target cue(
    "cue sheet",
    [] {
        return fuzz::Inputs{
            "REM DATE 1999\r\nTITLE \"A \"B\" C\"\r\nFILE \"a.bin\" BINARY\r\nTRACK 01 AUDIO\r\n"
            "INDEX 00 00:00:00\r\nINDEX 01 00:02:00\r\nTRACK 02 MODE1/2048\r\nINDEX 01 00:04:00\r\n",
            "FILE a.wav WAVE\nTRACK 1 AUDIO\nPERFORMER X\nPREGAP 0:2:0\nINDEX 01 0:0:0\nREM SESSION 2"
            "\nFILE b.wav WAVE\nTRACK 2 AUDIO\nINDEX 01 0:0:0\nPOSTGAP 0:1:0\n"};
    },
    [](const QByteArray &input) { runReader(readCueSheet, input); });

fuzz::Target toc(
    "text of cdrdao",
    [] {
        return fuzz::Inputs{
            "CD_DA CATALOG \"0724384260958\"\nCD_TEXT { LANGUAGE_MAP { 0 : EN }\nLANGUAGE 0 { TITLE "
            "\"Caf\\351\" SIZE_INFO { 1, 2 } } }\n// Track 1\nTRACK AUDIO\nPREGAP 00:02:00\n"
            "FILE \"a.bin\" 0 00:04:00\nTRACK AUDIO\nFILE \"a.wav\" 588 0\nSTART 00:01:00\n",
            "CD_ROM\nTRACK MODE1\nZERO MODE1 0:2:0 START DATAFILE \"a.iso\" #2048\n"
            "TRACK AUDIO SILENCE 75 AUDIOFILE \"b.bin\" SWAP 0\n"};
    },
    [](const QByteArray &input) { runReader(readTocSheet, input); });

} // namespace
