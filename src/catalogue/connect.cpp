#include "catalogue/connect.h"

#include "platform/ado/connection.h"

using namespace Qt::StringLiterals;

void configureConnection(ADODB::Connection &connection, const QString &file)
{
    connection.ConnectionString =
        u"Provider=MSDataShape;Data Provider=Microsoft.Jet.OLEDB.4.0;Data Source="_s + file +
        u"; "_s;
    connection.CommandTimeout = 30;
    connection.ConnectionTimeout = 30;
    connection.CursorLocation = ADODB::adUseClient;
    connection.IsolationLevel = ADODB::adXactChaos;
    connection.Mode = ADODB::adModeReadWrite;
}
