#pragma once

#include "platform/ado/connection.h"
#include "platform/ado/rows.h"

#include <memory>

namespace ADODB
{

class Recordset;

/// One column of the current record.
class Field
{
public:
    Field(Recordset &recordset, int column) : mRecordset(recordset), mColumn(column) {}
    QString Name() const;
    ADODB::Value Value() const; // throws errNoCurrentRecord
    void setValue(const ADODB::Value &v);

private:
    Recordset &mRecordset;
    int mColumn;
};

/// Rows in memory with a current record: the answer to a statement, all of it read when opened, or
/// a table of a screen's own, built field by field without a connection. Copies share their rows
/// until one of them is changed.
class Recordset
{
public:
    void Open(const QString &statement, Connection &connection, CursorTypeEnum = adOpenForwardOnly,
              LockTypeEnum = adLockReadOnly, int options = adOptionUnspecified);

    /// Adds a column to a recordset that is not open yet.
    void appendField(const QString &name, DataTypeEnum type, int size = 0);
    void Open(); // without a source, on the columns that were appended
    void Close();
    ObjectStateEnum State() const { return mRows ? adStateOpen : adStateClosed; }

    bool isEOF() const;
    bool isBOF() const;
    qsizetype RecordCount() const;
    void MoveFirst(); // throws errNoCurrentRecord on an empty recordset
    void MoveLast();
    void MoveNext();
    void MovePrevious();

    int fieldCount() const;
    Field Fields(int column);
    Field Fields(QStringView name); // without regard to case; throws errItemNotFound
    int columnOf(QStringView name) const;

    // Changes of the table in memory; nothing reaches a catalogue.
    void AddNew();
    void Update() {}                                       // every value counts at once
    void Delete();                                         // the position stays until the next move
    void arrange(const std::vector<std::uint32_t> &order); // keeps these rows, in this order

    /// The rows as they are now; they never change, whatever happens to the recordset.
    std::shared_ptr<const Rows> rows() const;

private:
    friend class Field;
    friend class Command;
    friend class Connection;
    Rows &changeable();
    void requireOpen() const;
    void requireRecord() const;
    void adopt(std::shared_ptr<const Rows> rows);

    std::shared_ptr<FieldList> mNewFields;
    std::shared_ptr<Rows> mRows;
    qsizetype mPosition = 0; // -1 before the first
    bool mOnDeleted = false;
};

using RecordsetPtr = std::shared_ptr<Recordset>;

} // namespace ADODB
