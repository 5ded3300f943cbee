#include "platform/ado/engineerror.h"

#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace ADODB
{

namespace
{

struct Words {
    int code;
    ErrorNumber number;
    const char *key;
};

constexpr Words words[] = {
    {SQLITE_BUSY, errCannotUse, "xErrInUse"},
    {SQLITE_LOCKED, errCannotUse, "xErrInUse"},
    {SQLITE_FULL, errCannotUse, "xErrDiskFull"},
    {SQLITE_READONLY_DBMOVED, errCannotUse, "xErrMoved"},
    {SQLITE_READONLY, errReadOnly, "xErrReadOnly"},
    {SQLITE_CANTOPEN, errCannotUse, "xErrCannotOpen"},
    {SQLITE_CORRUPT, errCannotUse, "xErrDamaged"},
    {SQLITE_NOTADB, errCannotUse, "xErrNoCatalogue"},
    {SQLITE_IOERR, errCannotUse, "xErrDisk"},
    {SQLITE_NOMEM, errCannotUse, "xErrMemory"},
    {SQLITE_CONSTRAINT, errConstraint, "xErrConstraint"},
};

} // namespace

Error engineError(int code, const QString &message)
{
    const auto source = u"SQLite"_s;
    for (const Words &w : words) {
        if (w.code == code || w.code == (code & 0xFF))
            return {w.number, source, errorText(w.key, message)};
    }
    return {errSyntax, source, errorText("xErrSyntax", message)};
}

} // namespace ADODB
