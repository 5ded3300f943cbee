#include "catalogue/ids.h"

#include "platform/ado/command.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"

namespace
{

// One row always; the number of an empty table's NULL is 0.
constexpr const char *highestId[] = {"select max(ID) from Artiesten", "select max(ID) from Tracks",
                                     "select max(ID) from CDTitels",
                                     "select max(ID) from CompactDiscs"};

} // namespace

qint64 nextId(Table table)
{
    return nextId(table, *gConnection);
}

qint64 nextId(Table table, ADODB::Connection &connection)
{
    return ADODB::Command(connection, highestId[int(table)]).find({}).id + 1;
}
