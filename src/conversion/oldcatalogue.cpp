#include "conversion/oldcatalogue.h"

#include "catalogue/connect.h"
#include "conversion/olderrors.h"
#include "conversion/streamedtables.h"
#include "helpers/jetheader.h"
#include "platform/files/nativename.h"
#include "platform/work/helperprogram.h"
#include "platform/work/longwork.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

namespace
{

using End = HelperProgram::End;

// A large catalogue is some ten megabytes; damaged ones keep the library reading for ever.
constexpr HelperProgram::Limits limits{qint64(256) << 20, qint64(512) << 20, 30, 600};

const char *keyOf(int exitCode)
{
    switch (jet::Result(exitCode)) {
    case jet::Result::NotOpened:
        return "xOldNotOpened";
    case jet::Result::NotAFile:
        return "xOldNotAFile";
    case jet::Result::NotADatabase:
        return "xOldNotADatabase";
    case jet::Result::NewerFormat:
        return "xOldNewerFormat";
    case jet::Result::Protected:
        return "xOldProtected";
    case jet::Result::CutOff:
        return "xOldCutOff";
    case jet::Result::OwnFormat:
        return "xOldOwnFormat";
    default:
        return "xOldDamaged";
    }
}

void requireTables(const StreamedTables &tables, bool withMP3)
{
    for (const OldTable &table : oldTables()) {
        if (!tables.has(table) && !table.ofMP3)
            throw oldDatabaseError("xOldNoTable", QLatin1String(table.name));
        if (!tables.has(table) && withMP3)
            throw oldDatabaseError("xOldNoMP3Table", QLatin1String(table.name));
    }
}

bool read(ADODB::Connection &connection, const QString &file, bool withMP3, LongWork &work)
{
    const QString program = HelperProgram::placeOf(u"songcase-jet"_s);
    QStringList arguments = {QString::fromLatin1(nativeName(file).toPercentEncoding("/"))};
    for (const OldTable &table : oldTables()) {
        if (withMP3 || !table.ofMP3) // what is not taken over may be damaged
            arguments.append(QLatin1String(table.name));
    }
    HelperProgram helper(work, program, arguments, limits);
    StreamedTables tables(connection);
    while (const auto line = helper.line()) {
        tables.take({line->constData(), std::size_t(line->size())});
        if (!work.step())
            return false;
    }
    if (helper.end() == End::Cancelled)
        return false;
    if (helper.end() == End::NotStarted)
        throw oldDatabaseError("xDiscNoHelper", program);
    if (helper.end() == End::Failed)
        throw oldDatabaseError(keyOf(helper.exitCode()));
    if (helper.end() != End::Whole || !tables.isWhole())
        throw oldDatabaseError("xOldDamaged");
    requireTables(tables, withMP3);
    return true;
}

} // namespace

Error oldDatabaseError(const char *key, const QString &detail)
{
    return {errCannotUse, u"Songcase"_s, GetMessage(key) + detail};
}

bool openOldCatalogue(ADODB::Connection &connection, const QString &file, bool withMP3,
                      LongWork &work)
{
    configureConnection(connection, file);
    const QString named = connection.ConnectionString;
    connection.Open({}, {}, u"Data Source=:memory:; "_s); // tables that go with the connection
    connection.ConnectionString = named;
    const auto close = [&] {
        if (connection.State() == ADODB::adStateOpen) // the screen may have gone meanwhile
            connection.Close();
    };
    bool done = false;
    try {
        done = read(connection, file, withMP3, work);
    } catch (const Error &) {
        close();
        throw;
    }
    if (!done)
        close();
    return done;
}
