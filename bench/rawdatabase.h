#pragma once

#include <memory>
#include <sqlite3.h>
#include <string>
#include <string_view>

/// A database without anything of the program's own around it: what the program is measured
/// against, and what generated catalogues are written through. Failures are std::runtime_error.
class RawDatabase
{
public:
    enum Functions { Plain, Ours }; // Ours: with the program's collation and functions
    explicit RawDatabase(const std::string &file, Functions functions = Ours);

    void exec(const std::string &sql);
    sqlite3_int64 number(const std::string &sql); // the first value of the first row
    sqlite3_int64 lastId() const { return sqlite3_last_insert_rowid(mDb.get()); }
    sqlite3 *handle() const { return mDb.get(); }
    void check(int code) const;

private:
    struct Close {
        void operator()(sqlite3 *db) const { sqlite3_close(db); }
    };
    std::unique_ptr<sqlite3, Close> mDb;
};

/// A prepared statement; texts are bound without a copy and must live until it is run.
class RawStatement
{
public:
    RawStatement(RawDatabase &database, const char *sql);

    template <typename... Values> void run(const Values &...values)
    {
        bind(values...);
        step();
        sqlite3_reset(mStatement.get());
    }

    /// The first value of the first row, 0 without a row.
    template <typename... Values> sqlite3_int64 number(const Values &...values)
    {
        bind(values...);
        const auto answer = step() ? sqlite3_column_int64(mStatement.get(), 0) : 0;
        sqlite3_reset(mStatement.get());
        return answer;
    }

    template <typename... Values> void bind(const Values &...values)
    {
        int place = 0;
        (bindOne(++place, values), ...);
    }
    bool step(); // whether there is a row
    sqlite3_stmt *handle() const { return mStatement.get(); }

private:
    void bindOne(int place, sqlite3_int64 v) { sqlite3_bind_int64(mStatement.get(), place, v); }
    void bindOne(int place, int v) { sqlite3_bind_int(mStatement.get(), place, v); }
    void bindOne(int place, std::nullptr_t) { sqlite3_bind_null(mStatement.get(), place); }
    void bindOne(int place, std::string_view v)
    {
        sqlite3_bind_text(mStatement.get(), place, v.data(), int(v.size()), SQLITE_STATIC);
    }

    struct Finalize {
        void operator()(sqlite3_stmt *s) const { sqlite3_finalize(s); }
    };
    RawDatabase &mDatabase;
    std::unique_ptr<sqlite3_stmt, Finalize> mStatement;
};
