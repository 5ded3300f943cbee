#include "platform/ado/connection.h"

#include "platform/ado/dialect.h"
#include "platform/ado/engineerror.h"
#include "platform/ado/preparedstatements.h"
#include "platform/ado/recordset.h"
#include "platform/ado/roworder.h"
#include "platform/ado/sqlfunctions.h"

#include <QElapsedTimer>
#include <QScopedValueRollback>
#include <QStringList>
#include <algorithm>
#include <sqlite3.h>

using namespace Qt::StringLiterals;

namespace ADODB
{

namespace
{

// Asked for as a text, the engine would copy it to put a NUL behind it.
std::string_view textOf(sqlite3_value *cell)
{
    const bool asItIs = sqlite3_value_encoding(cell) == SQLITE_UTF8;
    const auto *bytes = static_cast<const char *>(
        asItIs ? sqlite3_value_blob(cell) : static_cast<const void *>(sqlite3_value_text(cell)));
    return {bytes ? bytes : "", std::size_t(sqlite3_value_bytes(cell))};
}

// Other programs hold the catalogue for a moment while they save; a copy of it over a network takes
// longer. Beyond this a person wants to know.
constexpr int waitAtMost = 5; // seconds
constexpr int patience = 20;  // milliseconds between two tries

// A cell is asked for once, not for each thing about it: a connection without locks permits it.
void readRow(sqlite3_stmt *s, Rows &rows)
{
    const auto row = rows.addRow();
    for (int i = 0; i < rows.columnCount(); ++i) {
        sqlite3_value *cell = sqlite3_column_value(s, i);
        switch (sqlite3_value_type(cell)) {
        case SQLITE_INTEGER:
            rows.setInteger(row, i, sqlite3_value_int64(cell));
            break;
        case SQLITE_FLOAT:
            rows.setReal(row, i, sqlite3_value_double(cell));
            break;
        case SQLITE_NULL:
            break;
        default:
            rows.setUtf8OrShare(row, i, textOf(cell));
        }
    }
}

std::vector<std::uint32_t> firstOf(std::vector<std::uint32_t> order, int atMost)
{
    if (atMost >= 0 && std::size_t(atMost) < order.size())
        order.resize(std::size_t(atMost));
    return order;
}

} // namespace

struct Connection::Engine {
    sqlite3 *db = nullptr;
    PreparedStatements prepared;

    // The transaction: who has it, and whether its routine has ended without closing it.
    std::vector<Transaction *> routines;
    bool transactionOpen = false;
    std::shared_ptr<TransactionFate> fate; // of the outermost share

    QElapsedTimer waited; // for another program
    bool waiting = false; // the engine is in the middle of a call

    ~Engine()
    {
        if (waiting)
            return; // the program ends: what is open is rolled back by who opens the file next
        prepared.clear();
        sqlite3_close(db);
    }

