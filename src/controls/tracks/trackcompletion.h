#pragma once

#include <QStringList>

namespace ADODB
{
class Connection;
}

/// What the catalogue knows that begins like a text being typed, found through its indexes: some
/// ten of them, in its order, without regard to case and accents. Throws Error.
namespace trackcompletion
{

QStringList artists(ADODB::Connection &connection, const QString &start);
QStringList titles(ADODB::Connection &connection, const QString &artist, const QString &start);

/// Of the artist of a title of the catalogue.
QStringList titles(ADODB::Connection &connection, qint64 cdId, const QString &start);

} // namespace trackcompletion
