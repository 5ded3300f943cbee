#pragma once

#include "platform/ado/roworder.h"

#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

struct sqlite3;
struct sqlite3_stmt;

namespace ADODB
{

struct PreparedStatement {
    struct Finalize {
        void operator()(sqlite3_stmt *s) const;
    };
    std::unique_ptr<sqlite3_stmt, Finalize> statement;
    std::shared_ptr<const FieldList> fields;
    bool readOnly = false;
    int timesPrepared = 0; // by the engine itself, after the tables were changed

    /// The columns by which the rows are still to be sorted: a statement that ends in "order by
    /// 1,2" is run without it where all of its columns are in the program's order of texts. The
    /// rows are in memory anyway, sorting them there takes half the time, and the engine is free to
    /// join as is fastest.
    std::vector<OrderColumn> order;

    /// A "select distinct" ordered by all of its columns is run without the "distinct" too: rows
    /// that are alike are found side by side.
    Repeats repeats = Repeats::Kept;

    /// Finds out whether the tables are still those that the statement was prepared for.
    int firstStep();
};

/// A statement in use: it goes back to its start on every way out, so that it holds no lock and no
/// value.
class Running
{
public:
    explicit Running(PreparedStatement &prepared) : mStatement(prepared.statement.get()) {}
    ~Running();
    Running(const Running &) = delete;
    Running &operator=(const Running &) = delete;

    sqlite3_stmt *statement() const { return mStatement; }

private:
    sqlite3_stmt *mStatement;
};

/// The statements that a connection has prepared, by their texts.
class PreparedStatements
{
public:
    /// nullptr if it cannot be prepared; `code` is the engine's answer.
    std::shared_ptr<PreparedStatement> prepare(sqlite3 *db, const std::string &sql, int &code);
    void clear() { mStatements.clear(); }

private:
    std::unordered_map<std::string, std::shared_ptr<PreparedStatement>> mStatements;
};

std::shared_ptr<const FieldList> fieldsOf(sqlite3_stmt *statement);

} // namespace ADODB