    bool abandoned() const { return transactionOpen && routines.empty(); }
    int exec(const char *sql) const { return sqlite3_exec(db, sql, nullptr, nullptr, nullptr); }
};

Connection::Connection() = default;

Connection::~Connection()
{
    disconnect();
}

QString Connection::dataSource(const QString &connectionString)
{
    const QString key = u"Data Source="_s;
    const auto from = connectionString.indexOf(key, 0, Qt::CaseInsensitive);
    if (from < 0)
        return {};
    // A file name may hold semicolons; the one that ends the entry has a blank or nothing behind
    // it.
    QString file = connectionString.sliced(from + key.size());
    if (const auto end = file.lastIndexOf("; "_L1); end >= 0)
        file.truncate(end);
    else if (file.endsWith(u';'))
        file.chop(1);
    return file;
}

void Connection::fail(int code)
{
    const QString message = QString::fromUtf8(sqlite3_errmsg(mEngine->db));
    refuse(engineError(code, message));
}

void Connection::check(int code)
{
    if (code != SQLITE_OK && code != SQLITE_DONE && code != SQLITE_ROW)
        fail(code);
}

sqlite3 *Connection::handle() const
{
    return mEngine ? mEngine->db : nullptr;
}

void Connection::requireOpen() const
{
    if (!mEngine)
        throw makeError(errObjectClosed);
    if (mEngine->waiting)
        throw makeError(errNotPermitted);
}

ObjectStateEnum Connection::State() const
{
    return mEngine ? adStateOpen : adStateClosed;
}

void Connection::Open(const QString &, const QString &, const QString &connectionString, int)
{
    if (mEngine)
        throw makeError(errNotPermitted);
    if (!connectionString.isEmpty())
        ConnectionString = connectionString;
    // The engine's book-keeping of its memory, which nobody reads, would lock at each allocation.
    [[maybe_unused]] static const int once = sqlite3_config(SQLITE_CONFIG_MEMSTATUS, 0);
    mEngine = std::make_unique<Engine>();
    try {
        const QByteArray file = dataSource(ConnectionString).toUtf8();
        if (file.isEmpty()) // to the engine, a temporary file of its own
            throw makeError(errCannotUse);
        const int access = Mode == adModeRead ? SQLITE_OPEN_READONLY : SQLITE_OPEN_READWRITE;
        // The program has one thread: the engine need not lock at each call.
        const int flags = access | SQLITE_OPEN_EXRESCODE | SQLITE_OPEN_NOMUTEX;
        check(sqlite3_open_v2(file.constData(), &mEngine->db, flags, nullptr));
        const auto locked = [](void *self, int before) {
            return int(static_cast<Connection *>(self)->waitForOthers(before));
        };
        sqlite3_busy_handler(mEngine->db, locked, this);
        sqlite3_db_config(mEngine->db, SQLITE_DBCONFIG_DEFENSIVE, 1, nullptr);
        sqlite3_db_config(mEngine->db, SQLITE_DBCONFIG_TRUSTED_SCHEMA, 0, nullptr);
        sqlite3_db_config(mEngine->db, SQLITE_DBCONFIG_DQS_DML, 0, nullptr);
        // A catalogue has neither; one that somebody prepared shall not run what it brings.
        sqlite3_db_config(mEngine->db, SQLITE_DBCONFIG_ENABLE_TRIGGER, 0, nullptr);
        sqlite3_db_config(mEngine->db, SQLITE_DBCONFIG_ENABLE_VIEW, 0, nullptr);
        check(registerFunctions(mEngine->db));
        // EXTRA: until the folder is synced too, a power cut can bring back the journal of a
        // change that was told as saved, and the journal the catalogue from before it.
        check(mEngine->exec("PRAGMA synchronous=EXTRA; PRAGMA temp_store=MEMORY; "
                            "PRAGMA cache_size=-64000; PRAGMA cell_size_check=ON;"));
    } catch (const Error &) {
        mEngine.reset();
        throw;
    }
}

// False: it takes too long. An engine that waits must not be called, nor left by an exception.
bool Connection::waitForOthers(int before)
{
    if (before == 0)
        mEngine->waited.start();
    if (mEngine->waited.elapsed() >= std::min(ConnectionTimeout, waitAtMost) * qint64(1000))
        return false;
    const QScopedValueRollback<bool> waiting(mEngine->waiting, true);
    if (WhileLocked)
        WhileLocked();
    sqlite3_sleep(patience);
    return true;
}

void Connection::Close()
{
    requireOpen();
    disconnect();
}

void Connection::disconnect() noexcept
{
    if (!mEngine)
        return;
    for (Transaction *routine : mEngine->routines)
        routine->mRunning = false;
    mEngine.reset();
}

Recordset Connection::Execute(const QString &statement, int)
{
    Recordset answer;
    if (auto rows = run(statement))
        answer.adopt(std::move(rows));
    return answer;
}

Recordset Connection::firstRows(const QString &statement, int atMost)
{
    Recordset answer;
    answer.adopt(run(statement, atMost));
    return answer;
}

std::shared_ptr<const TransactionFate> Connection::fate() const
{
    if (!mEngine || !mEngine->transactionOpen)
        return nullptr;
    return mEngine->routines.empty() ? mEngine->fate : mEngine->routines.back()->mFate;
}

qint64 Connection::changes() const
{
    requireOpen();
    return sqlite3_total_changes64(mEngine->db);
}

bool Connection::hasMoved() const
{
    requireOpen();
    int moved = 0;
    sqlite3_file_control(mEngine->db, "main", SQLITE_FCNTL_HAS_MOVED, &moved);
    return moved != 0;
}

void Connection::refuse(const Error &error)
{
    Errors.assign(1, error);
    throw error;
}

std::shared_ptr<const Rows> Connection::run(const QString &statement, int atMost)
{
    requireOpen();
    const auto prepared = prepare(sqlOf(statement));
    const Running running(*prepared);
    return fetch(*prepared, atMost);
}

std::string Connection::sqlOf(const QString &statement)
{
    try {
        return translated(statement);
    } catch (const Error &error) {
        refuse(error);
    }
}

std::shared_ptr<PreparedStatement> Connection::prepare(const std::string &sql)
{
    requireOpen();
    int code = SQLITE_OK;
    auto prepared = mEngine->prepared.prepare(mEngine->db, sql, code);
    check(code);
    return prepared;
}

// Runs a statement that has its values; the caller takes it back to its start.
std::shared_ptr<const Rows> Connection::fetch(PreparedStatement &prepared, int atMost)
{
    settleBefore(prepared.readOnly);
    sqlite3_stmt *s = prepared.statement.get();
    int code = prepared.firstStep();
    std::shared_ptr<Rows> rows; // none for a change
    if (!prepared.fields->empty())
        rows = std::make_shared<Rows>(prepared.fields);
    const bool ordered = prepared.order.empty();
    for (; code == SQLITE_ROW; code = sqlite3_step(s)) {
        readRow(s, *rows);
        if (ordered && rows->rowCount() == atMost)
            break;
    }
    check(code);
    if (!ordered)
        rows->arrange(firstOf(rowOrder(*rows, prepared.order, prepared.repeats), atMost));
    return rows;
}

// An open transaction whose routine has gone is rolled back before anything new is written, so that
// nothing new goes down with it. One that the engine took back by itself must not be written on in.
void Connection::settleBefore(bool readOnly)
{
    if (readOnly)
        return;
    if (mEngine->abandoned())
        RollbackTrans();
    else
        requireKept();
}

void Connection::requireKept() const
{
    if (mEngine->transactionOpen && sqlite3_get_autocommit(mEngine->db))
        throw makeError(errNotPermitted);
}

QString Connection::housekeeping(const char *command)
{
    requireOpen();
    QString first;
    const auto take = [](void *to, int columns, char **values, char **) {
        auto *text = static_cast<QString *>(to);
        if (columns > 0 && text->isNull())
            *text = QString::fromUtf8(values[0] ? values[0] : "");
        return 0;
    };
    check(sqlite3_exec(mEngine->db, command, take, &first, nullptr));
    return first;
}

void Connection::begin(Transaction *owner)
{
    requireOpen();
    if (mEngine->abandoned())
        RollbackTrans();
    else
        requireKept();
    owner->mJoined = mEngine->transactionOpen;
    check(mEngine->exec(owner->mJoined ? "SAVEPOINT joined" : "BEGIN IMMEDIATE"));
    mEngine->transactionOpen = true;
    owner->mFate = std::make_shared<TransactionFate>();
    if (owner->mJoined)
        owner->mFate->mOuter = fate();
    else
        mEngine->fate = owner->mFate;
    mEngine->routines.push_back(owner);
    owner->mRunning = true;
}

void Connection::finish(Transaction *owner, bool commit)
{
    requireOpen();
    const bool stillOpen = !sqlite3_get_autocommit(mEngine->db);
    if (!stillOpen && commit)
        throw makeError(errNotPermitted);
    if (stillOpen) {
        if (owner->mJoined)
            check(mEngine->exec(commit ? "RELEASE joined" : "ROLLBACK TO joined; RELEASE joined"));
        else
            check(mEngine->exec(commit ? "COMMIT" : "ROLLBACK"));
    }
    if (!commit)
        owner->mFate->mUndone = true;
    std::erase(mEngine->routines, owner);
    owner->mRunning = false;
    mEngine->transactionOpen = owner->mJoined; // the first routine's share is still to be closed
}

void Connection::leave(Transaction *owner)
{
    if (owner->mJoined) {
        finish(owner, false);
        return;
    }
    std::erase(mEngine->routines, owner);
    owner->mRunning = false;
}

void Connection::RollbackTrans()
{
    if (!mEngine || !mEngine->routines.empty())
        return;
    if (!sqlite3_get_autocommit(mEngine->db))
        check(mEngine->exec("ROLLBACK"));
    if (mEngine->transactionOpen)
        mEngine->fate->mUndone = true;
    mEngine->transactionOpen = false;
}

Transaction::Transaction(Connection &connection) : mConnection(connection)
{
    connection.begin(this);
}

Transaction::~Transaction()
{
    if (!mRunning)
        return;
    try {
        mConnection.leave(this);
    } catch (const Error &) {
        mRunning = false; // the engine has taken it back already
    }
}

void Transaction::CommitTrans()
{
    if (!mRunning)
        throw makeError(errNotPermitted);
    mConnection.finish(this, true);
}

void Transaction::RollbackTrans()
{
    if (mRunning)
        mConnection.finish(this, false);
}

} // namespace ADODB
