#include "cases.h"
#include "collection/frmCDList.h"
#include "collection/frmCDRoot.h"
#include "collection/recordtree.h"
#include "controls/tracks/trackcompletion.h"
#include "controls/tracks/trackrow.h"
#include "controls/tracks/trackstore.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "shell/startup.h"

#include <QApplication>

using namespace Qt::StringLiterals;

namespace
{

const auto sizeOfDiscs =
    u"select cdt.id as ID, count(*) as N from CDTitels cdt, CompactDiscs cds where cdt.cd_type='V'"
    " and cds.CDTitels_ID=cdt.id and cds.DiskNo=1 and cdt.id < 5000 group by cdt.id having "
    "count(*)=20"_s;

void openCopy(const benchdata::Scale &scale)
{
    const std::string copy = benchdata::scratchCopy(benchdata::catalogue(scale));
    startup::openCatalogue(QString::fromStdString(copy), false);
}

// A compilation whose first disc has 20 tracks.
qint64 aDisc()
{
    ADODB::Recordset titles;
    titles.Open(sizeOfDiscs, *gConnection);
    return titles.Fields(u"ID").Value().toLong();
}

void openEditor(benchmark::State &state, const benchdata::Scale &scale)
{
    openCopy(scale);
    const qint64 disc = aDisc();
    for (auto _ : state) {
        auto *editor = new frmCDRoot;
        editor->Mode = u"U"_s;
        editor->CdId = disc;
        editor->Show();
        QApplication::processEvents();
        state.PauseTiming();
        editor->Unload();
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        state.ResumeTiming();
    }
    gConnection.reset();
}

// One track of the disc gets another title, up to the commit; the wait for the disk is left out.
void saveDisc(benchmark::State &state, const benchdata::Scale &scale)
{
    openCopy(scale);
    gConnection->housekeeping("PRAGMA synchronous=OFF");
    TrackStore store(*gConnection, aDisc(), 1, TrackStore::Artists::OfTracks);
    int round = 0;
    for (auto _ : state) {
        const auto stored = store.load();
        QList<TrackToSave> tracks;
        QList<qint64> links;
        for (const StoredTrack &track : stored) {
            tracks.append({track.linkId, false, track.texts, track.texts});
            links.append(track.linkId);
        }
        tracks[3].texts[TitleField] = u"Another title "_s + QString::number(++round);
        tracks[3].changed = true;
        ADODB::Transaction transaction(*gConnection);
        store.save(tracks, links);
        transaction.CommitTrans();
    }
    gConnection.reset();
}

void completeArtist(benchmark::State &state, const benchdata::Scale &scale)
{
    openCopy(scale);
    for (auto _ : state) {
        for (const QString &typed : {u"m"_s, u"ma"_s, u"de "_s})
            benchmark::DoNotOptimize(trackcompletion::artists(*gConnection, typed));
    }
    state.SetItemsProcessed(state.iterations() * 3);
    gConnection.reset();
}

void openLetter(benchmark::State &state, const benchdata::Scale &scale)
{
    openCopy(scale);
    auto *browser = new frmCDList;
    browser->Show();
    auto *tree = browser->findChild<RecordTree *>(u"Platenbak"_s);
    int artists = 0;
    for (auto _ : state) {
        browser->FillArtistNode(*tree, u"D"_s);
        artists = tree->node(u"D"_s)->childCount() - 1; // the placeholder
        state.PauseTiming();
        tree->resetRoots();
        state.ResumeTiming();
    }
    state.counters["artists"] = artists;
    browser->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    gConnection.reset();
}

} // namespace

void registerEditCases()
{
    const std::pair<const char *, void (*)(benchmark::State &, const benchdata::Scale &)> cases[] =
        {{"open an editor", openEditor},
         {"save a changed disc", saveDisc},
         {"complete an artist, three keys", completeArtist},
         {"open a letter of the tree", openLetter}};
    for (const auto &scale : benchdata::scales()) {
        for (const auto &[name, run] : cases)
            benchmark::RegisterBenchmark(caseName(name, scale).c_str(), run, scale)
                ->Unit(benchmark::kMillisecond);
    }
}
