#include "catalogue/errorboxes.h"

#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"

void showDatabaseErrors(const Error &error, const QString &title)
{
    errorBox(error.numbered(), title);
    const auto entries = gConnection->Errors;
    for (const Error &entry : entries)
        errorBox(entry.numbered());
}
