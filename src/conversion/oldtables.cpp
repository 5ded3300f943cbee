#include "conversion/oldtables.h"

namespace
{

constexpr auto Text = OldColumn::Text;
constexpr auto Number = OldColumn::Number;
constexpr auto Allowed = OldColumn::Allowed;

} // namespace

// By design: remarks (CompactDiscs.Opmerking) are not taken over.
const std::array<OldTable, 6> &oldTables()
{
    static const std::array<OldTable, 6> tables = {{
        {"Artiesten",
         "select count(*) as aantal from artiesten",
         " artists....",
         "select * from artiesten order by naam",
         "insert into artiesten(id,naam) values (?,?)",
         "% of artists conversion completed",
         {{"ID"}, {"Naam", Text}}},
        {"Tracks",
         "select count(*) as aantal from tracks",
         " tracks....",
         "select * from tracks order by titel",
         "insert into tracks(id,artiest_id,titel,genre,hitjaar) values (?,?,?,?,?)",
         "% of tracks conversion completed",
         {{"ID"},
          {"Artiest_ID"},
          {"Titel", Text},
          {"Genre", Text, Allowed},
          {"Hitjaar", Number, Allowed}}},
        {"CDTitels",
         "select count(*) as aantal from cdtitels",
         " titles of albums and compilations....",
         "select * from cdtitels order by titel",
         "insert into cdtitels(id,titel,artiest_id,cd_type,genre,hitjaar) values (?,?,?,?,?,?)",
         "% of cd titles completed",
         {{"ID"},
          {"Titel", Text},
          {"Artiest_ID", Number, Allowed},
          {"CD_Type", Text, OldColumn::IsEmptyText},
          {"Genre", Text, Allowed},
          {"Hitjaar", Number, Allowed}}},
        {"CompactDiscs",
         "select count(*) as aantal from compactdiscs",
         " tracks on these albums and compilations....",
         "select * from compactdiscs",
         "insert into compactdiscs(id,cdtitels_id,diskno,trackno,track_id,Opmerking) values "
         "(?,?,?,?,?,null)",
         "% of discs conversion completed",
         {{"ID"}, {"CDTitels_ID"}, {"DiskNo"}, {"TrackNo"}, {"Track_ID"}}},
        {"MP3Collections",
         "select count(*) as aantal from MP3Collections",
         "  MP3 collections....",
         "select * from MP3Collections",
         "insert into MP3Collections(id,map,album) values (?,?,?)",
         "% of MP3 collection conversion completed",
         {{"ID"}, {"Map", Text}, {"Album", Text}},
         true},
        {"MP3Files",
         "select count(*) as aantal from MP3Files",
         "  MP3 files....",
         "select * from MP3Files",
         "insert into MP3Files(id,volgnummer,filename,collectionid) values (?,?,?,?)",
         "% of MP3 filenames conversion completed",
         {{"ID"}, {"Volgnummer"}, {"FileName", Text}, {"CollectionId"}},
         true},
    }};
    return tables;
}
