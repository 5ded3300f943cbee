#pragma once

#include <QString>

namespace ADODB
{
class Connection;
}

/// Gives a connection the attributes that all of the program's connections have, in their order. It
/// is not opened.
void configureConnection(ADODB::Connection &connection, const QString &file);
