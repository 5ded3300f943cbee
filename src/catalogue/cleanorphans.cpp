#include "catalogue/cleanorphans.h"

#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace
{

const auto deleteTracks =
    u"delete from tracks trk where not exists (select '1' from CompactDiscs where Track_ID=trk.ID)"_s;

const auto deleteTitles = u"delete from CDTitels cdt where not exists "
                          "(select '1' from CompactDiscs where CDtitels_ID=cdt.ID)"_s;

const auto deleteArtists =
    u"delete from Artiesten art where not exists (select '1' from Tracks where Artiest_ID = art.ID)"
    "   and not exists  (select '1' from CDtitels where Artiest_ID = art.ID )"_s;

} // namespace

void CleanOrphans()
{
    try {
        if (!gConnection)
            throw makeError(errObjectClosed);
        ADODB::Transaction transaction(*gConnection);
        gConnection->Execute(deleteTracks);
        gConnection->Execute(deleteTitles);
        gConnection->Execute(deleteArtists); // must see what the first two have removed
        transaction.CommitTrans();
    } catch (const Error &error) {
        // By design: this title is Dutch in both languages, and nothing is rolled back here.
        errorBox(error.numbered(), u"Systeemfout"_s);
    }
}
