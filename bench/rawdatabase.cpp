#include "rawdatabase.h"

#include "platform/ado/sqlfunctions.h"

#include <stdexcept>

RawDatabase::RawDatabase(const std::string &file, Functions functions)
{
    sqlite3 *db = nullptr;
    const int code = sqlite3_open(file.c_str(), &db);
    mDb.reset(db);
    check(code);
    if (functions == Ours)
        check(ADODB::registerFunctions(db));
}

void RawDatabase::check(int code) const
{
    if (code != SQLITE_OK && code != SQLITE_ROW && code != SQLITE_DONE)
        throw std::runtime_error(sqlite3_errmsg(mDb.get()));
}

void RawDatabase::exec(const std::string &sql)
{
    check(sqlite3_exec(mDb.get(), sql.c_str(), nullptr, nullptr, nullptr));
}

sqlite3_int64 RawDatabase::number(const std::string &sql)
{
    return RawStatement(*this, sql.c_str()).number();
}

RawStatement::RawStatement(RawDatabase &database, const char *sql) : mDatabase(database)
{
    sqlite3_stmt *s = nullptr;
    database.check(
        sqlite3_prepare_v3(database.handle(), sql, -1, SQLITE_PREPARE_PERSISTENT, &s, nullptr));
    mStatement.reset(s);
}

bool RawStatement::step()
{
    const int code = sqlite3_step(mStatement.get());
    mDatabase.check(code);
    return code == SQLITE_ROW;
}
