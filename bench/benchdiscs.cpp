#include "cases.h"
#include "discs/musicbrainzanswer.h"
#include "discs/xmcd.h"
#include "names.h"

namespace
{

constexpr int answers = 1000; // in 0.5 s
constexpr int tracks = 14, releases = 3;

QByteArray title(Names &names)
{
    return QByteArray::fromStdString(names.title()).replace('"', '\'').replace('\\', '/');
}

TableOfContents toc()
{
    TableOfContents toc;
    for (int i = 0; i < tracks; ++i)
        toc.tracks.push_back({150 + i * 18'000});
    toc.leadOut = 150 + tracks * 18'000;
    return toc;
}

QByteArray xmcdRecord(Names &names)
{
    DiscRecord disc;
    disc.title = QString::fromUtf8(title(names));
    disc.artist.name = QString::fromUtf8(title(names));
    disc.year = QStringLiteral("1999");
    disc.genre = QStringLiteral("Rock");
    disc.notes = QStringLiteral("YEAR: 1999 ID3G: 17");
    for (int i = 0; i < tracks; ++i)
        disc.tracks.emplace_back().title = QString::fromUtf8(title(names));
    return writeXmcd(disc, toc(), QStringLiteral("Bench"), QStringLiteral("1"));
}

QByteArray track(Names &names)
{
    const QByteArray name = title(names), artist = title(names);
    const QByteArray credit = R"("artist-credit":[{"name":")" + artist +
                              R"(","joinphrase":"","artist":{"type":"Group","sort-name":")" +
                              artist + R"("}}])";
    return R"({"id":"5e6d2b0c-0f0c-4a0e-9d55-0c8b6a1d3f11","number":"1","length":240000,"title":")" +
           name + R"(","recording":{"video":false,"title":")" + name +
           R"(","length":240000,"first-release-date":"1999-05-17",)" + credit + "}," + credit + '}';
}

QByteArray release(Names &names)
{
    QByteArrayList all;
    for (int i = 0; i < tracks; ++i)
        all << track(names);
    return R"({"id":"0b1c2d3e","title":")" + title(names) +
           R"(","date":"1999-05-17","country":"XE","genres":[{"name":"rock","count":3}],)"
           R"("artist-credit":[{"name":"A"}],"media":[{"position":1,"track-count":14,)"
           R"("discs":[{"id":"it"}],"tracks":[)" +
           all.join(',') + "]}]}";
}

QByteArray lookUp(Names &names)
{
    QByteArrayList all;
    for (int i = 0; i < releases; ++i)
        all << release(names);
    return R"({"id":"it","releases":[)" + all.join(',') + "]}";
}

template <typename Read>
void readAll(benchmark::State &state, QByteArray (*make)(Names &), const Read &read)
{
    Names names(4);
    std::vector<QByteArray> all;
    for (int i = 0; i < answers; ++i)
        all.push_back(make(names));
    for (auto _ : state) {
        for (const QByteArray &bytes : all)
            benchmark::DoNotOptimize(read(bytes));
    }
    state.SetItemsProcessed(state.iterations() * answers);
    state.SetBytesProcessed(state.iterations() * answers * all.front().size());
}

void readRecords(benchmark::State &state)
{
    readAll(state, xmcdRecord, readXmcd);
}

void readLookUps(benchmark::State &state)
{
    readAll(state, lookUp, [](const QByteArray &json) { return musicBrainzDiscs({json}, toc()); });
}

} // namespace

void registerDiscCases()
{
    benchmark::RegisterBenchmark("read/1000 xmcd records", readRecords)
        ->Unit(benchmark::kMillisecond);
    benchmark::RegisterBenchmark("read/1000 MusicBrainz answers", readLookUps)
        ->Unit(benchmark::kMillisecond);
}
