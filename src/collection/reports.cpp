#include "collection/reports.h"

QString CompilationReport::command()
{
    return QStringLiteral("SHAPE { select cd.titel as titel from cdtitels as cd where cd_type='V' "
                          "order by 1 } as CompilationRep compute CompilationRep by Titel");
}

QString AlbumReport::command()
{
    return QStringLiteral(
        "SHAPE { select art.naam as artiest, cd.titel as titel from cdtitels as cd, artiesten art "
        "where cd_type='E' and art.id=cd.artiest_id order by 1,2 } as AlbumRep compute AlbumRep by "
        "Artiest, Titel");
}

QString PlatenbakReport::command()
{
    return QStringLiteral(
        "SHAPE { select art.naam as Artiest , trk.titel as titel from artiesten as art, tracks as "
        "trk where art.id = trk.artiest_id order by 1,2 } as PlatenbakRep compute PlatenbakRep by "
        "Artiest, Titel");
}
