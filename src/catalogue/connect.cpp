#include "catalogue/connect.h"

#include "platform/ado/connection.h"

void configureConnection(ADODB::Connection &connection, const QString &file)
{
    connection.ConnectionString =
        QStringLiteral("Provider=MSDataShape;Data Provider=Microsoft.Jet.OLEDB.4.0;Data Source=") +
        file + QStringLiteral("; ");
    connection.CommandTimeout = 30;
    connection.ConnectionTimeout = 30;
    connection.CursorLocation = ADODB::adUseClient;
    connection.IsolationLevel = ADODB::adXactChaos;
    connection.Mode = ADODB::adModeReadWrite;
}
