#pragma once

#include "platform/ado/connection.h"
#include "platform/ado/value.h"

#include <initializer_list>
#include <span>
#include <string_view>

struct sqlite3_stmt;

namespace ADODB
{

/// A value on its way into a command. Texts are looked at where they are: they must live until the
/// command has run.
class Parameter
{
public:
    Parameter(std::nullptr_t) {} // NULL
    Parameter(int v) : mValue(qint64(v)) {}
    Parameter(qint64 v) : mValue(v) {}
    Parameter(QStringView text) : mValue(text) {}
    Parameter(const QString &text) : mValue(QStringView(text)) {}
    Parameter(std::string_view utf8) : mValue(utf8) {}
    Parameter(const Value &value);

    /// Gives the value to a "?" of a statement, texts in NFC; a result code of SQLite.
    int bind(sqlite3_stmt *statement, int place) const;

private:
    std::variant<std::monostate, qint64, double, QStringView, std::string_view> mValue;
};

/// A statement that is run again and again with other values: it is prepared once, with a "?" in
/// the place of each value, and keeps the rules of transactions as any statement. Its words are the
/// program's own, in the engine's language; no value can become a word. Fails as Connection does.
class Command
{
public:
    /// The statement must live as long as the command.
    Command(Connection &connection, std::string_view statement)
        : mConnection(connection), mStatement(statement)
    {
    }

    /// Runs it and gives its rows, of a change a closed recordset.
    Recordset Execute(std::initializer_list<Parameter> values = {});
    Recordset Execute(std::span<const Parameter> values);

    /// What a search for an id has found: the first column of the first row, and how many rows
    /// there are, 2 for all that are more than one.
    struct Match {
        int rows = 0;
        qint64 id = 0;
    };
    Match find(std::initializer_list<Parameter> values);

private:
    std::shared_ptr<PreparedStatement> prepared();
    void bind(sqlite3_stmt *statement, std::span<const Parameter> values);

    Connection &mConnection;
    std::string_view mStatement;
    std::weak_ptr<PreparedStatement> mPrepared; // the connection has it, and drops it when closed
};

} // namespace ADODB
