#include "catalogue/cleanorphans.h"

#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "shell/services/globals.h"

namespace
{

const auto deleteTracks = QStringLiteral(
    "delete from tracks trk where not exists (select '1' from CompactDiscs where Track_ID=trk.ID)");

const auto deleteTitles = QStringLiteral("delete from CDTitels cdt where not exists "
                                         "(select '1' from CompactDiscs where CDtitels_ID=cdt.ID)");

const auto deleteArtists = QStringLiteral(
    "delete from Artiesten art where not exists (select '1' from Tracks where Artiest_ID = art.ID)"
    "   and not exists  (select '1' from CDtitels where Artiest_ID = art.ID )");

} // namespace

void CleanOrphans()
{
    try {
        if (!gConnection)
            throw ADODB::makeError(ADODB::errObjectClosed);
        ADODB::Transaction transaction(*gConnection);
        gConnection->Execute(deleteTracks);
        gConnection->Execute(deleteTitles);
        gConnection->Execute(deleteArtists); // must see what the first two have removed
        transaction.CommitTrans();
    } catch (const ADODB::Error &error) {
        // By design: this title is Dutch in both languages, and nothing is rolled back here.
        errorBox(error.numbered(), QStringLiteral("Systeemfout"));
    }
}
