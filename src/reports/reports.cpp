#include "reports/reports.h"

using namespace Qt::StringLiterals;

CompilationReport::CompilationReport() : Report(u"CompilationReport"_s) {}

QString CompilationReport::caption()
{
    return u"Compilations"_s;
}

QString CompilationReport::command()
{
    return u"SHAPE { select cd.titel as titel from cdtitels as cd where cd_type='V' "
           "order by 1 } as CompilationRep compute CompilationRep by Titel"_s;
}

AlbumReport::AlbumReport() : Report(u"AlbumReport"_s) {}

QString AlbumReport::caption()
{
    return u"Albums"_s;
}

QString AlbumReport::command()
{
    return u"SHAPE { select art.naam as artiest, cd.titel as titel from cdtitels as cd, artiesten art "
           "where cd_type='E' and art.id=cd.artiest_id order by 1,2 } as AlbumRep compute AlbumRep by "
           "Artiest, Titel"_s;
}

PlatenbakReport::PlatenbakReport() : Report(u"PlatenbakReport"_s) {}

QString PlatenbakReport::caption()
{
    return u"Records"_s;
}

QString PlatenbakReport::command()
{
    return u"SHAPE { select art.naam as Artiest , trk.titel as titel from artiesten as art, tracks as "
           "trk where art.id = trk.artiest_id order by 1,2 } as PlatenbakRep compute PlatenbakRep by "
           "Artiest, Titel"_s;
}
