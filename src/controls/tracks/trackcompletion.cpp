#include "controls/tracks/trackcompletion.h"

#include "platform/ado/command.h"
#include "platform/ado/recordset.h"

namespace trackcompletion
{

namespace
{

// So many and no more are read.
constexpr std::string_view selectArtists =
    "select Naam from Artiesten where Naam >= ? and Naam < ? order by Naam limit 10";
constexpr std::string_view selectTitlesOfArtist =
    "select distinct Titel from Tracks where Artiest_ID = (select ID from Artiesten where Naam = ?) "
    "and Titel >= ? and Titel < ? order by Titel limit 10";
constexpr std::string_view selectTitlesOfDisc =
    "select distinct Titel from Tracks where Artiest_ID = (select Artiest_ID from CDTitels where "
    "ID = ?) and Titel >= ? and Titel < ? order by Titel limit 10";

// The code point U+FFFF sorts behind all others.
QString behindAll(const QString &start)
{
    return start + QChar(0xFFFF);
}

QStringList run(ADODB::Connection &connection, std::string_view statement,
                std::initializer_list<ADODB::Parameter> values)
{
    const auto rows = ADODB::Command(connection, statement).Execute(values).rows();
    QStringList texts;
    for (qsizetype row = 0; row < rows->rowCount(); ++row)
        texts.append(rows->text(row, 0));
    return texts;
}

} // namespace

QStringList artists(ADODB::Connection &connection, const QString &start)
{
    return run(connection, selectArtists, {start, behindAll(start)});
}

QStringList titles(ADODB::Connection &connection, const QString &artist, const QString &start)
{
    return run(connection, selectTitlesOfArtist, {artist, start, behindAll(start)});
}

QStringList titles(ADODB::Connection &connection, qint64 cdId, const QString &start)
{
    return run(connection, selectTitlesOfDisc, {cdId, start, behindAll(start)});
}

} // namespace trackcompletion
