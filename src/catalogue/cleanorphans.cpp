#include "catalogue/cleanorphans.h"

#include "platform/ado/deletedrows.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"
#include "services/messages.h"

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

// The deletes ask indexes whether anything points at a row. One that is damaged says no.
bool goodRowsGone(const ADODB::DeletedRows &deleted)
{
    return deleted.stillNamedIn("CompactDiscs",
                                {{"Track_ID", "Tracks"}, {"CDTitels_ID", "CDTitels"}}) ||
           deleted.stillNamedIn("Tracks", {{"Artiest_ID", "Artiesten"}}) ||
           deleted.stillNamedIn("CDTitels", {{"Artiest_ID", "Artiesten"}});
}

} // namespace

void CleanOrphans()
{
    try {
        ADODB::Transaction transaction(*gConnection);
        const ADODB::DeletedRows deleted(*gConnection);
        gConnection->Execute(deleteTracks);
        gConnection->Execute(deleteTitles);
        gConnection->Execute(deleteArtists); // must see what the first two have removed
        if (goodRowsGone(deleted)) {
            transaction.RollbackTrans();
            throw Error(errCannotUse, u"Songcase"_s, GetMessage("xDamaged"));
        }
        transaction.CommitTrans();
    } catch (const Error &error) {
        // By design: this title is Dutch in both languages, and nothing is rolled back here.
        errorBox(error.numbered(), u"Systeemfout"_s);
    }
}
