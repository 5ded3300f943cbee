#include "controls/tracks/trackcompletion.h"

#include "catalogue/quoting.h"
#include "platform/ado/recordset.h"

namespace trackcompletion
{

namespace
{

using Literal = QLatin1String;

constexpr int suggestions = 10;

// The code point U+FFFF sorts behind all others.
QString beginsWith(Literal column, const QString &start)
{
    return column + Literal(" >= ") + quoted(start) + Literal(" and ") + column + Literal(" < ") +
           quoted(start + QChar(0xFFFF));
}

QString selectArtists(const QString &start)
{
    return Literal("select Naam from Artiesten where ") + beginsWith(Literal("Naam"), start) +
           Literal(" order by Naam");
}

QString selectTitles(const QString &artists, const QString &start)
{
    return Literal("select distinct trk.Titel from Tracks trk where trk.Artiest_ID = (") + artists +
           Literal(") and ") + beginsWith(Literal("trk.Titel"), start) +
           Literal(" order by trk.Titel");
}

QString selectArtist(const QString &name)
{
    return Literal("select ID from Artiesten where Naam = ") + quoted(name);
}

QString selectArtistOf(qint64 cdId)
{
    return Literal("select Artiest_ID from CDTitels where ID = ") + QString::number(cdId);
}

QStringList firstOf(ADODB::Connection &connection, const QString &statement)
{
    const auto rows = connection.firstRows(statement, suggestions).rows();
    QStringList texts;
    for (qsizetype row = 0; row < rows->rowCount(); ++row)
        texts.append(rows->text(row, 0));
    return texts;
}

} // namespace

QStringList artists(ADODB::Connection &connection, const QString &start)
{
    return firstOf(connection, selectArtists(start));
}

QStringList titles(ADODB::Connection &connection, const QString &artist, const QString &start)
{
    return firstOf(connection, selectTitles(selectArtist(artist), start));
}

QStringList titles(ADODB::Connection &connection, qint64 cdId, const QString &start)
{
    return firstOf(connection, selectTitles(selectArtistOf(cdId), start));
}

} // namespace trackcompletion
