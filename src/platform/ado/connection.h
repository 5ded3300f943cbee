#pragma once

#include "platform/error/error.h"

#include <QStringList>
#include <functional>
#include <memory>
#include <vector>

struct sqlite3;

namespace ADODB
{

class Recordset;
class Rows;
struct PreparedStatement;

enum CursorLocationEnum { adUseServer = 2, adUseClient = 3 };
enum IsolationLevelEnum { adXactChaos = 16, adXactReadCommitted = 4096 };
enum ConnectModeEnum { adModeRead = 1, adModeReadWrite = 3 };
enum CursorTypeEnum { adOpenForwardOnly = 0, adOpenStatic = 3 };
enum LockTypeEnum { adLockReadOnly = 1, adLockOptimistic = 3 };
enum ObjectStateEnum { adStateClosed = 0, adStateOpen = 1 };
inline constexpr int adConnectUnspecified = -1;
inline constexpr int adOptionUnspecified = -1;

/// Tells later on whether the changes of a transaction were taken back, by whatever routine.
class TransactionFate
{
public:
    bool undone() const { return mUndone || (mOuter && mOuter->undone()); }

private:
    friend class Connection;
    bool mUndone = false;
    std::shared_ptr<const TransactionFate> mOuter; // of the transaction that it joined
};

/// The one connection to a catalogue: an SQLite file behind the attributes and operations that the
/// screens use. All failures are thrown as Error; those of the engine stand in Errors as well.
///
/// A transaction belongs to the routine that began it, see Transaction. What comes in while that
/// routine still runs joins it.
class Connection
{
public:
    Connection();
    ~Connection();
    Connection(const Connection &) = delete;
    Connection &operator=(const Connection &) = delete;

    // Attributes, to be set before Open().
    QString ConnectionString;   // "...;Data Source=<file>; "
    int CommandTimeout = 30;    // seconds
    int ConnectionTimeout = 15; // seconds; another program's lock is waited for as long, at most 5

    /// Called some fifty times a second while another program's lock is waited for, in the middle
    /// of a call of the engine: it must not come back to this connection.
    std::function<void()> WhileLocked;
    CursorLocationEnum CursorLocation = adUseServer;
    IsolationLevelEnum IsolationLevel = adXactReadCommitted;
    ConnectModeEnum Mode = adModeRead;

    /// The last failure of the engine, none before the first.
    std::vector<Error> Errors;

    void Open(const QString &user = {}, const QString &password = {},
              const QString &connectionString = {}, int options = adConnectUnspecified);
    void Close(); // rolls back what is open
    ObjectStateEnum State() const;

    /// Runs a statement and gives its rows, all of them read; of a change a closed recordset.
    Recordset Execute(const QString &statement, int options = adOptionUnspecified);

    /// The same for a query of which only the first rows are wanted; no more than those are read.
    Recordset firstRows(const QString &statement, int atMost);

    /// The rows inserted, changed and deleted over this connection since it was opened: by it a
    /// routine sees whether another one has written meanwhile.
    qint64 changes() const;

    /// Whether the file has been moved, replaced or deleted since it was opened. What is written
    /// then is refused by the engine.
    bool hasMoved() const;

    /// Fails as the engine would: the error stands in Errors and is thrown.
    [[noreturn]] void refuse(const Error &error);

    /// What becomes of the changes made now: null if no transaction is open.
    std::shared_ptr<const TransactionFate> fate() const;

    /// For the handler of a failed routine: closes the transaction that it has left open. With none
    /// open nothing happens, and a transaction of a routine that still runs is not touched.
    void RollbackTrans();

    /// The file named by a connection string, empty if none is.
    static QString dataSource(const QString &connectionString);

    /// Commands of the program's own housekeeping (PRAGMA, REINDEX), never of a screen: taken
    /// as they stand. Gives the first value of the first row as text.
    QString housekeeping(const char *command);

private:
    friend class Command;
    friend class Recordset;
    friend class Transaction;
    friend class DeletedRows;
    friend QStringList columnsOf(Connection &, const QByteArray &);
    struct Engine;

    static constexpr int allRows = -1;
    std::shared_ptr<const Rows> run(const QString &statement, int atMost = allRows);
    std::string sqlOf(const QString &statement);
    std::shared_ptr<PreparedStatement> prepare(const std::string &sql);
    std::shared_ptr<const Rows> fetch(PreparedStatement &prepared, int atMost = allRows);
    [[noreturn]] void fail(int code);
    void check(int code);
    sqlite3 *handle() const; // null while closed
    void requireOpen() const;
    bool waitForOthers(int before);
    void disconnect() noexcept;
    void settleBefore(bool readOnly);
    void requireKept() const; // that the engine has not taken an open transaction back
    void begin(class Transaction *owner);
    void finish(class Transaction *owner, bool commit);
    void leave(class Transaction *owner);

    std::unique_ptr<Engine> mEngine;
};

/// The share of a routine in a transaction of its connection: made where the routine begins one,
/// gone when the routine ends. One that began while another routine's is running joins it, and
/// takes back its own changes alone. A routine that ends without CommitTrans or RollbackTrans
/// leaves its transaction open; the next one to begin, or to write, rolls it back first.
class Transaction
{
public:
    explicit Transaction(Connection &connection); // BeginTrans
    ~Transaction();
    Transaction(const Transaction &) = delete;
    Transaction &operator=(const Transaction &) = delete;

    void CommitTrans();
    void RollbackTrans();

private:
    friend class Connection;
    Connection &mConnection;
    bool mRunning = false;
    bool mJoined = false;
    std::shared_ptr<TransactionFate> mFate;
};

} // namespace ADODB
