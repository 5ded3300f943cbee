#include "discs/candidates.h"
#include "discs/cddbanswer.h"
#include "discs/discid.h"
#include "discs/musicbrainzanswer.h"
#include "discs/recordjson.h"
#include "discs/xmcd.h"
#include "fuzz/fuzz.h"
#include "platform/error/error.h"

namespace
{

constexpr std::size_t mostTracks = 99;

// Three tracks of 4, 6 and 8 seconds.
const TableOfContents toc{{{150}, {450}, {900}}, 1, 1500};

bool isClean(const QString &text)
{
    return text == cleanText(text);
}

bool isYear(const QString &text)
{
    return text.isEmpty() || yearOf(text) == text;
}

bool isWholeNumber(const QString &text)
{
    return text.toInt() > 0 && QString::number(text.toInt()) == text;
}

// What the screens, the catalogue and the kept answers rely on.
void mustBeInOrder(const DiscRecord &disc)
{
    fuzz::must(isClean(disc.title) && isClean(disc.artist.name) && isClean(disc.notes),
               "a text with control signs");
    fuzz::must(isYear(disc.year), "a year of other than four digits");
    fuzz::must(isWholeNumber(disc.numberInSet) && isWholeNumber(disc.totalInSet) &&
                   disc.numberInSet.toInt() <= disc.totalInSet.toInt(),
               "a number above that of the set");
    fuzz::must(disc.tracks.size() <= mostTracks && disc.trackCount >= 0, "more than 99 tracks");
    for (const TrackRecord &track : disc.tracks) {
        fuzz::must(isClean(track.title) && isClean(track.artist.name),
                   "a title with control signs");
        fuzz::must(isYear(track.year) && track.length >= -1, "a track that no disc has");
    }
}

void mustBeInOrder(const std::vector<DiscRecord> &discs)
{
    for (const DiscRecord &disc : discs)
        mustBeInOrder(disc);
    fuzz::must(recordsFromJson(toJson(discs)) == std::optional(discs), "not kept as it is");
}

// A reader may refuse its input, with an error of ours.
template <typename Read> void allowed(const Read &read)
{
    try {
        mustBeInOrder(read());
    } catch (const Error &) {
    }
}

// What is sent is understood again, and the tracks sent again are the same. Not so the title: one
// remark on the set is taken out of it each time.
std::vector<DiscRecord> sentAndRead(const QByteArray &input)
{
    const XmcdRecord record = readXmcd(input);
    TableOfContents table;
    for (const int offset : record.offsets)
        table.tracks.push_back({offset});
    table.leadOut = record.seconds * framesPerSecond;
    if (!table.isValid() || notToBeSent(record.disc, table))
        return {record.disc};
    const DiscRecord again =
        readXmcd(writeXmcd(record.disc, table, QStringLiteral("a"), QStringLiteral("1"))).disc;
    const DiscRecord third =
        readXmcd(writeXmcd(again, table, QStringLiteral("a"), QStringLiteral("1"))).disc;
    fuzz::must(again.tracks == third.tracks, "sent again it differs");
    return {record.disc, again};
}

fuzz::Target xmcd(
    "xmcd record",
    [] {
        return fuzz::Inputs{
            "# xmcd\n# Track frame offsets:\n#\t150\n#\t450\n#\t900\n#\n# Disc length: 20 "
            "seconds\n# Revision: 2\nDISCID=0a001203\nDTITLE=The Band / Caf\xC3\xA9 (Disc 2 of "
            "3)\nDYEAR=1999\nDGENRE=Rock\nTTITLE0=One \\\\ two\\n\nTTITLE1=Th\nTTITLE1=ree\n"
            "TTITLE2=x\nEXTD= YEAR: 1978 ID3G: 17\nEXTT0=\nEXTT1=note\nPLAYORDER=\n",
            "# Track frame offsets:\r\n# 150\r\n# 450\r\n# 900\r\n# Disc length: 20\r\n"
            "DTITLE=Various / CD 2: Caf\xE9\r\nTTITLE0=A / a\r\nTTITLE1=B / b / c\r\n"
            "TTITLE2=C - c\r\n"};
    },
    [](const QByteArray &input) { allowed([&] { return sentAndRead(input); }); });

fuzz::Target cddb(
    "CDDB answer",
    [] {
        return fuzz::Inputs{
            "210 list\r\nrock 0a001203 A / B\r\nfolk 0a001203 A / C (CD 2)\r\n.\r\n",
            "200 rock 0a001203 A / B\r\n", "211 x\n..\nmisc 0a001203 \xE9\n.\n",
            "403 Database entry is corrupt.\r\n"};
    },
    [](const QByteArray &input) {
        allowed([&] {
            const CddbAnswer answer = readCddbAnswer(input);
            fuzz::must(answer.code >= 0 && answer.code <= 999, "a code of four digits");
            fuzz::must(!answer.isRefusal() || !answer.isTrouble(), "both a refusal and trouble");
            return cddbCandidates(answer);
        });
    });

const char release[] =
    R"({"id":"r","title":"T","date":"1984-05","country":"XE","barcode":null,"artist-credit":[)"
    R"({"name":"A B","joinphrase":"","artist":{"type":"Person","name":"A B","sort-name":"B, A"}}],)"
    R"("release-group":{"first-release-date":"1977","genres":[{"name":"pop","count":2}]},)"
    R"("media":[{"position":2,"title":"x","track-count":3,"discs":[{"id":"it","sectors":1500,)"
    R"("offsets":[150,450,900]}],"tracks":[{"title":"a","length":4000},{"title":"b","length":null,)"
    R"("recording":{"video":true,"length":6000}},{"title":"c","length":8000}]}]})";

fuzz::Target musicBrainz(
    "MusicBrainz answer",
    [] {
        const QByteArray releases = QByteArray(R"({"releases":[)") + release + "]}";
        return fuzz::Inputs{
            releases, QByteArray(releases).replace("{\"releases\"", "{\"id\":\"it\",\"releases\""),
            release, R"({"title":"T","artist":"A","tracks":[{"title":"a","length":5}]})"};
    },
    [](const QByteArray &input) {
        const auto [first, second] = fuzz::halves(input);
        fuzz::must(musicBrainzPage(input).listed >= 0, "fewer than none");
        allowed([&] { return musicBrainzDiscs({input}, toc); });
        allowed([&, a = first, b = second] { return musicBrainzDiscs({a, b}, toc); });
        allowed([&] { return musicBrainzSearch(input); });
        allowed([&] { return musicBrainzRecordings(input); });
        allowed([&] { return std::vector{musicBrainzRelease(input, 2)}; });
    });

fuzz::Target kept(
    "kept records",
    [] {
        DiscRecord disc;
        disc.title = QStringLiteral("T");
        disc.tracks.resize(2);
        disc.discIds = QStringList{QStringLiteral("0a001203")};
        return fuzz::Inputs{toJson({disc, {}}), toJson({})};
    },
    [](const QByteArray &input) {
        if (const auto records = recordsFromJson(input))
            fuzz::must(recordsFromJson(toJson(*records)) == records, "not kept as it is");
    });

} // namespace
