#include "catalogue/ids.h"

#include "platform/ado/recordset.h"
#include "services/globals.h"

qint64 nextId(const QString &statement, QLatin1String field)
{
    return nextId(statement, field, *gConnection);
}

qint64 nextId(const QString &statement, QLatin1String field, ADODB::Connection &connection)
{
    ADODB::Recordset answer;
    answer.Open(statement, connection);
    const ADODB::Value id = answer.Fields(QString(field)).Value();
    return id.isNull() ? 1 : id.toLong();
}
